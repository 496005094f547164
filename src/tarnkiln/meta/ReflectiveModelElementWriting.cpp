// How reflective elements take new values. Each setter tests all that can fail, then leaves the
// collections whose key changes, announces the change, stores, and enters the collections again.
#include "tarnkiln/collections/QualifierKeys.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/internal/DependentCollections.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"

namespace tarn::kiln {

using internal::DependentCollections;
using internal::SlotKind;

namespace {

/// Holds a change of several elements together where the model needs no transaction and none is
/// open: else each collection that it reaches would end one of its own, in the middle of the
/// change.
class ChangeOfSeveral
{
public:
    explicit ChangeOfSeveral(ModelElement::Impl const& element)
    {
        element.getModelImpl()->validateTransaction();
        if (!element.getModelImpl()->getCurrentTransaction())
            m_transaction = element.getModelImpl()->beginTransaction(/*revertible=*/false);
    }
    void commit()
    {
        if (m_transaction)
            m_transaction.commit();
    }

private:
    Transaction m_transaction;  ///< Empty unless opened here.
};
}  // namespace

void ReflectiveModelElementImpl::setPropertyValue(meta::Property const& property,
                                                  Value const& value,
                                                  ReflectionPrivateTag const& tag)
{
    ReflectiveSlot const* const slot = settableSlot(property, tag);
    if (!slot)
        return ModelElement::Impl::setPropertyValue(property, value, tag);
    checkType(*slot, value);
    if (isProxy())
        reportException(tarnkiln::messages::CannotModifyProxy());
    if (!isLive())
        return;

    ModelElement const self(this);
    switch (slot->kind())
    {
    case SlotKind::Container:
        return setContainer(*slot, value.getValue<ModelElement>());
    case SlotKind::Reference:
        return setReference(*slot, value.getValue<ModelElement>());
    case SlotKind::Annotations:
        return static_cast<StringToStringMap*>(made(*slot))
            ->assign(value.getValue<StringToStringMap&>());
    default:
        return setPlain(*slot, value);
    }
}

/// The slot, if the element has the property, it is single, and `tag` allows to set it.
internal::ReflectiveSlot const*
ReflectiveModelElementImpl::settableSlot(meta::Property const& property,
                                         ReflectionPrivateTag const& tag) const
{
    if (!property || !getMetaClass() || !getMetaClass()->isATypeOf(property))
        return nullptr;
    if (tag == PUBLIC_ACCESS &&
        (!property->isPublicMutator() || (property->isReadOnly() && !property->isSetOnce())))
        return nullptr;
    ReflectiveSlot const* const slot = layout().find(property);
    bool const isSingle =
        slot && slot->kind() != SlotKind::Values && slot->kind() != SlotKind::References;
    return isSingle ? slot : nullptr;
}

void ReflectiveModelElementImpl::checkType(ReflectiveSlot const& slot, Value const& value) const
{
    meta::Property const& property = slot.property();
    meta::Type const type = property->getType();
    bool suits = false;
    if (auto const* const own = internal::classImpl(value.getType());
        own && internal::classImpl(type))
    {
        ModelElement const element = value.getFlags() <= ValueFlags::Single
                                         ? value.getValue<ModelElement>()
                                         : ModelElement();
        meta::Class const metaClass =
            element.getImpl() ? element.getImpl()->getMetaClass() : meta::Class();
        suits = !element.getImpl() || (metaClass && metaClass->isA(type));
    }
    else
    {
        // An absent literal travels as an absent `Integer`.
        bool const isClearedEnum = value.getFlags() == ValueFlags::OptionalSingle &&
                                   value.isAbsent() && internal::isEnumType(type);
        suits = value.getType() == type || isClearedEnum;
    }
    if (property->getLower() == 1 && value.getFlags() == ValueFlags::OptionalSingle)
        suits = false;
    if (!suits)
        reportException(
            tarnkiln::messages::CannotCastIncompatibleTypes(internal::qualifiedName(type)));
    if (value.getFlags() > ValueFlags::Single)
        reportException(tarnkiln::messages::InvalidValue());
}

/// Fails unless a keyed collection of `target`, the other end of `slot`, has room for this element.
void ReflectiveModelElementImpl::checkOwnKey(ReflectiveSlot const& slot,
                                             ModelElement const& target) const
{
    meta::Property const opposite = slot.property()->getOpposite();
    meta::Property const qualifier = opposite ? opposite->getQualifiedBy() : meta::Property();
    if (!qualifier || target->isProxy())
        return;
    Value key = getPropertyValue(qualifier, PUBLIC_ACCESS);
    if (key.getFlags() == ValueFlags::OptionalSingle && key.isAbsent())
        support::reportMissingKey(qualifier);
    ReflectiveSlot const* const keySlot = layout().find(qualifier);
    if (keySlot && internal::isPlain(keySlot->kind()))
        key = keySlot->asRequired(key);
    checkUniqueness(target, opposite, unwrapKey(key));
}

// ---------------------------------------------------------------------------- plain values

void ReflectiveModelElementImpl::setPlain(ReflectiveSlot const& slot, Value const& value)
{
    meta::Property const& property = slot.property();
    Value const empty = value.getFlags() == ValueFlags::OptionalSingle && value.isAbsent()
                            ? Value::createEmptyValue(property)
                            : value;
    if (property->isSetOnce() && !slot.holds(m_cells->get(slot), Value::createEmptyValue(property)))
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    if (slot.holds(m_cells->get(slot), empty))
        return;
    DependentCollections const dependents(*this, slot);
    dependents.check(empty);
    if (dependents.isEmpty())
    {
        notifyModifying(slot.index());
        return applyPlain(slot, empty);
    }
    ChangeOfSeveral change(*this);
    dependents.leave();
    notifyModifying(slot.index());
    applyPlain(slot, empty);
    dependents.enter();
    change.commit();
}

void ReflectiveModelElementImpl::applyPlain(ReflectiveSlot const& slot, Value const& value)
{
    internal::ReflectiveCell const added =
        slot.keep(meta::MetaRegistry::getInstance().convertValueForOwnership(value));
    internal::ReflectiveCell const removed = m_cells->get(slot);
    m_cells->set(slot, added);
    slot.release(removed);
}

// ---------------------------------------------------------------------------- references

void ReflectiveModelElementImpl::setReference(ReflectiveSlot const& slot,
                                              ModelElement const& target)
{
    meta::Property const& property = slot.property();
    ModelElement const present(this->target(slot, PRIVILEGED_ACCESS));
    if (target.getImpl() == present.getImpl())
        return;
    if (property->isSetOnce() && present)
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    DependentCollections const dependents(*this, slot);
    dependents.check(Value::createElementValue(property, target));
    if (target)
    {
        checkOwnKey(slot, target);
        checkCompatibleModel(target.getImpl(), property);
    }

    ChangeOfSeveral change(*this);
    dependents.leave();
    notifyModifying(slot.index());
    applyReference(slot, target);
    dependents.enter();
    change.commit();
}

void ReflectiveModelElementImpl::applyReference(ReflectiveSlot const& slot,
                                                ModelElement const& target)
{
    Feature const feature = slot.property();
    Feature const opposite = feature.opposite();
    ModelElement const removed(basicTarget(slot));
    if (removed && opposite)
        _inverseRemoveThis(removed.getImpl(), opposite);
    basicSetTarget(slot, target);
    if (target && opposite)
        _inverseAddThis(target.getImpl(), opposite, /*force=*/false);
    else if (target && feature.isComposite())
        _setContainedByThis(target.getImpl(), feature);
    if (removed && !removed->isProxy() && !opposite && feature.isComposite())
        _basicSetUncontained(removed.getImpl());
}

// ---------------------------------------------------------------------------- container

void ReflectiveModelElementImpl::setContainer(ReflectiveSlot const& slot,
                                              ModelElement const& container)
{
    meta::Property const& property = slot.property();
    ModelElement::Impl* const present = containerBy(slot);
    if (container.getImpl() == present || (!container && !present))
        return;
    if (property->isSetOnce() && present && present->isLive())
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    DependentCollections const dependents(*this, slot);
    dependents.check(Value::createElementValue(property, container));
    if (container)
    {
        if (container->isProxy())
            reportException(tarnkiln::messages::CannotModifyProxy());
        checkOwnKey(slot, container);
        checkCircularContainment(container);
        if (container->getModelImpl() != getModelImpl())
            reportException(tarnkiln::messages::CannotChangeModel());
    }

    ChangeOfSeveral change(*this);
    dependents.leave();
    notifyModifying(slot.index());
    applyContainer(slot, container);
    dependents.enter();
    change.commit();
}

void ReflectiveModelElementImpl::applyContainer(ReflectiveSlot const& slot,
                                                ModelElement const& container)
{
    Feature const opposite = Feature(slot.property()).opposite();
    makeUncontained();
    if (!container)
        return;
    basicSetContainer(container.getImpl(), opposite, NO_INDEX);
    _inverseAddThis(container.getImpl(), opposite, /*force=*/true);
}
}  // namespace tarn::kiln
