#include "tarnkiln/meta/internal/ReflectiveCells.h"

#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/internal/PackedPayload.h"

#include <atomic>
#include <cstring>
#include <new>

namespace tarn::kiln::internal {

static_assert(isInPlace(SlotKind::DateTime) && Packed<boost::posix_time::ptime>::IN_PLACE);
static_assert(!isInPlace(SlotKind::Uuid) && !Packed<UUID>::IN_PLACE);

ReflectiveCells* ReflectiveCells::create(std::byte* place, ReflectiveLayout::Handle const& layout)
{
    std::size_t const bytes = layout.get()->cellBytes();
    std::memset(place - bytes, 0, bytes);
    return new (place - sizeof(ReflectiveCells)) ReflectiveCells(layout);
}

void ReflectiveCells::fill()
{
    if (meta::MetaRegistry::getInstance().hasOwnershipConverters())
    {
        for (ReflectiveSlot const& slot : layout().slots())
        {
            if (isPlain(slot.kind()))
                set(slot, slot.keepInitial());
        }
        return;
    }
    for (ReflectiveSlot const* const slot : layout().sharedInitials())
        set(*slot, *slot->sharedInitial());
    for (ReflectiveSlot const* const slot : layout().ownInitials())
        set(*slot, slot->keepInitial());
}

void ReflectiveCells::destroy()
{
    bool const isTold = meta::MetaRegistry::getInstance().hasOwnershipConverters();
    for (ReflectiveSlot const& slot : layout().slots())
    {
        bool const ownsNothing =
            word(slot) == 0 || (isInPlace(slot.kind()) && state(slot) != CellState::Boxed);
        if ((ownsNothing && !isTold) || slot.kind() == SlotKind::Container)
            continue;
        slot.release(get(slot));
    }
    this->~ReflectiveCells();
}

AbstractOwnedCollection* ReflectiveCells::getCollection(ReflectiveSlot const& slot) const
{
    auto& word = const_cast<ReflectiveCells*>(this)->word(slot);
    return reinterpret_cast<AbstractOwnedCollection*>(
        std::atomic_ref(word).load(std::memory_order_acquire));
}

AbstractOwnedCollection* ReflectiveCells::publish(ReflectiveSlot const& slot,
                                                  std::unique_ptr<AbstractOwnedCollection> made)
{
    std::uint64_t present = 0;
    std::atomic_ref entry(word(slot));
    if (!entry.compare_exchange_strong(present, reinterpret_cast<std::uint64_t>(made.get()),
                                       std::memory_order_acq_rel))
        return reinterpret_cast<AbstractOwnedCollection*>(present);
    return made.release();
}

bool ReflectiveCells::markLoaded(ReflectiveSlot const& slot)
{
    return std::atomic_ref(state(slot)).exchange(CellState::Loaded) != CellState::Loaded;
}
}  // namespace tarn::kiln::internal
