#include "tarnkiln/meta/internal/ReflectiveCells.h"

#include "tarnkiln/collections/AbstractOwnedCollection.h"

#include <atomic>
#include <cstring>
#include <new>

namespace tarn::kiln::internal {

std::size_t ReflectiveCells::sizeFor(std::size_t slots)
{
    return sizeof(ReflectiveCells) + slots * (sizeof(std::uint64_t) + sizeof(CellState));
}

ReflectiveCells::Owner ReflectiveCells::create(ReflectiveLayout::Handle const& layout)
{
    std::size_t const slots = layout.get()->slots().size();
    void* const block = ::operator new(sizeFor(slots));
    Owner cells(new (block) ReflectiveCells(layout));
    std::memset(static_cast<void*>(cells.get() + 1), 0, sizeFor(slots) - sizeof(ReflectiveCells));
    return cells;
}

void ReflectiveCells::destroy(ReflectiveCells* cells)
{
    for (ReflectiveSlot const& slot : cells->layout().slots())
        slot.release(cells->get(slot));
    cells->~ReflectiveCells();
    ::operator delete(cells);
}

AbstractOwnedCollection* ReflectiveCells::getCollection(ReflectiveSlot const& slot) const
{
    std::uint64_t& word = const_cast<ReflectiveCells*>(this)->words()[layout().numberOf(slot)];
    return reinterpret_cast<AbstractOwnedCollection*>(
        std::atomic_ref(word).load(std::memory_order_acquire));
}

AbstractOwnedCollection* ReflectiveCells::publish(ReflectiveSlot const& slot,
                                                  std::unique_ptr<AbstractOwnedCollection> made)
{
    std::uint64_t present = 0;
    auto const word = reinterpret_cast<std::uint64_t>(made.get());
    std::atomic_ref entry(words()[layout().numberOf(slot)]);
    if (!entry.compare_exchange_strong(present, word, std::memory_order_acq_rel))
        return reinterpret_cast<AbstractOwnedCollection*>(present);
    return made.release();
}

bool ReflectiveCells::markLoaded(ReflectiveSlot const& slot)
{
    std::atomic_ref state(states()[layout().numberOf(slot)]);
    return state.exchange(CellState::Loaded) != CellState::Loaded;
}
}  // namespace tarn::kiln::internal
