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
#include "tarnkiln/meta/internal/PayloadAccess.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"
#include "tarnkiln/support/OpenStep.h"
#include "tarnkiln/support/OwnTransaction.h"

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
        : m_transaction(validated(element.getModelImpl())),
          m_step(m_transaction.isSkipped() ? element.getModelImpl() : nullptr)
    {}
    void commit()
    {
        m_step.close();
        m_transaction.commit();
    }

private:
    static Model::Impl* validated(Model::Impl* model)
    {
        model->validateTransaction();
        return model;
    }

    support::OwnTransaction m_transaction;
    support::OpenStep m_step;  ///< Only where there is no transaction.
};

/// What a value holds whose type was found to suit.
ModelElement elementOf(Value const& value)
{
    auto const* const held = support::PayloadAccess::get<ModelElement>(value);
    return held ? *held : value.getValue<ModelElement>();
}
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

    if (internal::isPlain(slot->kind()))
        return setPlain(*slot, value);
    ModelElement const self(this);
    switch (slot->kind())
    {
    case SlotKind::Container:
        return setContainer(*slot, elementOf(value));
    case SlotKind::Reference:
        return setReference(*slot, elementOf(value));
    default:
        return static_cast<StringToStringMap*>(made(*slot))
            ->assign(value.getValue<StringToStringMap&>());
    }
}

/// The slot, if the element has the property, it is single, and `tag` allows to set it.
internal::ReflectiveSlot const*
ReflectiveModelElementImpl::settableSlot(meta::Property const& property,
                                         ReflectionPrivateTag const& tag) const
{
    ReflectiveSlot const* const slot = layout().find(property);
    bool const isSingle =
        slot && slot->kind() != SlotKind::Values && slot->kind() != SlotKind::References;
    return isSingle && layout().factsOf(*slot).maySet(tag) ? slot : nullptr;
}

/// Whether the value is just what the property holds; if not, `checkType` has more to ask.
bool ReflectiveModelElementImpl::isOfType(ReflectiveSlot const& slot, Value const& value) const
{
    internal::SlotFacts const facts = layout().factsOf(slot);
    bool const isShaped = value.getFlags() == ValueFlags::Single ||
                          (value.getFlags() == ValueFlags::OptionalSingle && !facts.isRequired);
    if (!facts.isTypeKept || !isShaped || value.getType() != slot.type())
        return false;
    if (!facts.isTypedByClass)
        return true;
    auto const* const held = support::PayloadAccess::get<ModelElement>(value);
    if (!held || !held->getImpl())
        return held != nullptr;
    meta::Class const& metaClass = held->getImpl()->getMetaClass();
    return metaClass && metaClass->isA(slot.type());
}

void ReflectiveModelElementImpl::checkType(ReflectiveSlot const& slot, Value const& value) const
{
    if (isOfType(slot, value))
        return;
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
    if (!layout().factsOf(slot).opposite.isKeyed())
        return;
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
    if (value.getFlags() == ValueFlags::OptionalSingle && value.isAbsent())
        storePlain(slot, Value::createEmptyValue(slot.property()));
    else
        storePlain(slot, value);
}

void ReflectiveModelElementImpl::storePlain(ReflectiveSlot const& slot, Value const& value)
{
    meta::Property const& property = slot.property();
    if (layout().factsOf(slot).isSetOnce &&
        !slot.holds(cells().get(slot), Value::createEmptyValue(property)))
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    if (slot.holds(cells().get(slot), value))
        return;
    DependentCollections const dependents(*this, slot);
    dependents.check(value);
    if (dependents.isEmpty())
    {
        notifyModifying(slot.index());
        return applyPlain(slot, value);
    }
    ChangeOfSeveral change(*this);
    dependents.leave();
    notifyModifying(slot.index());
    applyPlain(slot, value);
    dependents.enter();
    change.commit();
}

void ReflectiveModelElementImpl::applyPlain(ReflectiveSlot const& slot, Value const& value)
{
    internal::ReflectiveCell const added = slot.keepOwn(value);
    internal::ReflectiveCell const removed = cells().get(slot);
    cells().set(slot, added);
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
    if (!dependents.isEmpty())
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
    internal::SlotFacts const facts = layout().factsOf(slot);
    ModelElement const removed(basicTarget(slot));
    if (removed && facts.opposite)
        _inverseRemoveThis(removed.getImpl(), facts.opposite);
    basicSetTarget(slot, target);
    if (target && facts.opposite)
        _inverseAddThis(target.getImpl(), facts.opposite, /*force=*/false);
    else if (target && facts.isComposite)
        _setContainedByThis(target.getImpl(), slot.property());
    if (removed && !removed->isProxy() && !facts.opposite && facts.isComposite)
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
    if (!dependents.isEmpty())
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
    Feature const opposite = layout().factsOf(slot).opposite;
    makeUncontained();
    if (!container)
        return;
    basicSetContainer(container.getImpl(), opposite, NO_INDEX);
    _inverseAddThis(container.getImpl(), opposite, /*force=*/true);
}
}  // namespace tarn::kiln
