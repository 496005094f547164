// How reflective elements take new values. Each setter tests all that can fail, then leaves the
// collections whose key changes, announces the change, stores, and enters the collections again.
#include "tarnkiln/collections/QualifierKeys.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
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

#include <optional>

namespace tarn::kiln {

using internal::DependentCollections;
using internal::SlotKind;

namespace {

/// Holds a change of several elements together where the model needs no transaction and none is
/// open: else each collection that it reaches would end one of its own, in the middle of the
/// change. Does nothing for a change in silence.
class ChangeOfSeveral
{
public:
    explicit ChangeOfSeveral(ModelElement::Impl const& element)
    {
        if (!internal::isChangedInSilence(*element.getModelImpl()))
            m_bracket.emplace(*element.getModelImpl());
    }
    bool isSilent() const { return !m_bracket; }
    void commit()
    {
        if (m_bracket)
            m_bracket->commit();
    }

private:
    class Bracket
    {
    public:
        explicit Bracket(Model::Impl& model)
            : m_transaction(validated(model)),
              m_step(m_transaction.isSkipped() ? &model : nullptr)
        {}
        void commit()
        {
            m_step.close();
            m_transaction.commit();
        }

    private:
        static Model::Impl* validated(Model::Impl& model)
        {
            model.validateTransaction();
            return &model;
        }

        support::OwnTransaction m_transaction;
        support::OpenStep m_step;  ///< Only where there is no transaction.
    };

    std::optional<Bracket> m_bracket;
};

ModelElement const none;

/// What a value holds whose type was found to suit; lies in the value.
ModelElement const& elementOf(Value const& value)
{
    if (auto const* const held = support::PayloadAccess::get<ModelElement>(value))
        return *held;
    value.checkCompatible<ModelElement>();
    return none;
}

bool hasOneValue(SlotKind kind)
{
    return kind != SlotKind::Values && kind != SlotKind::References;
}
}  // namespace

/// Whether the value is just what the property holds; if not, `checkType` has more to ask.
[[gnu::always_inline]] inline bool ReflectiveModelElementImpl::isOfType(ReflectiveSlot const& slot,
                                                                        SlotFacts const& facts,
                                                                        Value const& value)
{
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
    return metaClass && (metaClass == slot.type() || metaClass->isA(slot.type()));
}

void ReflectiveModelElementImpl::setPropertyValue(meta::Property const& property,
                                                  Value const& value,
                                                  ReflectionPrivateTag const& tag)
{
    Layout const& layout = getCells().layout();
    ReflectiveSlot const* const slot = layout.find(property);
    if (!slot || !hasOneValue(slot->kind()))
        return ModelElement::Impl::setPropertyValue(property, value, tag);
    std::optional<SlotFacts> room;
    SlotFacts const& facts = layout.factsOf(*slot, room);
    if (!facts.maySet(tag))
        return ModelElement::Impl::setPropertyValue(property, value, tag);
    if (!isOfType(*slot, facts, value))
        checkType(*slot, value);
    if (isProxy())
        reportException(tarnkiln::messages::CannotModifyProxy());
    if (!isLive())
        return;

    if (internal::isPlain(slot->kind()))
        return setPlain(*slot, facts, value);
    ModelElement const self(this);
    switch (slot->kind())
    {
    case SlotKind::Container:
        return setContainer(self, *slot, facts, elementOf(value));
    case SlotKind::Reference:
        return setReference(self, *slot, facts, elementOf(value));
    default:
        return static_cast<StringToStringMap*>(made(*slot))
            ->assign(value.getValue<StringToStringMap&>());
    }
}

void ReflectiveModelElementImpl::checkType(ReflectiveSlot const& slot, Value const& value)
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

void ReflectiveModelElementImpl::setPlain(ReflectiveSlot const& slot, SlotFacts const& facts,
                                          Value const& value)
{
    if (setWord(slot, facts, value))
        return;
    if (value.getFlags() == ValueFlags::OptionalSingle && value.isAbsent())
        storePlain(slot, facts, Value::createEmptyValue(slot.property()));
    else
        storePlain(slot, facts, value);
}

/// Stores a value that is kept as nothing but a word, and on which nothing else depends; the same
/// as `storePlain` does, in fewer steps. False if the value is none.
bool ReflectiveModelElementImpl::setWord(ReflectiveSlot const& slot, SlotFacts const& facts,
                                         Value const& value)
{
    internal::ReflectiveCell added;
    if (facts.isSetOnce || !slot.dependents().empty() || !slot.packWord(value, added) ||
        meta::MetaRegistry::getInstance().hasOwnershipConverters())
        return false;
    internal::ReflectiveCell const present = cells().get(slot);
    if (present.isPacked() ? slot.isSameWord(present, added) : slot.holds(present, value))
        return true;
    notifyModifying(slot.index());
    internal::ReflectiveCell const removed = cells().get(slot);
    cells().set(slot, added);
    if (!removed.isPacked())
        slot.release(removed);
    return true;
}

void ReflectiveModelElementImpl::storePlain(ReflectiveSlot const& slot, SlotFacts const& facts,
                                            Value const& value)
{
    meta::Property const& property = slot.property();
    if (facts.isSetOnce && !slot.holds(cells().get(slot), Value::createEmptyValue(property)))
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    if (slot.holds(cells().get(slot), value))
        return;
    DependentCollections const dependents(*this, slot);
    if (dependents.isEmpty())
    {
        notifyModifying(slot.index());
        return replace(slot, slot.keepOwn(value));
    }
    dependents.check(value);
    ChangeOfSeveral change(*this);
    dependents.leave();
    notifyModifying(slot.index());
    replace(slot, slot.keepOwn(value));
    dependents.enter();
    change.commit();
}

void ReflectiveModelElementImpl::replace(ReflectiveSlot const& slot, internal::ReflectiveCell added)
{
    internal::ReflectiveCell const removed = cells().get(slot);
    cells().set(slot, added);
    slot.release(removed);
}

// ---------------------------------------------------------------------------- references

/// The same as `_inverseAddThis` for a property without generated code, in fewer steps.
[[gnu::always_inline]] inline void
ReflectiveModelElementImpl::enterOtherEnd(ModelElement const& self, ModelElement const& target,
                                          Feature const& opposite, bool force)
{
    Model::Impl const* const model = getModelImpl();
    if (!model || model->isParsing())
        _inverseAddThis(target.getImpl(), opposite, force);
    else if (!target->isProxy())
        target->inverseAdd(self, opposite.property());
}

[[gnu::always_inline]] inline void
ReflectiveModelElementImpl::applyReference(ModelElement const& self, ReflectiveSlot const& slot,
                                           SlotFacts const& facts, ModelElement const& target)
{
    ModelElement const removed(cells().target(slot));
    bool const isPaired = !facts.opposite.isNull();  // it is live, or would not be a fact
    if (removed && isPaired)
        _inverseRemoveThis(removed.getImpl(), facts.opposite);
    cells().setTarget(slot, target);
    if (target && isPaired)
        enterOtherEnd(self, target, facts.opposite, /*force=*/false);
    else if (target && facts.isComposite)
        _setContainedByThis(target.getImpl(), slot.property());
    if (removed && !removed->isProxy() && !isPaired && facts.isComposite)
        _basicSetUncontained(removed.getImpl());
}

void ReflectiveModelElementImpl::setReference(ModelElement const& self, ReflectiveSlot const& slot,
                                              SlotFacts const& facts, ModelElement const& target)
{
    meta::Property const& property = slot.property();
    ModelElement::Impl const* present = cells().target(slot);
    if (present && present->isProxy())
        present = this->target(slot, PRIVILEGED_ACCESS);
    if (target.getImpl() == present)
        return;
    if (facts.isSetOnce && present && present->isLive())
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    DependentCollections const dependents(*this, slot);
    if (!dependents.isEmpty())
        dependents.check(Value::createElementValue(property, target));
    if (target)
    {
        if (facts.isOppositeKeyed)
            checkOwnKey(slot, target);
        bool const isNeighbour = !target->isProxy() && target->getModelImpl() == getModelImpl();
        if (!isNeighbour || facts.isComposite)
            checkCompatibleModel(target.getImpl(), property);
    }

    ChangeOfSeveral change(*this);
    dependents.leave();
    if (!change.isSilent())
        notifyModifying(slot.index());
    applyReference(self, slot, facts, target);
    dependents.enter();
    change.commit();
}

// ---------------------------------------------------------------------------- container

[[gnu::always_inline]] inline void
ReflectiveModelElementImpl::applyContainer(ModelElement const& self, SlotFacts const& facts,
                                           ModelElement const& container)
{
    makeUncontained();
    if (!container)
        return;
    basicSetContainer(container.getImpl(), facts.opposite, NO_INDEX);
    enterOtherEnd(self, container, facts.opposite, /*force=*/true);
}

void ReflectiveModelElementImpl::setContainer(ModelElement const& self, ReflectiveSlot const& slot,
                                              SlotFacts const& facts, ModelElement const& container)
{
    meta::Property const& property = slot.property();
    ModelElement::Impl* const present =
        !isTopLevel() && getContainment() == facts.opposite ? basicContainer() : nullptr;
    if (container.getImpl() == present || (!container && !present))
        return;
    if (facts.isSetOnce && present && present->isLive())
        reportException(tarnkiln::messages::CannotSetReadOnlyProperty(property->getName()));
    DependentCollections const dependents(*this, slot);
    if (!dependents.isEmpty())
        dependents.check(Value::createElementValue(property, container));
    if (container)
    {
        if (container->isProxy())
            reportException(tarnkiln::messages::CannotModifyProxy());
        if (facts.isOppositeKeyed)
            checkOwnKey(slot, container);
        checkCircularContainment(container);
        if (container->getModelImpl() != getModelImpl())
            reportException(tarnkiln::messages::CannotChangeModel());
    }

    ChangeOfSeveral change(*this);
    dependents.leave();
    if (!change.isSilent())
        notifyModifying(slot.index());
    applyContainer(self, facts, container);
    dependents.enter();
    change.commit();
}

}  // namespace tarn::kiln
