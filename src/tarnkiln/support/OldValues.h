/// \file
/// The values that some slots of one element had at another time.
#pragma once
#include <cstddef>
#include <cstdint>
#include <new>
#include <utility>

namespace tarn::kiln::support {

/// A short list of values by slot, each of a type of its own.
///
/// A record keeps one for the slots that changed, which are few of those that a class has. A first
/// value of eight bytes at most needs no allocation.
class OldValues
{
public:
    OldValues() = default;
    OldValues(OldValues const&) = delete;
    OldValues& operator=(OldValues const&) = delete;
    ~OldValues()
    {
        while (m_first)
        {
            Entry* const released = std::exchange(m_first, m_first->next);
            released->release(released, isInPlace(released));
        }
    }

    /// Keeps `value` for `slot`, in the place of one that was kept before. Always the same `T` for
    /// a slot.
    ///
    /// \param note  a number of the caller's own that goes with the value.
    template <class T> void keep(unsigned long slot, T value, std::uint32_t note = 0)
    {
        if (T* const before = find<T>(slot))
            *before = std::move(value);
        else
            m_first = make(slot, std::move(value));
        entryOf(slot)->note = note;
    }
    /// The value for `slot`, which is of the type `T`; null if there is none.
    template <class T> T* find(unsigned long slot)
    {
        Entry* const entry = entryOf(slot);
        return entry ? &static_cast<EntryOf<T>*>(entry)->value : nullptr;
    }
    template <class T> T const* find(unsigned long slot) const
    {
        return const_cast<OldValues*>(this)->find<T>(slot);
    }

    /// Calls `visit(slot, value, note)` with references to each value but that of slot 0; all are
    /// of the type `T`.
    template <class T, class Visit> void forEach(Visit const& visit)
    {
        for (Entry* entry = m_first; entry; entry = entry->next)
        {
            if (entry->slot != 0)
                visit(entry->slot, static_cast<EntryOf<T>*>(entry)->value, entry->note);
        }
    }
    /// The number that came with the value for `slot`; there must be one.
    std::uint32_t getNote(unsigned long slot) const
    {
        return const_cast<OldValues*>(this)->entryOf(slot)->note;
    }

private:
    struct Entry
    {
        Entry(Entry* following, std::uint32_t ofSlot, void (*releaseThis)(Entry*, bool) noexcept)
            : next(following),
              release(releaseThis),
              slot(ofSlot)
        {}

        Entry* next;
        void (*release)(Entry*, bool inPlace) noexcept;
        std::uint32_t slot;
        std::uint32_t note = 0;
    };
    template <class T> struct EntryOf : Entry
    {
        EntryOf(Entry* following, std::uint32_t ofSlot, T&& kept)
            : Entry(following, ofSlot, &EntryOf::releaseEntry),
              value(std::move(kept))
        {}

        static void releaseEntry(Entry* entry, bool inPlace) noexcept
        {
            auto* const self = static_cast<EntryOf*>(entry);
            if (inPlace)
                self->~EntryOf();
            else
                delete self;
        }

        T value;
    };

    static constexpr std::size_t ROOM = 32;

    Entry* entryOf(unsigned long slot)
    {
        Entry* entry = m_first;
        while (entry && entry->slot != slot)
            entry = entry->next;
        return entry;
    }
    bool isInPlace(Entry const* entry) const
    {
        return static_cast<void const*>(entry) == static_cast<void const*>(m_room);
    }
    template <class T> Entry* make(unsigned long slot, T&& value)
    {
        using Made = EntryOf<T>;
        auto const number = static_cast<std::uint32_t>(slot);
        if constexpr (sizeof(Made) <= ROOM && alignof(Made) <= alignof(Entry))
        {
            if (!m_first)
                return new (m_room) Made(nullptr, number, std::move(value));
        }
        return new Made(m_first, number, std::move(value));
    }

    Entry* m_first = nullptr;
    alignas(Entry) std::byte m_room[ROOM];  ///< For the value that was kept first, if it is small.
};
}  // namespace tarn::kiln::support
