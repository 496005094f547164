// What reflective elements keep in change records, and how they take it back.
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveStorage.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln {

using internal::isCollection;
using internal::ReflectiveCell;
using internal::ReflectiveCells;
using internal::SlotKind;

ModelElement::Impl::Changes* ReflectiveModelElementImpl::createChanges() const
{
    return new Changes(getUuid(), getModel(), getMetaClass(), layout().getRecordSize());
}

ModelElement::Impl::Storage* ReflectiveModelElementImpl::createStorage() const
{
    return new ReflectiveStorage(*this);
}

/// Several properties may have one index; the record has one bit for them and keeps all.
void ReflectiveModelElementImpl::copyValue(Storage* storage, unsigned long index) const
{
    auto& record = static_cast<ReflectiveStorage&>(*storage);
    for (ReflectiveSlot const& slot : layout().slots())
    {
        if (slot.index() == index && slot.property())
            record.keep(slot, m_cells->get(slot));
    }
}

void ReflectiveModelElementImpl::copyStateFromStorage(Storage* storage)
{
    static_cast<ReflectiveStorage&>(*storage).swapWith(*m_cells);
    ModelElement::Impl::copyStateFromStorage(storage);
}

// ---------------------------------------------------------------------------- the record

using Record = ReflectiveModelElementImpl::ReflectiveStorage;

Record::ReflectiveStorage(ReflectiveModelElementImpl const& element)
    : Storage(element.getUuid(), element.getModel(), element.getMetaClass(),
              element.layout().getRecordSize()),
      m_layout(element.m_cells->layoutHandle())
{}

Record::~ReflectiveStorage()
{
    for (OldCell const& old : m_old)
        old.slot->release(old.cell);
}

Record::OldCell const* Record::find(internal::ReflectiveSlot const& slot) const
{
    auto const found = std::find_if(m_old.begin(), m_old.end(),
                                    [&](OldCell const& old) { return old.slot == &slot; });
    return found == m_old.end() ? nullptr : &*found;
}

void Record::keep(internal::ReflectiveSlot const& slot, ReflectiveCell cell)
{
    if (slot.kind() == SlotKind::Container || find(slot))
        return;
    m_old.reserve(m_old.size() + 1);
    m_old.push_back({&slot, slot.copy(cell)});
}

void Record::swapWith(ReflectiveCells& cells) noexcept
{
    for (OldCell& old : m_old)
    {
        if (!isCollection(old.slot->kind()))
        {
            ReflectiveCell const present = cells.get(*old.slot);
            cells.set(*old.slot, std::exchange(old.cell, present));
            continue;
        }
        AbstractOwnedCollection* const present = cells.getCollection(*old.slot);
        auto* const snapshot = old.cell.pointer<AbstractOwnedCollection>();
        if (present && snapshot)
            present->basicSwapContents(*snapshot);
        else if (present)
            present->basicDropContents();
    }
}

Value Record::getOldValue(meta::Property const& property, ReflectionPrivateTag const& tag) const
{
    if (!property || !getMetaClass() || !getMetaClass()->isATypeOf(property))
        return Storage::getOldValue(property, tag);
    internal::ReflectiveSlot const* const slot = m_layout.get()->find(property);
    if (slot && slot->kind() == SlotKind::Container)
        return oldContainerBy(property);
    OldCell const* const old = slot ? find(*slot) : nullptr;
    if (!old)
        return Value::createEmptyValue(property);
    if (slot->kind() == SlotKind::Reference)
        return Value::createElementValue(property,
                                         ModelElement(old->cell.pointer<ModelElement::Impl>()));
    if (!isCollection(slot->kind()))
        return slot->read(old->cell);

    Value value =
        Value::createCollectionValue(property, old->cell.pointer<AbstractOwnedCollection>());
    if (slot->kind() == SlotKind::References)
        value.setReflective();
    return value;
}

/// The link is in the record of the base: it was this property's, another one's, or none.
Value Record::oldContainerBy(meta::Property const& property) const
{
    bool const wasHeld =
        isContainerChanged() && getOldContainment() == Feature(property).opposite();
    return wasHeld ? Value::createElementValue(property, getOldContainer())
                   : Value::createEmptyValue(property);
}
}  // namespace tarn::kiln
