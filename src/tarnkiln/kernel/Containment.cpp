// The operations of elements on the containment tree, and their destruction.
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/support/JoiningTransaction.h"
#include "tarnkiln/support/OpenStep.h"

#include <utility>
#include <vector>

namespace tarn::kiln {

namespace {

/// How many levels of a tree are destroyed inside one another before deeper ones wait.
constexpr int MAX_DESTRUCTION_DEPTH = 100;

/// An element that is destroyed when the outermost level of its tree ends.
struct Waiting
{
    ModelElement element;
    ModelElement container;  ///< To which the element still points.
    bool keepIncoming;
    bool multiModel;
};

/// The levels of one tree that are being destroyed, and what waits for the outermost of them, so
/// that a tree of any depth needs little stack.
struct Destructions
{
    int depth = 0;
    std::vector<Waiting>* waiting = nullptr;  ///< Made by the outermost level of a deep tree.
};

/// Holds no object, so that it is found without a test whether it has been made.
constinit thread_local Destructions destructions;

/// A function of its own, so that they are found once: in a shared library that takes a call.
[[gnu::noinline]] Destructions& destructionsOfThread()
{
    return destructions;
}

/// One level.
class DestructionLevel
{
public:
    explicit DestructionLevel(Destructions& all) : m_all(all) { ++m_all.depth; }
    DestructionLevel(DestructionLevel const&) = delete;
    DestructionLevel& operator=(DestructionLevel const&) = delete;
    ~DestructionLevel()
    {
        if (--m_all.depth == 0)
            delete std::exchange(m_all.waiting, nullptr);  // not empty after a failure only
    }

    /// Destroys what waits, if this is the outermost level.
    void finish() const
    {
        while (m_all.depth == 1 && m_all.waiting && !m_all.waiting->empty())
        {
            Waiting const next = std::move(m_all.waiting->back());
            m_all.waiting->pop_back();
            next.element->destroyRecursively(next.keepIncoming, /*removeFromContainer=*/false,
                                             next.multiModel);
        }
    }

private:
    Destructions& m_all;
};

/// Lets an element wait for the outermost level.
void postpone(Destructions& all, Waiting waiting)
{
    if (!all.waiting)
        all.waiting = new std::vector<Waiting>;
    all.waiting->push_back(std::move(waiting));
}

/// Lets a tree that is destroyed by a hook in the middle of another one count its own levels.
class SeparateDestruction
{
public:
    SeparateDestruction() : m_all(destructionsOfThread()), m_outer(std::exchange(m_all, {})) {}
    SeparateDestruction(SeparateDestruction const&) = delete;
    SeparateDestruction& operator=(SeparateDestruction const&) = delete;
    ~SeparateDestruction() { m_all = m_outer; }

private:
    Destructions& m_all;
    Destructions m_outer;
};

}  // namespace

ModelElement ModelElement::Impl::container() const
{
    return ModelElement(basicContainer());
}

meta::Property ModelElement::Impl::containerProperty() const
{
    return m_containmentFeature.opposite().property();
}

meta::Property ModelElement::Impl::containmentFeature() const
{
    return m_containmentFeature.property();
}

meta::Property::Impl* ModelElement::Impl::containmentFeatureImpl() const
{
    return m_containmentFeature.propertyImpl();
}

/// A dead element's container may lose its last handle before the dead element does.
void ModelElement::Impl::pinContainer()
{
    if (m_container && !m_containerPinned)
    {
        m_container->addRef();
        m_containerPinned = true;
    }
}

void ModelElement::Impl::unpinContainer()
{
    if (m_containerPinned)
    {
        m_containerPinned = false;
        m_container->removeRef();
    }
}

void ModelElement::Impl::storeLink(Impl* container, Feature const& feature)
{
    unpinContainer();
    m_container = container;
    m_containmentFeature = feature;
    if (container)
        container->m_everContainer = true;
}

void ModelElement::Impl::announceContainerChange()
{
    if (m_validity == ElementValidity::Valid && !isProxy() && m_model->isRecording())
        m_model->m_currentTransaction->containerChanging(this);
}

void ModelElement::Impl::recordOldContainer(Storage& storage) const
{
    if (isTopLevel() && !storage.isContainerChanged())
        m_model->m_topLevelElements.reserveReturn();
    storage.setOldContainer(container(), m_containmentFeature);
}

void ModelElement::Impl::basicSetContainer(Impl* newContainer, Feature const& feature,
                                           unsigned long index)
{
    notifyModifying(index);
    if (!newContainer || !feature)
    {
        if (isTopLevel())
            return;
        announceContainerChange();
        if (m_validity == ElementValidity::Valid && !isProxy())
            m_model->elementMadeTopLevel(this);
        storeLink(nullptr, Feature());
        return;
    }
    if (newContainer->m_model != m_model)
        reportException(tarnkiln::messages::CannotChangeModel());
    ModelElement const keep(this);
    announceContainerChange();
    if (isTopLevel())
        m_model->elementNoLongerTopLevel(this);
    storeLink(newContainer, feature);
}

void ModelElement::Impl::basicSetContainer(Storage const* storage)
{
    Feature const feature = storage->getOldContainment();
    if (!feature)
    {
        m_model->m_topLevelElements.insertReturning(this);
        storeLink(nullptr, Feature());
        return;
    }
    ModelElement const keep(this);
    m_model->elementNoLongerTopLevel(this);
    storeLink(storage->getOldContainer().getImpl(), feature);
}

void ModelElement::Impl::makeUncontained()
{
    Impl* const oldContainer = basicContainer();
    if (!oldContainer)
        return;
    ModelElement const keep(this);
    Feature const feature = m_containmentFeature;
    Feature const opposite = feature.opposite();
    _inverseRemoveThis(oldContainer, feature);
    basicSetContainer(nullptr, Feature(), opposite ? opposite.index() : NO_INDEX);
}

void ModelElement::Impl::_setContainedByThis(Impl* child, Feature const& feature)
{
    ModelElement const keep(child);
    child->makeUncontained();
    child->basicSetContainer(this, feature, NO_INDEX);
}

void ModelElement::Impl::_basicSetUncontained(Impl* child)
{
    child->basicSetContainer(nullptr, Feature(), NO_INDEX);
}

void ModelElement::Impl::checkCircularContainment(ModelElement const& candidate) const
{
    for (Impl const* above = candidate.getImpl(); above; above = above->basicContainer())
    {
        if (above == this)
            reportException(tarnkiln::messages::CircularContainment());
        if (!m_everContainer)
            return;  // above nothing, however deep the candidate lies
    }
}

void ModelElement::Impl::checkCompatibleModel(Impl* other, Feature const& feature) const
{
    if (!other || !other->isLive())
        return;
    bool const sameModel = other->m_model == m_model;
    if (feature.isComposite())
    {
        bool const elsewhere =
            other->isProxy() ? other->m_standIn->getModelName() != nullptr : !sameModel;
        if (elsewhere)
            reportException(tarnkiln::messages::CannotCreateCrossModelAssociation());
        other->checkCircularContainment(ModelElement(const_cast<Impl*>(this)));
    }
    if (sameModel && !other->isProxy())
        return;
    bool const paired = static_cast<bool>(feature.opposite());
    if (m_model->isRegistryModel())
        reportException(tarnkiln::messages::CannotCreateCrossModelAssociation());
    Model::Impl const* const target = other->m_model;
    bool const oneSided = target && (target->isRegistryModel() || target->isTransientModel());
    if (paired && (oneSided || m_model->isTransientModel()))
        reportException(tarnkiln::messages::CannotCreateCrossModelAssociation());
}

void ModelElement::Impl::destroy()
{
    if (!isLive())
        return;
    ModelElement const keep(this);
    Model const model = getModel();
    if (!model)
    {
        invalidate();  // a proxy that outlived its model
        return;
    }
    bool const multiModel = model->isMultiModel();
    SeparateDestruction const separate;
    if (model->getCurrentTransaction() && !model->getDataSource())
    {
        support::JoiningTransaction transaction(*this);
        destroyRecursively(/*keepIncoming=*/false, /*removeFromContainer=*/true, multiModel);
        transaction.commit();
        return;
    }
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    if (model->getDataSource())
        model->getDataSource()->loadElementSubtree(keep);
    support::OpenStep step(model.getImpl());
    destroyRecursively(/*keepIncoming=*/false, /*removeFromContainer=*/true, multiModel);
    step.close();
    transaction.commit();
}

void ModelElement::Impl::destroyRecursively(bool keepIncoming, bool removeFromContainer,
                                            bool multiModel)
{
    if (!isLive())
        return;
    Destructions& ofThread = destructionsOfThread();
    if (ofThread.depth == MAX_DESTRUCTION_DEPTH && !isProxy() && !removeFromContainer)
    {
        postpone(ofThread, {ModelElement(this), container(), keepIncoming, multiModel});
        return;
    }
    ModelElement const keep(this);
    DestructionLevel const level(ofThread);
    if (!isProxy())
    {
        aboutToDestroy();
        notifyDestroying();
        if (!keepIncoming)
            disassociateIncoming();
        if (removeFromContainer && !isTopLevel())
            _callInverseRemove(*m_container, m_containmentFeature);
        doDestroy(keepIncoming, multiModel);
        recordEndingExtensions();
        level.finish();
    }
    else if (m_model && m_model->isRecording())
    {
        m_model->m_currentTransaction->proxyDestroying(this);
    }
    invalidate();
}

void ModelElement::Impl::_destroyEach(std::vector<ModelElement> elements, bool keepIncoming,
                                      bool multiModel)
{
    // Far enough for an element to arrive, and then its entry in the table of elements.
    constexpr std::size_t AHEAD = 8;
    for (std::size_t i = 0; i < elements.size(); ++i)
    {
        if (i + 2 * AHEAD < elements.size())
            __builtin_prefetch(elements[i + 2 * AHEAD].getImpl(), /*rw=*/1);
        ModelElement const element = std::move(elements[i]);
        Model::Impl const* const model = element->getModelImpl();
        if (model && i + AHEAD < elements.size())
            model->m_elements.prefetch(elements[i + AHEAD]->getUuid());
        element->destroyRecursively(keepIncoming, /*removeFromContainer=*/false, multiModel);
    }
}
}  // namespace tarn::kiln
