#include "tarnkiln/collections/ReferenceCollection.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {
namespace {

/// Whether there is an element and it is neither dead nor a stand-in.
bool isPresent(ModelElement const& element)
{
    return element && !element->isProxy();
}
}  // namespace

ReferenceCollection::ReferenceCollection(ModelElement::Impl* owner, Feature const& feature,
                                         Feature const& opposite)
    : AbstractOwnedCollection(owner, feature),
      m_opposite(opposite)
{}

ReferenceCollection::~ReferenceCollection() = default;

void ReferenceCollection::copyContents(AbstractOwnedCollection const& other)
{
    basicCopyValues(static_cast<ReferenceCollection const&>(other));
}

std::vector<ModelElement> ReferenceCollection::getAllValuesAndProxies() const
{
    return getAllValues();
}

void ReferenceCollection::refuseElementClass(ModelElement const& element) const
{
    reportException(tarnkiln::messages::CannotAddIncompatibleTypes(
        internal::qualifiedName(getElementClass()),
        internal::qualifiedName(element->getMetaClass())));
}

void ReferenceCollection::checkCompatibleModel(ModelElement::Impl* element) const
{
    if (m_owner)
        m_owner->checkCompatibleModel(element, getCollectionFeature());
}

ModelElement ReferenceCollection::resolveProxy(ModelElement const& proxy) const
{
    Model::Impl* const model = m_owner ? m_owner->getModelImpl() : nullptr;
    return model ? model->resolveProxy(m_owner, proxy) : proxy;
}

ModelElement ReferenceCollection::peekResolveProxy(ModelElement const& proxy) const
{
    Model::Impl* const model = m_owner ? m_owner->getModelImpl() : nullptr;
    return model ? model->peekResolveProxy(m_owner, proxy) : proxy;
}

void ReferenceCollection::basicAddWithProxy(ModelElement const& element)
{
    basicAdd(element);
}

void ReferenceCollection::destroyAllContents()
{
    if (isOwnerDead())
        return;

    std::vector<ModelElement> const elements = getAllValues();
    Operation operation(*this);
    modifying();
    basicClear();
    for (ModelElement const& element : elements)
        element->destroy();
    operation.commit();
}

void ReferenceCollection::linkAdded(ModelElement const& element) const
{
    if (!m_owner)
        return;
    if (m_opposite)
        m_owner->_inverseAddThis(element.getImpl(), m_opposite, /*force=*/false);
    else if (isComposite())
        m_owner->_setContainedByThis(element.getImpl(), getCollectionFeature());
}

void ReferenceCollection::unlinkRemoved(ModelElement const& element) const
{
    if (!m_owner || !isPresent(element))
        return;
    if (m_opposite)
        m_owner->_callInverseRemove(*element.getImpl(), m_opposite);
    else if (isComposite())
        m_owner->_basicSetUncontained(element.getImpl());
}

bool ReferenceCollection::isReferredBackBy(ModelElement const& element) const
{
    // A class tells its own slots without reflection; a property must be open to the public.
    Slot const* const slot = m_opposite.slot();
    if (isComposite() && (slot || m_opposite.propertyImpl()->isPublicAccessor()))
        return element->basicContainer() == m_owner &&
               element->getContainment() == getCollectionFeature();
    if (slot)
        return element->basicGetReference(*slot) == m_owner;

    Value const referred =
        element->getPropertyValue(m_opposite.property(), ModelElement::Impl::PUBLIC_ACCESS);
    return referred.getValue<ModelElement>().getImpl() == m_owner;
}

ModelElement ReferenceCollection::resolveEntry(ModelElement const& proxy) const
{
    ModelElement const target = resolveProxy(proxy);
    if (!isPresent(target))
        return {};
    if (m_opposite && !isComposite() &&
        !(m_owner && m_owner->_inverseContainsThis(target.getImpl(), m_opposite)))
        return {};
    return target;
}

bool ReferenceCollection::namesModel(ModelElement const& proxy)
{
    return proxy->getProxyIdImpl()->getModelId().has_value();
}

void ReferenceCollection::reportCannotAddIncompatibleObjectSubset()
{
    reportException(tarnkiln::messages::CannotAddIncompatibleObjectSubset());
}

void ReferenceCollection::reportCannotAddNonExistentObject()
{
    reportException(tarnkiln::messages::CannotAddNonExistentObject());
}

void ReferenceCollection::reportCannotAddSecondObject()
{
    reportException(tarnkiln::messages::CannotAddSecondObject());
}

void ReferenceCollection::reportCannotCreateCrossModelAssociation()
{
    reportException(tarnkiln::messages::CannotCreateCrossModelAssociation());
}

void ReferenceCollection::reportUniquenessConstraint()
{
    reportException(tarnkiln::messages::UniquenessConstraint());
}
}  // namespace tarn::kiln
