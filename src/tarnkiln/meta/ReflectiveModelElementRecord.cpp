// What reflective elements keep in change records, and how they take it back.
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveStorage.h"

#include <cstdint>

namespace tarn::kiln {

using internal::CellState;
using internal::isCollection;
using internal::ReflectiveCell;
using internal::ReflectiveCells;
using internal::SlotKind;

ModelElement::Impl::Changes* ReflectiveModelElementImpl::createChanges() const
{
    return new Changes(*this, layout().getRecordSize());
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
        if (slot.index() == index && slot.property() && slot.kind() != SlotKind::Container)
            record.keep(slot, cells().get(slot));
    }
}

void ReflectiveModelElementImpl::copyStateFromStorage(Storage* storage)
{
    static_cast<ReflectiveStorage&>(*storage).swapWith(cells());
    ModelElement::Impl::copyStateFromStorage(storage);
}

// ---------------------------------------------------------------------------- the record

using Record = ReflectiveModelElementImpl::ReflectiveStorage;

Record::ReflectiveStorage(ReflectiveModelElementImpl const& element)
    : Storage(element, element.layout().getRecordSize()),
      m_layout(element.cells().layoutHandle())
{}

Record::~ReflectiveStorage()
{
    forEachCell([](ReflectiveSlot const& slot, Word word, std::uint32_t state) {
        slot.release({word, static_cast<CellState>(state)});
    });
}

template <class Visit> void Record::forEachCell(Visit const& visit)
{
    oldValues().forEach<Word>([&](std::uint32_t key, Word& word, std::uint32_t& state) {
        visit(m_layout.get()->slots()[key - 1], word, state);
    });
}

void Record::keep(ReflectiveSlot const& slot, ReflectiveCell cell)
{
    if (oldValues().find<Word>(keyOf(slot)))
        return;
    ReflectiveCell const copy = slot.copy(cell);
    try
    {
        oldValues().keep(keyOf(slot), copy.word, static_cast<std::uint32_t>(copy.state));
    }
    catch (...)
    {
        slot.release(copy);
        throw;
    }
}

void Record::swapWith(ReflectiveCells& cells) noexcept
{
    forEachCell([&](ReflectiveSlot const& slot, Word& word, std::uint32_t& state) {
        if (!isCollection(slot.kind()))
        {
            ReflectiveCell const present = cells.get(slot);
            cells.set(slot, {word, static_cast<CellState>(state)});
            word = present.word;
            state = static_cast<std::uint32_t>(present.state);
            return;
        }
        AbstractOwnedCollection* const present = cells.getCollection(slot);
        auto* const snapshot = reinterpret_cast<AbstractOwnedCollection*>(word);
        if (present && snapshot)
            present->basicSwapContents(*snapshot);
        else if (present)
            present->basicDropContents();
    });
}

Value Record::getOldValue(meta::Property const& property, ReflectionPrivateTag const& tag) const
{
    if (!property || !getMetaClass() || !getMetaClass()->isATypeOf(property))
        return Storage::getOldValue(property, tag);
    ReflectiveSlot const* const slot = m_layout.get()->find(property);
    if (slot && slot->kind() == SlotKind::Container)
        return oldContainerBy(property);
    Word const* const word = slot ? oldValues().find<Word>(keyOf(*slot)) : nullptr;
    if (!word)
        return Value::createEmptyValue(property);
    ReflectiveCell const old{*word, static_cast<CellState>(oldValues().getNote(keyOf(*slot)))};
    if (slot->kind() == SlotKind::Reference)
        return Value::createElementValue(property, ModelElement(old.pointer<ModelElement::Impl>()));
    if (!isCollection(slot->kind()))
        return slot->read(old);

    Value value = Value::createCollectionValue(property, old.pointer<AbstractOwnedCollection>());
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
