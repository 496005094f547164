#include "tarnkiln/kernel/ModelConstellation.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/internal/TransactionGroup.h"
#include "tarnkiln/services/ModelIdNormalizer.h"

#include <algorithm>
#include <atomic>
#include <utility>
#include <vector>

namespace tarn::kiln {

ModelConstellation::ModelConstellation(Impl* impl) : ElementHandle(impl) {}

ModelConstellation ModelConstellation::create()
{
    return ModelConstellation(new Impl());
}

ConstellationListenerHolder::ConstellationListenerHolder(ConstellationListener* listener,
                                                         ModelConstellation::Impl* constellation,
                                                         bool owned)
    : m_listener(listener),
      m_constellation(constellation),
      m_owned(owned)
{}

ConstellationListenerHolder::~ConstellationListenerHolder()
{
    m_listener->listenerRemoved(ModelConstellation(m_constellation));
    if (m_owned)
        delete m_listener;
}

ModelConstellation::Impl::Impl() : ElementImpl(UUID{}, ElementValidity::Valid) {}

ModelConstellation::Impl::~Impl()
{
    m_refCount.set(REFCOUNT_DELETING);
    destroy();
}

Model ModelConstellation::Impl::getModel() const
{
    return Model();
}

meta::Class const& ModelConstellation::Impl::getMetaClass() const
{
    return ModelConstellation::metaClass();
}

void ModelConstellation::Impl::removeRef()
{
    if (m_refCount.decrement() && !hasAliveModels())
        delete this;
}

/// Keeps the places of listeners for as long as any walk over them is under way.
class ModelConstellation::Impl::ListenerWalk
{
public:
    explicit ListenerWalk(Impl& constellation) : m_constellation(constellation)
    {
        ++m_constellation.m_listenerWalks;
    }
    ListenerWalk(ListenerWalk const&) = delete;
    ListenerWalk& operator=(ListenerWalk const&) = delete;
    ~ListenerWalk()
    {
        if (--m_constellation.m_listenerWalks == 0)
            std::erase(m_constellation.m_listeners, nullptr);
    }

private:
    Impl& m_constellation;
};

template <class Tell> void ModelConstellation::Impl::forEachListener(Tell const& tell)
{
    ListenerWalk const walk(*this);
    for (std::size_t i = 0; i < m_listeners.size(); ++i)
    {
        if (m_listeners[i])
            tell(*m_listeners[i]->getListener());
    }
}

// ---------------------------------------------------------------------------- models

bool ModelConstellation::Impl::hasAliveModels()
{
    return std::any_of(m_models.begin(), m_models.end(),
                       [](auto const& entry) { return entry.second->getRefCount() != 0; });
}

std::vector<Model> ModelConstellation::Impl::getModels() const
{
    std::vector<Model> result;
    for (auto const& [location, model] : m_models)
        result.emplace_back(model);
    return result;
}

Model ModelConstellation::Impl::peekModel(ustring const& uri) const
{
    auto found = m_models.find(uri);
    if (found == m_models.end())
        found = m_models.find(services::ModelIdNormalizer::convertToLocationModelId(uri));
    return found == m_models.end() ? Model() : Model(found->second);
}

Model ModelConstellation::Impl::fetchModel(ustring const& uri)
{
    Model const model = services::ModelIdNormalizer::load(uri);
    if (!model || model->isRegistryModel())
        return model;
    if (model->isTransientModel())
        return Model();
    model->setModelURI(uri);
    model->migrateToConstellation(ModelConstellation(this));
    return model;
}

void ModelConstellation::Impl::saveModels()
{
    // a copy: saving may rename, load or destroy models
    std::vector<std::pair<ustring, Model>> models;
    for (auto const& [location, model] : m_models)
        models.emplace_back(location, Model(model));
    for (auto const& [location, model] : models)
        services::ModelIdNormalizer::save(model, location);
}

void ModelConstellation::Impl::addModelToConstellation(Model::Impl* model)
{
    if (m_group && !m_group->isDeep())
        reportException(tarnkiln::messages::CannotJoinShallowTransaction());
    if (!m_models.emplace(model->getLocationModelId(), model).second)
        reportException(tarnkiln::messages::UniquenessConstraint());
    namesChanged();
    model->basicSetModelConstellation(this);
    ModelConstellation const self(this);
    forEachListener(
        [&](ConstellationListener& listener) { listener.modelAdded(self, Model(model)); });
    if (m_group && !model->getCurrentTransaction())
        model->doBeginTransaction(m_group.get(), m_group->getOrigin());
    m_uriHistory[model->getModelURI()] = UriRecord{model, ustring()};
    namesChanged();
}

void ModelConstellation::Impl::modelIsDestroyed(Model::Impl* model)
{
    ModelConstellation const self(this);
    forEachListener(
        [&](ConstellationListener& listener) { listener.modelDestroyed(self, Model(model)); });
    auto const found = m_models.find(model->getLocationModelId());
    if (found != m_models.end() && found->second == model)
        m_models.erase(found);
    namesChanged();
    bool const inMemory = model->getModelURI().find(u"memory://") == 0;
    for (auto record = m_uriHistory.begin(); record != m_uriHistory.end();)
    {
        if (record->second.model != model)
        {
            ++record;
        }
        else if (inMemory)
        {
            record = m_uriHistory.erase(record);
        }
        else
        {
            record->second = UriRecord{nullptr, model->getModelURI()};
            ++record;
        }
    }
}

void ModelConstellation::Impl::modelIsNotExternallyReferenced(Model::Impl*)
{
    addRef();
    removeRef();  // deletes this, and the model with it, when nobody holds any of them
}

void ModelConstellation::Impl::modelURIAboutToChange(ustring const& oldId, ustring const& newId)
{
    if (m_models.count(newId) != 0)
        reportException(tarnkiln::messages::UniquenessConstraint());
    auto node = m_models.extract(oldId);
    Model::Impl* const model = node.mapped();
    node.key() = newId;
    m_models.insert(std::move(node));
    namesChanged();
    m_uriHistory[model->getModelURI()] = UriRecord{model, ustring()};
}

std::uint64_t ModelConstellation::Impl::nextNamesVersion()
{
    static std::atomic<std::uint64_t> last{0};
    return ++last;
}

ustring const& ModelConstellation::Impl::latestModelURI(ustring const& uri) const
{
    auto const found = m_uriHistory.find(uri);
    if (found == m_uriHistory.end())
        return uri;
    UriRecord const& record = found->second;
    return record.model ? record.model->getModelURI() : record.forwardingUri;
}

ustring ModelConstellation::Impl::getLatestModelURI(ustring const& uri) const
{
    return latestModelURI(uri);
}

Model::Impl* ModelConstellation::Impl::findListed(ustring const& uri) const
{
    auto const found = m_models.find(latestModelURI(uri));
    return found == m_models.end() ? nullptr : found->second;
}

ModelElement ModelConstellation::Impl::resolveProxy(ModelElement const& proxy)
{
    if (m_validity == ElementValidity::ModelDestroying)
        return ModelElement();
    ProxyId const& id = *proxy->getProxyIdImpl();
    ustring const& uri = *id.getModelId();
    Model model = peekModel(getLatestModelURI(uri));
    if (!model)
        model = peekModel(services::ModelIdNormalizer::convertToLocationModelId(uri));
    if (!model)
        model = fetchModel(uri);
    ModelElement const found =
        model ? model->findElement(proxy->getMetaClass(), id) : ModelElement();
    return found ? found : proxy;
}

// ---------------------------------------------------------------------------- listeners

void ModelConstellation::Impl::addConstellationListener(ConstellationListener* listener)
{
    m_listeners.push_back(
        std::make_unique<ConstellationListenerHolder>(listener, this, /*owned=*/false));
}

void ModelConstellation::Impl::addOwnedConstellationListener(
    std::unique_ptr<ConstellationListener> listener)
{
    m_listeners.reserve(m_listeners.size() + 1);
    m_listeners.push_back(
        std::make_unique<ConstellationListenerHolder>(listener.get(), this, /*owned=*/true));
    static_cast<void>(listener.release());
}

void ModelConstellation::Impl::removeConstellationListener(ConstellationListener* listener)
{
    auto const found =
        std::find_if(m_listeners.begin(), m_listeners.end(), [&](auto const& holder) {
            return holder && holder->getListener() == listener;
        });
    if (found == m_listeners.end())
        return;
    // told last, when it is off the list
    std::unique_ptr<ConstellationListenerHolder> const removed = std::move(*found);
    if (m_listenerWalks == 0)
        m_listeners.erase(found);
}

// ---------------------------------------------------------------------------- transactions

void ModelConstellation::Impl::createTransactionGroup(bool deep,
                                                      meta::TransactionOrigin const& origin)
{
    if (m_group)
    {
        // a listener begins on a model that is just being added: it joins now
        for (auto const& [location, model] : m_models)
        {
            if (!model->getCurrentTransaction())
                model->doBeginTransaction(m_group.get(), m_group->getOrigin());
        }
        return;
    }
    m_group = std::make_unique<internal::TransactionGroup>(
        this, deep || isMultiModelConstellation(), origin);
    try
    {
        for (auto const& [location, model] : m_models)
            model->doBeginTransaction(m_group.get(), origin);
    }
    catch (...)
    {
        m_group->rollBack();
        throw;
    }
}

void ModelConstellation::Impl::transactionGroupCompleted()
{
    m_group.reset();
}

void ModelConstellation::Impl::destroy()
{
    if (!isLive())
        return;
    ModelConstellation const keep(this);
    if (m_group)
        m_group->rollBack();
    for (Model const& model : getModels())
        model->destroy();
    invalidate();
    forEachListener(
        [&](ConstellationListener& listener) { removeConstellationListener(&listener); });
}
}  // namespace tarn::kiln
