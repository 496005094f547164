/// \file
/// The table of a model's elements by UUID.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>

namespace tarn::kiln::support {

/// Maps UUIDs to elements, without a share in them.
///
/// Open addressing with linear probing over pointers; the key is read through the pointer. An entry
/// also tells some bits of its key's hash, so that a look-up hardly ever touches another element
/// than the one that it is for, and how far it is from its home, so that closing a gap touches
/// none.
///
/// Room is kept for elements that were erased and may come back, so that their return allocates
/// nothing.
class ElementRegistry
{
public:
    /// Null if there is none.
    ModelElement::Impl* find(UUID const& id) const
    {
        return m_size == 0 ? nullptr : m_table[lookUp(id, hashOf(id)).at].element();
    }
    /// Fetches what finding or erasing `id` will need; for one who knows it some steps ahead.
    ///
    /// Not left to the compiler: GCC 12 drops calls of functions that do nothing else.
    [[gnu::always_inline]] void prefetch(UUID const& id) const
    {
        if (m_size != 0)
            __builtin_prefetch(&m_table[home(hashOf(id))], /*rw=*/1);
    }
    /// False if the UUID is taken.
    bool insert(ModelElement::Impl* element)
    {
        reserveFor(m_size + m_mayReturn + 1);
        std::uint64_t const hash = hashOf(element->getUuid());
        Place const place = lookUp(element->getUuid(), hash);
        if (!m_table[place.at].isFree())
            return false;
        m_table[place.at] = Entry(element, hash, place.distance);
        ++m_size;
        return true;
    }
    /// Erases the entry of `element`, and no other element's of the same UUID.
    void erase(ModelElement::Impl const* element)
    {
        if (m_size == 0)
            return;
        Place const place = lookUp(hashOf(element->getUuid()),
                                   [&](Entry entry) { return entry.element() == element; });
        if (m_table[place.at].isFree())
            return;
        closeGap(place.at);
        --m_size;
    }
    bool contains(ModelElement::Impl const* element) const
    {
        return find(element->getUuid()) == element;
    }
    std::size_t size() const { return m_size; }
    void clear()
    {
        std::fill_n(m_table.get(), m_capacity, Entry());
        m_size = 0;
    }

    /// Keeps room for one more element that is about to be erased.
    void reserveReturn()
    {
        reserveFor(m_size + m_mayReturn + 1);
        ++m_mayReturn;
    }
    /// Enters an element whose UUID is free. Allocates nothing if room was kept for its return.
    void insertReturning(ModelElement::Impl* element)
    {
        if (m_mayReturn != 0)
            --m_mayReturn;
        else
            reserveFor(m_size + 1);
        place(element);
        ++m_size;
    }
    /// Nothing that was erased comes back any more.
    void forgetReturns() { m_mayReturn = 0; }

    /// Calls `visit(ModelElement::Impl*)` for each; the table must not change meanwhile.
    template <class Visit> void forEach(Visit const& visit) const
    {
        // No processor foretells which entries are free: some are gathered without asking first.
        constexpr std::size_t AT_ONCE = 64;
        std::array<ModelElement::Impl*, AT_ONCE> present;
        for (std::size_t at = 0; at < m_capacity;)
        {
            std::size_t const end = std::min(at + AT_ONCE, m_capacity);
            std::size_t count = 0;
            for (; at < end; ++at)
            {
                present[count] = m_table[at].element();
                count += m_table[at].isFree() ? 0 : 1;
            }
            std::for_each_n(present.begin(), count, visit);
        }
    }

    /// How many entries a look-up passes in the worst case.
    std::size_t longestProbe() const
    {
        std::size_t longest = 0;
        for (std::size_t at = 0; at < m_capacity; ++at)
        {
            if (!m_table[at].isFree())
                longest = std::max(longest, distanceAt(at));
        }
        return longest;
    }

private:
    /// A pointer to an element with marks in the bits that the pointer can spare: below, how many
    /// places the entry lies behind its home; above, part of the hash. A free one has no bits.
    class Entry
    {
    public:
        Entry() = default;
        Entry(ModelElement::Impl* element, std::uint64_t hash, std::size_t distance)
            : m_bits(reinterpret_cast<std::uintptr_t>(element) | hashMarks(hash) |
                     std::min(distance, FAR))
        {}
        /// The same element in another place.
        Entry movedTo(std::size_t distance) const
        {
            Entry result;
            result.m_bits = (m_bits & ~std::uintptr_t{FAR}) | std::min(distance, FAR);
            return result;
        }

        bool isFree() const { return m_bits == 0; }
        /// Null in a free one.
        ModelElement::Impl* element() const
        {
            return reinterpret_cast<ModelElement::Impl*>(m_bits & ~(HASH_BITS | FAR));
        }
        /// The distance, if it is less than `FAR`; else `FAR`.
        std::size_t distance() const { return m_bits & FAR; }
        /// False only if the key has another hash.
        bool mayBe(std::uint64_t hash) const
        {
            return ((m_bits ^ hashMarks(hash)) & HASH_BITS) == 0;
        }

        static constexpr std::size_t FAR = 7;

    private:
        /// Above all addresses of programs that do not ask for higher ones; none where that is not
        /// so.
#if defined(__x86_64__)
        static constexpr std::uintptr_t HASH_BITS = std::uintptr_t{0xFFFF} << 48;
#else
        static constexpr std::uintptr_t HASH_BITS = 0;
#endif

        /// Not the first bits of the hash, which are much the same in all that have one home.
        static std::uintptr_t hashMarks(std::uint64_t hash)
        {
            return static_cast<std::uintptr_t>(hash << 16) & HASH_BITS;
        }

        std::uintptr_t m_bits = 0;
    };
    /// Where a look-up has ended.
    struct Place
    {
        std::size_t at;
        std::size_t distance;  ///< From the home.
    };
    static_assert(alignof(ModelElement::Impl) > Entry::FAR);
    __extension__ using Wide = unsigned __int128;

    static std::uint64_t wordAt(std::uint8_t const* bytes)
    {
        std::uint64_t word = 0;
        std::memcpy(&word, bytes, sizeof word);
        return word;
    }
    /// Depends on all bytes: those of a family of UUIDs often differ in a few only.
    static std::uint64_t hashOf(UUID const& id)
    {
        constexpr std::uint64_t SPREAD = 0x9E3779B97F4A7C15u;
        std::uint64_t word = wordAt(&id.data[0]) ^ std::rotl(wordAt(&id.data[8]) * SPREAD, 32);
        word ^= word >> 32;
        return word * SPREAD;
    }
    /// The hash is a fraction of 2^64, and that fraction of the table is the place.
    std::size_t home(std::uint64_t hash) const
    {
        return static_cast<std::size_t>(static_cast<Wide>(hash) * m_capacity >> 64);
    }
    std::size_t next(std::size_t at) const
    {
        return at + 1 == m_capacity ? 0 : at + 1;
    }
    /// From one place on to another, which may lie before it.
    std::size_t stepsFrom(std::size_t from, std::size_t to) const
    {
        return to >= from ? to - from : to + m_capacity - from;
    }
    std::size_t distanceAt(std::size_t at) const
    {
        Entry const entry = m_table[at];
        if (entry.distance() < Entry::FAR)
            return entry.distance();
        return stepsFrom(home(hashOf(entry.element()->getUuid())), at);
    }
    /// The first entry from the home of `hash` on that is free or `isWanted(Entry)`.
    template <class IsWanted> Place lookUp(std::uint64_t hash, IsWanted const& isWanted) const
    {
        Place place{home(hash), 0};
        while (!m_table[place.at].isFree() && !isWanted(m_table[place.at]))
        {
            place.at = next(place.at);
            ++place.distance;
        }
        return place;
    }
    /// The entry of that UUID, or the free one that it would take.
    Place lookUp(UUID const& id, std::uint64_t hash) const
    {
        return lookUp(hash, [&](Entry entry) {
            return entry.mayBe(hash) && entry.element()->getUuid() == id;
        });
    }
    /// Enters an element whose UUID is free, and for which there is room.
    void place(ModelElement::Impl* element)
    {
        std::uint64_t const hash = hashOf(element->getUuid());
        Place const place = lookUp(hash, [](Entry) { return false; });
        m_table[place.at] = Entry(element, hash, place.distance);
    }
    /// Moves later entries of the probe sequence up, so that none is cut off from its home.
    void closeGap(std::size_t gap)
    {
        for (std::size_t at = next(gap); !m_table[at].isFree(); at = next(at))
        {
            std::size_t const distance = distanceAt(at);
            std::size_t const step = stepsFrom(gap, at);
            if (distance >= step)
            {
                m_table[gap] = m_table[at].movedTo(distance - step);
                gap = at;
            }
        }
        m_table[gap] = Entry();
    }
    void reserveFor(std::size_t count)
    {
        if (count * 5 <= m_capacity * 4)
            return;
        std::size_t capacity = m_capacity ? larger(m_capacity) : 16;
        while (count * 5 > capacity * 4)
            capacity = larger(capacity);
        auto old = std::make_unique<Entry[]>(capacity);
        std::size_t const oldCapacity = m_capacity;
        m_table.swap(old);
        m_capacity = capacity;
        // An element's UUID is far away: by the time that it is needed it shall have arrived.
        constexpr std::size_t AHEAD = 16;
        for (std::size_t at = 0; at < oldCapacity; ++at)
        {
            if (at + AHEAD < oldCapacity && !old[at + AHEAD].isFree())
                __builtin_prefetch(&old[at + AHEAD].element()->getUuid());
            if (!old[at].isFree())
                place(old[at].element());
        }
    }
    /// The next one of 16, 24, 32, 48, 64, ...
    static std::size_t larger(std::size_t capacity)
    {
        return std::has_single_bit(capacity) ? capacity / 2 * 3 : capacity / 3 * 4;
    }

    std::unique_ptr<Entry[]> m_table;
    std::size_t m_capacity = 0;  ///< At most four fifths are used.
    std::size_t m_size = 0;
    std::size_t m_mayReturn = 0;
};
}  // namespace tarn::kiln::support
