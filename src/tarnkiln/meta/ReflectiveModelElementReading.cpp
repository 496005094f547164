// How reflective elements answer what they hold.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"
#include "tarnkiln/meta/internal/RecentSlots.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"
#include "tarnkiln/support/Field.h"

namespace tarn::kiln {

using internal::SlotKind;

[[gnu::always_inline]] inline internal::ReflectiveSlot const*
ReflectiveModelElementImpl::readableSlot(meta::Property const& property,
                                         ReflectionPrivateTag const& tag) const
{
    Layout const& layout = getCells().layout();
    ReflectiveSlot const* const slot = layout.find(property);
    return slot && layout.mayRead(*slot, tag) ? slot : nullptr;
}

bool ReflectiveModelElementImpl::hasPropertyValue(meta::Property const& property,
                                                  ReflectionPrivateTag const& tag) const
{
    ReflectiveSlot const* const slot = readableSlot(property, tag);
    if (!slot)
        return ModelElement::Impl::hasPropertyValue(property, PUBLIC_ACCESS);
    switch (slot->kind())
    {
    case SlotKind::Container:
        return containerBy(*slot) != nullptr;
    case SlotKind::Reference:
        return cells().target(*slot) && cells().target(*slot)->isLive();
    case SlotKind::References:
        return mayHaveMembers(*slot) && shown(*slot, tag).getGenericInterface()->genericSize() > 0;
    case SlotKind::Values: {
        auto const* const values =
            static_cast<AbstractPrimitiveCollection*>(cells().getCollection(*slot));
        return values && values->size() > 0;
    }
    case SlotKind::Annotations: {
        auto const* const map = static_cast<StringToStringMap*>(cells().getCollection(*slot));
        return map && !map->empty();
    }
    default:
        return property->getLower() != 0 ||
               !slot->holds(cells().get(*slot), Value::createEmptyValue(property));
    }
}

/// Where all is known and the value is a word this calls nothing, and so needs to save no register.
Value ReflectiveModelElementImpl::getPropertyValue(meta::Property const& property,
                                                   ReflectionPrivateTag const& tag) const
{
    getCells().prefetch();
    Layout const& layout = getCells().layout();
    ReflectiveSlot const* const slot = internal::RecentSlots::find(layout, property.getImpl());
    if (!slot || !layout.isKnownToBeReadable(*slot, tag))
        return getUncertainValue(property, tag);
    internal::ReflectiveCell const cell = getCells().get(*slot);
    return slot->isWord(cell) ? slot->readWord(cell) : getOtherValue(*slot, cell, tag);
}

Value ReflectiveModelElementImpl::getUncertainValue(meta::Property const& property,
                                                    ReflectionPrivateTag const& tag) const
{
    ReflectiveSlot const* const slot =
        internal::RecentSlots::findFirst(layout(), property.getImpl());
    if (!slot || !layout().mayRead(*slot, tag))
        return ModelElement::Impl::getPropertyValue(
            property, meta::Extension::cast(property) ? tag : PUBLIC_ACCESS);
    internal::ReflectiveCell const cell = getCells().get(*slot);
    return slot->isWord(cell) ? slot->readWord(cell) : getOtherValue(*slot, cell, tag);
}

/// The value of a slot that is read in more steps than one.
Value ReflectiveModelElementImpl::getOtherValue(ReflectiveSlot const& slot,
                                                internal::ReflectiveCell cell,
                                                ReflectionPrivateTag const& tag) const
{
    meta::Property const& property = slot.property();
    if (internal::isPlain(slot.kind()))
        return slot.read(cell);
    switch (slot.kind())
    {
    case SlotKind::Container:
        return valueOf(slot, ModelElement(containerBy(slot)));
    case SlotKind::Reference:
        return valueOf(slot, ModelElement(target(slot, tag)));
    case SlotKind::References: {
        Value value = Value::createCollectionValue(property, &shown(slot, tag));
        value.setReflective();
        return value;
    }
    default:
        return Value::createCollectionValue(property, made(slot));
    }
}

/// The value of a reference to `element`.
Value ReflectiveModelElementImpl::valueOf(ReflectiveSlot const& slot,
                                          ModelElement const& element) const
{
    SlotFacts const facts = layout().factsOf(slot);
    return facts.isTypeKept && facts.isTypedByElements
               ? support::PayloadAccess::makeOfElement(slot.type(), element)
               : Value::createElementValue(slot.property(), element);
}

// ---------------------------------------------------------------------------- references

/// The container, if it holds this element in the very property that is the opposite.
ModelElement::Impl* ReflectiveModelElementImpl::containerBy(ReflectiveSlot const& slot) const
{
    Feature const opposite = layout().factsOf(slot).opposite;
    return opposite && getContainment() == opposite ? basicContainer() : nullptr;
}

ModelElement::Impl* ReflectiveModelElementImpl::target(ReflectiveSlot const& slot,
                                                       ReflectionPrivateTag const& tag) const
{
    ModelElement::Impl* const present = cells().target(slot);
    Model::Impl const* const model = present && present->isProxy() ? getModelImpl() : nullptr;
    if (!model || tag == NO_PROXY_RESOLVE)
        return present;
    bool const mayLoad = !(tag == IN_MEMORY_ONLY);
    ModelElement const proxy(present);
    ModelElement const found =
        mayLoad ? model->resolveProxy(this, proxy) : model->peekResolveProxy(this, proxy);
    if (!found || found->isProxy())
        return cells().target(slot);
    internal::SlotFacts const facts = layout().factsOf(slot);
    meta::Class const& metaClass = found->getMetaClass();
    bool const isOfType =
        metaClass && metaClass->isA(facts.isTypeKept ? slot.type() : slot.property()->getType());
    if (!isOfType)
        return cells().target(slot);
    if (facts.opposite && !facts.isComposite &&
        !_inverseContainsThis(found.getImpl(), facts.opposite))
        return cells().target(slot);
    if (cells().target(slot) == present)  // loading may have changed it
        cells().setTarget(slot, found);
    return cells().target(slot);
}

bool ReflectiveModelElementImpl::refersTo(ReflectiveSlot const& slot,
                                          ModelElement const& element) const
{
    ModelElement::Impl* const present = cells().target(slot);
    if (!present || present == element.getImpl())
        return present != nullptr;
    return present->isProxy() && getModelImpl() &&
           getModelImpl()->peekResolveProxy(this, ModelElement(present)) == element;
}

ModelElement::Impl* ReflectiveModelElementImpl::basicGetReference(Slot const& slot) const
{
    ReflectiveSlot const* const own = layout().findByIndex(slot.index);
    if (own && own->kind() == SlotKind::Reference)
        return cells().target(*own);
    return own && own->kind() == SlotKind::Container ? containerBy(*own) : nullptr;
}

std::vector<ModelElement> ReflectiveModelElementImpl::referred(ReflectiveSlot const& slot) const
{
    switch (slot.kind())
    {
    case SlotKind::Container:
        return {ModelElement(containerBy(slot))};
    case SlotKind::Reference:
        return {ModelElement(target(slot, PRIVILEGED_ACCESS))};
    case SlotKind::References:
        return shown(slot, PRIVILEGED_ACCESS).getAllValues();
    default:
        return {};
    }
}

void ReflectiveModelElementImpl::visitReferences(ReferenceVisitor const& visit) const
{
    for (ReflectiveSlot const& slot : layout().slots())
    {
        if (slot.kind() == SlotKind::Reference && cells().target(slot))
            visit(ModelElement(cells().target(slot)), slot.property());
        for (ModelElement const& member : members(slot))
            visit(member, slot.property());
    }
}

// ---------------------------------------------------------------------------- collections

AbstractOwnedCollection* ReflectiveModelElementImpl::made(ReflectiveSlot const& slot) const
{
    if (AbstractOwnedCollection* const present = cells().getCollection(slot))
        return present;
    auto* const self = const_cast<ReflectiveModelElementImpl*>(this);
    return cells().publish(slot, slot.makeCollection(self));
}

bool ReflectiveModelElementImpl::mayHaveMembers(ReflectiveSlot const& slot) const
{
    return cells().getCollection(slot) || support::hasDataSource(*this);
}

ReferenceCollection& ReflectiveModelElementImpl::loaded(ReflectiveSlot const& slot) const
{
    auto* const collection = static_cast<ReferenceCollection*>(made(slot));
    if (cells().get(slot).state != internal::CellState::Loaded && cells().markLoaded(slot))
        _loadCollectionContents(collection);
    return *collection;
}

/// Stand-ins that a set or a map keeps aside give way to their targets, if these are there by now.
ReferenceCollection& ReflectiveModelElementImpl::shown(ReflectiveSlot const& slot,
                                                       ReflectionPrivateTag const& tag) const
{
    if (tag == IN_MEMORY_ONLY)
        return *static_cast<ReferenceCollection*>(made(slot));
    ReferenceCollection& collection = loaded(slot);
    bool const keepsProxiesAside = !collection.getGenericInterface()->isSequenceInterface();
    if (keepsProxiesAside && !(tag == NO_PROXY_RESOLVE) && getModelImpl() &&
        !getModelImpl()->isParsing())
        collection.resolveAll();
    return collection;
}

std::vector<ModelElement> ReflectiveModelElementImpl::members(ReflectiveSlot const& slot) const
{
    if (slot.kind() != SlotKind::References)
        return {};
    auto const* const present = static_cast<ReferenceCollection*>(cells().getCollection(slot));
    return present ? present->getAllValuesAndProxies() : std::vector<ModelElement>();
}

AbstractOwnedCollection*
ReflectiveModelElementImpl::instantiateCollection(meta::Property const& property, bool owned) const
{
    auto* const owner = owned ? const_cast<ReflectiveModelElementImpl*>(this) : nullptr;
    ReflectiveSlot const* const slot = layout().find(property);
    if (slot && slot->kind() == SlotKind::References)
        return slot->makeCollection(owner).release();
    return internal::ReferenceCollectionRecipe(property).make(owner).release();
}

AbstractOwnedCollection*
ReflectiveModelElementImpl::instantiatePrimitiveCollection(meta::Property const& property,
                                                           bool owned) const
{
    auto* const owner = owned ? const_cast<ReflectiveModelElementImpl*>(this) : nullptr;
    return meta::MetaRegistry::getInstance().instantiateDynamicCollection(ModelElement(owner),
                                                                          property);
}

// ---------------------------------------------------------------------------- keys

Value ReflectiveModelElementImpl::unwrapKey(Value const& value)
{
    if (value.getFlags() > ValueFlags::Single || !internal::classImpl(value.getType()))
        return value;
    ModelElement const element = value.getValue<ModelElement>();
    return Value(meta::StandardTypes::uuidMeta, element ? element->getUuid() : UUID());
}

void ReflectiveModelElementImpl::checkUniqueness(ModelElement const& owner,
                                                 meta::Property const& collectionProperty,
                                                 Value const& key)
{
    if (!collectionProperty->isQualificationUnique() || !owner)
        return;
    Value const value = owner->getPropertyValue(collectionProperty, PRIVILEGED_ACCESS);
    GenericCollectionInterface* const collection =
        value.getValue<ReferenceCollection&>().getGenericInterface();
    if (collection->isMapInterface() &&
        static_cast<GenericMapInterface*>(collection)->genericFind(key))
        reportException(tarnkiln::messages::UniquenessConstraint());
}
}  // namespace tarn::kiln
