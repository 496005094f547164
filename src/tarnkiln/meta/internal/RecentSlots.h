/// \file
/// How slots are found that were found just before.
#pragma once
#include "tarnkiln/meta/internal/ReflectiveLayout.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace tarn::kiln::internal {

/// The slots that this thread found last, by property.
///
/// To find a slot in the layout of an element takes the element, for which one may have to wait.
/// What was found last is known at once, and the layout only has to confirm it: a processor that
/// takes that for granted goes on to other elements meanwhile.
///
/// Threads: each has its own.
class RecentSlots
{
public:
    /// Null also for one that was not found just before.
    static ReflectiveSlot const* find(ReflectiveLayout const& layout,
                                      meta::Property::Impl const* property)
    {
        Entry const& entry = entries[placeOf(property)];
        bool const isIt =
            entry.layout == layout.id() && entry.slot->property().getImpl() == property;
        return isIt ? entry.slot : nullptr;
    }
    /// As `layout.find(property)`; to be found again by the other function.
    static ReflectiveSlot const* findFirst(ReflectiveLayout const& layout,
                                           meta::Property::Impl const* property)
    {
        ReflectiveSlot const* const slot = layout.find(property);
        if (slot)
            entries[placeOf(property)] = {layout.id(), slot};
        return slot;
    }

private:
    static constexpr std::size_t NUMBER = 8;

    struct Entry
    {
        std::uint64_t layout = 0;  ///< The id of one that may be gone; 0 of none.
        ReflectiveSlot const* slot = nullptr;
    };

    static std::size_t placeOf(meta::Property::Impl const* property)
    {
        return reinterpret_cast<std::uintptr_t>(property) >> 6 & (NUMBER - 1);
    }

    [[gnu::tls_model("initial-exec")]] static constinit thread_local std::array<Entry, NUMBER>
        entries;
};
}  // namespace tarn::kiln::internal
