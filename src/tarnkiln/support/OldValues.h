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
    template <class T> void keep(unsigned long slot, T value)
    {
        if (T* const before = find<T>(slot))
            *before = std::move(value);
        else
            m_first = make(slot, std::move(value));
    }
    /// The value for `slot`, which is of the type `T`; null if there is none.
    template <class T> T* find(unsigned long slot)
    {
        for (Entry* entry = m_first; entry; entry = entry->next)
        {
            if (entry->slot == slot)
                return &static_cast<EntryOf<T>*>(entry)->value;
        }
        return nullptr;
    }
    template <class T> T const* find(unsigned long slot) const
    {
        return const_cast<OldValues*>(this)->find<T>(slot);
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
