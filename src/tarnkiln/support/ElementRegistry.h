/// \file
/// The table of a model's elements by UUID.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>

namespace tarn::kiln::support {

/// Maps UUIDs to elements, without a share in them.
///
/// Open addressing with linear probing over pointers; the key is read through the pointer. An entry
/// also knows how far it is from its home, so that most of what a probe passes need not be touched.
/// Room is kept for elements that were erased and may come back, so that their return allocates
/// nothing.
class ElementRegistry
{
public:
    /// Null if there is none.
    ModelElement::Impl* find(UUID const& id) const
    {
        if (m_size == 0)
            return nullptr;
        std::size_t distance = 0;
        for (std::size_t at = home(id);; at = next(at), ++distance) {
            Entry const entry = m_table[at];
            if (entry.isFree())
                return nullptr;
            if (entry.mayBeAt(distance) && entry.element()->getUuid() == id)
                return entry.element();
        }
    }
    /// False if the UUID is taken.
    bool insert(ModelElement::Impl* element)
    {
        if (find(element->getUuid()))
            return false;
        reserveFor(m_size + m_mayReturn + 1);
        place(element);
        ++m_size;
        return true;
    }
    /// Erases the entry of `element`, and no other element's of the same UUID.
    void erase(ModelElement::Impl const* element)
    {
        if (m_size == 0)
            return;
        std::size_t at = home(element->getUuid());
        while (m_table[at].element() != element) {
            if (m_table[at].isFree())
                return;
            at = next(at);
        }
        closeGap(at);
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
    template <class Visit>
    void forEach(Visit const& visit) const
    {
        for (std::size_t at = 0; at < m_capacity; ++at) {
            if (!m_table[at].isFree())
                visit(m_table[at].element());
        }
    }

    /// How many entries a look-up passes in the worst case.
    std::size_t longestProbe() const
    {
        std::size_t longest = 0;
        for (std::size_t at = 0; at < m_capacity; ++at) {
            if (!m_table[at].isFree())
                longest = std::max(longest, distanceAt(at));
        }
        return longest;
    }

private:
    /// A pointer to an element, whose low bits tell how many places behind its home it lies.
    class Entry
    {
    public:
        Entry() = default;
        Entry(ModelElement::Impl* element, std::size_t distance)
            : m_bits(reinterpret_cast<std::uintptr_t>(element) | std::min(distance, FAR))
        {
        }

        bool isFree() const { return m_bits == 0; }
        ModelElement::Impl* element() const
        {
            return reinterpret_cast<ModelElement::Impl*>(m_bits & ~std::uintptr_t{FAR});
        }
        /// The distance, if it is less than `FAR`; else `FAR`.
        std::size_t distance() const { return m_bits & FAR; }
        bool mayBeAt(std::size_t distance) const
        {
            return this->distance() == std::min(distance, FAR);
        }

        static constexpr std::size_t FAR = 7;

    private:
        std::uintptr_t m_bits = 0;
    };
    static_assert(alignof(ModelElement::Impl) > Entry::FAR);
    __extension__ using Wide = unsigned __int128;

    /// Depends on all bytes: those of a family of UUIDs often differ in a few only.
    std::size_t home(UUID const& id) const
    {
        constexpr std::uint64_t SPREAD = 0x9E3779B97F4A7C15u;
        std::uint64_t halves[2];
        std::memcpy(halves, id.data, sizeof halves);
        std::uint64_t word = halves[0] ^ std::rotl(halves[1] * SPREAD, 32);
        word ^= word >> 32;
        // The product is a fraction of 2^64, and that fraction of the table is the place.
        return static_cast<std::size_t>(static_cast<Wide>(word * SPREAD) * m_capacity >> 64);
    }
    std::size_t next(std::size_t at) const { return at + 1 == m_capacity ? 0 : at + 1; }
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
        return stepsFrom(home(entry.element()->getUuid()), at);
    }
    void place(ModelElement::Impl* element)
    {
        std::size_t at = home(element->getUuid());
        std::size_t distance = 0;
        for (; !m_table[at].isFree(); at = next(at))
            ++distance;
        m_table[at] = Entry(element, distance);
    }
    /// Moves later entries of the probe sequence up, so that none is cut off from its home.
    void closeGap(std::size_t gap)
    {
        for (std::size_t at = next(gap); !m_table[at].isFree(); at = next(at)) {
            std::size_t const distance = distanceAt(at);
            std::size_t const step = stepsFrom(gap, at);
            if (distance >= step) {
                m_table[gap] = Entry(m_table[at].element(), distance - step);
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
        for (std::size_t at = 0; at < oldCapacity; ++at) {
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
    std::size_t m_capacity = 0; ///< At most four fifths are used.
    std::size_t m_size = 0;
    std::size_t m_mayReturn = 0;
};
} // namespace tarn::kiln::support
