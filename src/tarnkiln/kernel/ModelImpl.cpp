#include "tarnkiln/kernel/ModelImpl.h"

#include "tarnkiln/kernel/DefaultModelUsageProvider.h"
#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/internal/DeclaredExtensions.h"
#include "tarnkiln/kernel/internal/LocalTransactionFactoryImpl.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/kernel/internal/sortByAddress.h"
#include "tarnkiln/kernel/internal/uuidText.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/services/ElementIdResolver.h"
#include "tarnkiln/services/ModelIdNormalizer.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/support/OpenStep.h"

#include "sill/i18n/StringConversion.h"

#include <algorithm>

namespace tarn::kiln {

namespace {

std::atomic<unsigned long> modelsCreated{0};

}  // namespace

Model::Impl::Impl(UUID const& id, ModelConstellation const& constellation)
    : ElementImpl(id, ElementValidity::Valid),
      m_proxies(std::make_unique<internal::StandIns>()),
      m_modelCounter(++modelsCreated),
      m_anchor(new support::ModelAnchor(this)),
      m_extensions(std::make_unique<internal::DeclaredExtensions>(m_modelCounter)),
      m_usageProvider(std::make_unique<DefaultModelUsageProvider>()),
      m_transactionFactory(std::make_unique<internal::LocalTransactionFactoryImpl>(*this))
{
    if (constellation)
    {
        m_modelURI = u"memory://" + sill::i18n::to_ustring(std::to_string(m_modelCounter));
        m_locationModelId = m_modelURI;
    }
}

Model::Impl::~Impl()
{
    m_refCount.set(REFCOUNT_DELETING);
    destroy();
    m_anchor.get()->modelIsGone();
}

Model Model::Impl::getModel() const
{
    return Model(const_cast<Impl*>(this));
}

meta::Class const& Model::Impl::getMetaClass() const
{
    return Model::metaClass();
}

void Model::Impl::removeRef()
{
    if (!m_refCount.decrement())
        return;
    if (m_constellation)
        m_constellation->modelIsNotExternallyReferenced(this);  // may delete this
    else
        delete this;
}

// ---------------------------------------------------------------------------- elements

ModelElement Model::Impl::findElement(UUID const& id, FindElementBehavior behavior) const
{
    if (ModelElement::Impl* const found = m_elements.find(id))
        return ModelElement(found);
    if (behavior == FindElementBehavior::Fetch && m_dataSource)
        return m_dataSource->fetchElement(id);
    return ModelElement();
}

ModelElement Model::Impl::findElement(meta::Class const& metaClass, ElementId const& id) const
{
    return services::ElementIdResolver::doFindElement(getModel(), metaClass, id);
}

std::vector<ModelElement> Model::Impl::getTopLevelElements() const
{
    return m_topLevelElements.all();
}

std::vector<ModelElement> Model::Impl::getAllElements() const
{
    std::vector<ModelElement> result;
    result.reserve(m_elements.size());
    m_elements.forEach([&](ModelElement::Impl* element) { result.emplace_back(element); });
    return result;
}

std::vector<ModelElement::Impl*> Model::Impl::getAllElementImpls() const
{
    std::vector<ModelElement::Impl*> result(m_elements.size());
    auto next = result.begin();
    m_elements.forEach([&](ModelElement::Impl* element) { *next++ = element; });
    return result;
}

void Model::Impl::elementCreated(ModelElement::Impl* element, bool topLevel)
{
    validateTransaction();
    m_anchor.get()->changed();
    if (!m_elements.insert(element))
    {
        element->m_uuid = UUID{};  // its destructor must not find the other element
        reportException(tarnkiln::messages::UUIDConflict());
    }
    if (topLevel)
        m_topLevelElements.reserve();
    bool const recording = isRecording();
    if (recording)
        m_currentTransaction->elementCreated(element);
    try
    {
        if (m_usageProvider)
            m_usageProvider->elementCreated(element);
    }
    catch (...)
    {
        if (recording)
            m_currentTransaction->forgetCreation(element);
        throw;
    }
    if (topLevel)
        m_topLevelElements.insert(element);
}

void Model::Impl::elementDestroying(ModelElement::Impl* element)
{
    validateTransaction();
    if (isRecording())
    {
        if (m_currentTransaction->isDeep())
        {
            m_elements.reserveReturn();
            if (element->isTopLevel())
                m_topLevelElements.reserveReturn();
        }
        m_currentTransaction->elementDestroying(element);
    }
    if (m_usageProvider)
        m_usageProvider->elementDestroying(element);
    remove(element);
}

void Model::Impl::allElementsDestroying()
{
    validateTransaction();
    if (m_currentTransaction)
        m_currentTransaction->allElementsDestroying();
}

void Model::Impl::elementModifying(ModelElement::Impl* element, unsigned long index)
{
    validateTransaction();
    m_anchor.get()->changed();
    if (isRecording() && m_currentTransaction->isHeard())
        m_currentTransaction->elementModifying(element, index);
}

void Model::Impl::elementModifying(ModelElement::Impl* element, meta::Extension const& extension)
{
    validateTransaction();
    if (isRecording())
        m_currentTransaction->elementModifying(element, extension);
}

void Model::Impl::elementMadeTopLevel(ModelElement::Impl* element)
{
    m_topLevelElements.insert(element);
}

void Model::Impl::elementNoLongerTopLevel(ModelElement::Impl* element)
{
    m_topLevelElements.erase(element);
}

void Model::Impl::remove(ModelElement::Impl* element)
{
    m_anchor.get()->changed();
    m_elements.erase(element);
    m_topLevelElements.erase(element);
}

void Model::Impl::resurrectElement(ModelElement::Impl* element)
{
    if (element->isProxy())
    {
        element->m_validity = ElementValidity::BuilderProxy;
        return;
    }
    if (m_elements.contains(element))
        return;  // its destruction failed before it began
    element->m_validity = ElementValidity::Valid;
    element->unpinContainer();
    element->unanchor();
    m_elements.insertReturning(element);
    if (element->isTopLevel())
        m_topLevelElements.insertReturning(element);
}

// ---------------------------------------------------------------------------- listeners

bool Model::Impl::isListening(Listener const* listener) const
{
    return std::any_of(m_listeners.begin(), m_listeners.end(),
                       [&](auto const& holder) { return holder->getListener() == listener; });
}

void Model::Impl::addListenerHolder(std::unique_ptr<ListenerHolderBase> holder)
{
    bool const deep = !holder->isShallow();
    m_listeners.push_back(std::move(holder));
    if (deep)
        resetTransactionDepth();
}

void Model::Impl::removeListener(Listener* listener)
{
    auto const found =
        std::find_if(m_listeners.begin(), m_listeners.end(),
                     [&](auto const& holder) { return holder->getListener() == listener; });
    if (found == m_listeners.end())
        return;
    std::unique_ptr<ListenerHolderBase> const removed = std::move(*found);
    m_listeners.erase(found);
    removeListenerFromTransaction(removed.get());
    if (!removed->isShallow())
        resetTransactionDepth();
}

/// Also reaches the ended transactions that are telling their listeners now.
void Model::Impl::removeListenerFromTransaction(ListenerHolderBase* holder)
{
    if (m_currentTransaction)
        m_currentTransaction->removeListener(holder);
    for (auto* telling = m_telling; telling; telling = telling->getPreviousTelling())
        telling->removeListener(holder);
}

void Model::Impl::removeAllListeners()
{
    std::unordered_set<ExtensionListener*> const extensionListeners =
        std::move(m_extensionListeners);
    m_extensionListeners.clear();
    for (ExtensionListener* const listener : extensionListeners)
        listener->listenerRemoved();
    auto const listeners = std::move(m_listeners);
    m_listeners.clear();
    for (auto const& holder : listeners)
        removeListenerFromTransaction(holder.get());
}

// ---------------------------------------------------------------------------- identity

void Model::Impl::setModelURI(ustring const& uri)
{
    if (uri == m_modelURI)
        return;
    if (!m_constellation)
        reportException(tarnkiln::messages::InvalidValue());
    ustring const location = services::ModelIdNormalizer::convertToLocationModelId(uri);
    if (location != m_locationModelId)
    {
        m_constellation->modelURIAboutToChange(m_locationModelId, location);
        m_locationModelId = location;  // at once: what follows may fail
    }
    m_modelURI = services::ModelIdNormalizer::convertToExternalModelId(location);
    m_constellation->namesChanged();
}

ModelConstellation Model::Impl::getModelConstellation() const
{
    return ModelConstellation(m_constellation);
}

void Model::Impl::basicSetModelConstellation(ModelConstellation::Impl* constellation)
{
    if (m_constellation && m_constellation != constellation)
        m_constellation->modelIsDestroyed(this);
    m_constellation = constellation;
}

void Model::Impl::migrateToConstellation(ModelConstellation const& target)
{
    if (target.getImpl() == m_constellation)
        return;
    if (m_currentTransaction || !m_constellation || isMultiModel() || !target)
        reportException(tarnkiln::messages::CannotMigrateModel());
    target->addModelToConstellation(this);
}

bool Model::Impl::isMultiModel() const
{
    return m_constellation && m_constellation->isMultiModelConstellation();
}

// ---------------------------------------------------------------------------- packages

std::vector<meta::Package> Model::Impl::getUsedPackages() const
{
    return m_usageProvider ? m_usageProvider->getUsedPackages() : std::vector<meta::Package>();
}

std::vector<ustring> Model::Impl::getUsedPackageUris() const
{
    return m_usageProvider ? m_usageProvider->getUsedPackageUris() : std::vector<ustring>();
}

std::vector<ustring> Model::Impl::getDescriptivePackageURIClosure() const
{
    return getImportedPackageClosure(getUsedPackages());
}

void Model::Impl::setUsageProvider(std::unique_ptr<meta::DataModelUsageProvider> provider)
{
    m_usageProvider = std::move(provider);
}

// ---------------------------------------------------------------------------- states

Model::Freezer Model::Impl::freeze()
{
    return Freezer(getModel());
}

Model::ParseInProgressIndicator Model::Impl::startParse()
{
    return ParseInProgressIndicator(getModel());
}

Model::DataSourceLoadingInProgressIndicator Model::Impl::startDataSourceLoading()
{
    return DataSourceLoadingInProgressIndicator(getModel());
}

void Model::Impl::setDataSource(std::unique_ptr<datasource::DataSource> source)
{
    m_dataSource = std::move(source);
}

void Model::Impl::resetDataSource()
{
    m_dataSource.reset();
}

// ---------------------------------------------------------------------------- proxies

/// The model that is meant by the model part of an id, null for none; null if normalizers have to
/// be asked. May be dead.
Model::Impl const* Model::Impl::findNamedModel(internal::ModelName const* name) const
{
    if (!name)
        return this;
    if (!m_constellation)
        return name->text() == m_modelURI ? this : nullptr;
    std::uint64_t const version = m_constellation->getNamesVersion();
    Impl const* model = name->getModel(this, version);
    if (!model)
    {
        model = name->text() == m_modelURI ? this : m_constellation->findListed(name->text());
        name->remember(this, version, model);
    }
    return model;
}

ModelElement::Impl* Model::Impl::findKnownTarget(ModelElement::Impl const& proxy) const
{
    internal::StandIn const& standIn = *proxy.getStandIn();
    UUID const* const uuid = standIn.getUuid();
    if (!uuid || m_validity == ElementValidity::ModelDestroying)
        return nullptr;
    Impl const* const model = findNamedModel(standIn.getModelName());
    if (!model || !model->isLive())
        return nullptr;
    ModelElement::Impl* const found = model->m_elements.find(*uuid);
    bool const isAnswer = found && found->isLive() && found->getMetaClass() == proxy.getMetaClass();
    return isAnswer ? found : nullptr;
}

ModelElement Model::Impl::resolveProxy(ModelElement::Impl const*, ModelElement const& proxy) const
{
    if (m_validity == ElementValidity::ModelDestroying)
        return ModelElement();
    if (ModelElement::Impl* const known = findKnownTarget(*proxy.getImpl()))
        return ModelElement(known);
    ProxyId const& id = *proxy->getProxyIdImpl();
    ModelElement result;
    if (!id.getModelId() || *id.getModelId() == m_modelURI)
        result = findElement(proxy->getMetaClass(), id);
    else if (m_constellation)
        result = m_constellation->resolveProxy(proxy);
    return result ? result : proxy;
}

ModelElement Model::Impl::peekResolveProxy(ModelElement::Impl const*,
                                           ModelElement const& proxy) const
{
    if (m_validity == ElementValidity::ModelDestroying)
        return ModelElement();
    ProxyId const& id = *proxy->getProxyIdImpl();
    ModelElement result;
    if (!id.getModelId() || *id.getModelId() == m_modelURI)
        result = findElement(proxy->getMetaClass(), id);
    else if (m_constellation)
    {
        if (Model const other = m_constellation->peekModel(*id.getModelId()))
            result = other->findElement(proxy->getMetaClass(), id);
    }
    return result ? result : proxy;
}

ProxyId Model::Impl::getPersistentProxyId(ModelElement::Impl const* element, bool omitModel) const
{
    return ProxyId(ElementId::UUID_TYPE, internal::uuidText(element->getUuid()),
                   omitModel ? boost::optional<ustring>() : m_modelURI);
}

// ---------------------------------------------------------------------------- destruction

void Model::Impl::destroyElements(bool multiModel)
{
    bool const keepIncoming =
        m_validity == ElementValidity::ModelDestroying || (m_dataSource && !multiModel);
    std::vector<ModelElement> const& all = m_topLevelElements.all();
    // from the back, where leaving the top level moves no other element
    ModelElement::Impl::_destroyEach({all.rbegin(), all.rend()}, keepIncoming, multiModel);
}

void Model::Impl::destroyAllContents()
{
    Transaction const transaction = beginTransaction(/*revertible=*/false);
    support::OpenStep step(this);
    destroyElements(isMultiModel());
    allElementsDestroying();
    m_topLevelElements.clear();
    step.close();
    transaction.commit();
}

/// Top-level elements in their order, in which they also lie in memory more or less, and then what
/// they contain, as it lies in memory.
std::vector<ModelElement> Model::Impl::getElementsInOrder() const
{
    std::vector<ModelElement> elements = m_topLevelElements.all();
    if (elements.size() == m_elements.size())
        return elements;
    std::vector<ModelElement::Impl*> all = getAllElementImpls();
    internal::sortByAddress(all);
    elements.reserve(all.size());
    for (ModelElement::Impl* const element : all)
    {
        if (!m_topLevelElements.contains(element))
            elements.emplace_back(element);
    }
    return elements;
}

void Model::Impl::convertAllReferencesToProxies(bool multiModel)
{
    std::vector<ModelElement> elements = getElementsInOrder();
    for (ModelElement& next : elements)
    {
        ModelElement const element = std::move(next);  // let go while it is at hand
        boost::optional<ProxyId> proxyId;
        element->convertReferencesToProxies(multiModel, proxyId);
    }
}

void Model::Impl::destroy()
{
    if (m_validity == ElementValidity::Invalid || m_validity == ElementValidity::ModelDestroying)
        return;
    if (m_currentTransaction && m_currentTransaction->isProhibited())
        reportException(tarnkiln::messages::ChangesProhibited());
    m_validity = ElementValidity::ModelDestroying;
    m_anchor.get()->changed();
    Transaction const transaction = beginTransaction(/*revertible=*/false);
    removeAllListeners();
    bool const multiModel = isMultiModel();
    convertAllReferencesToProxies(multiModel);
    destroyElements(multiModel);
    m_topLevelElements.clear();
    // what a link calls contained although no collection holds it
    for (ModelElement const& element : getAllElements())
        element->invalidate();
    m_elements.clear();
    m_proxies->clear([](ModelElement::Impl& proxy) { proxy.m_model = nullptr; });
    destroyExtensions();
    if (m_currentTransaction)
        m_currentTransaction->abandon();
    resetDataSource();
    invalidate();
    if (ModelConstellation::Impl* const constellation = m_constellation)
    {
        ModelConstellation const keep(constellation);
        constellation->modelIsDestroyed(this);
        m_constellation = nullptr;
    }
}
}  // namespace tarn::kiln
