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
/// Open addressing with linear probing over pointers; the key is read through the pointer. Room is
/// kept for elements that were erased and may come back, so that their return allocates nothing.
class ElementRegistry
{
public:
    /// Null if there is none.
    ModelElement::Impl* find(UUID const& id) const
    {
        if (m_size == 0)
            return nullptr;
        for (std::size_t at = home(id);; at = next(at)) {
            ModelElement::Impl* const element = m_table[at];
            if (!element || element->getUuid() == id)
                return element;
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
        while (m_table[at] != element) {
            if (!m_table[at])
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
        std::fill_n(m_table.get(), m_capacity, nullptr);
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
            if (m_table[at])
                visit(m_table[at]);
        }
    }

    /// How many entries a look-up passes in the worst case.
    std::size_t longestProbe() const
    {
        std::size_t longest = 0;
        for (std::size_t at = 0; at < m_capacity; ++at) {
            if (m_table[at])
                longest = std::max(longest,
                                   (at - home(m_table[at]->getUuid())) & (m_capacity - 1));
        }
        return longest;
    }

private:
    /// Depends on all bytes: those of a family of UUIDs often differ in a few only.
    std::size_t home(UUID const& id) const
    {
        constexpr std::uint64_t SPREAD = 0x9E3779B97F4A7C15u;
        std::uint64_t halves[2];
        std::memcpy(halves, id.data, sizeof halves);
        std::uint64_t word = halves[0] ^ std::rotl(halves[1] * SPREAD, 32);
        word ^= word >> 32;
        return static_cast<std::size_t>(word * SPREAD >> m_shift);
    }
    std::size_t next(std::size_t at) const { return (at + 1) & (m_capacity - 1); }
    void place(ModelElement::Impl* element)
    {
        std::size_t at = home(element->getUuid());
        while (m_table[at])
            at = next(at);
        m_table[at] = element;
    }
    /// Moves later entries of the probe sequence up, so that none is cut off from its home.
    void closeGap(std::size_t gap)
    {
        for (std::size_t at = next(gap); m_table[at]; at = next(at)) {
            std::size_t const from = home(m_table[at]->getUuid());
            if (((at - from) & (m_capacity - 1)) >= ((at - gap) & (m_capacity - 1))) {
                m_table[gap] = m_table[at];
                gap = at;
            }
        }
        m_table[gap] = nullptr;
    }
    void reserveFor(std::size_t count)
    {
        if (count * 4 <= m_capacity * 3)
            return;
        std::size_t capacity = m_capacity ? m_capacity * 2 : 16;
        while (count * 4 > capacity * 3)
            capacity *= 2;
        auto old = std::make_unique<ModelElement::Impl*[]>(capacity);
        std::size_t const oldCapacity = m_capacity;
        m_table.swap(old);
        m_capacity = capacity;
        m_shift = 64 - std::countr_zero(capacity);
        for (std::size_t at = 0; at < oldCapacity; ++at) {
            if (old[at])
                place(old[at]);
        }
    }

    std::unique_ptr<ModelElement::Impl*[]> m_table;
    std::size_t m_capacity = 0; ///< A power of two; at most three quarters are used.
    int m_shift = 0;            ///< Leaves as many of 64 bits as a place in the table has.
    std::size_t m_size = 0;
    std::size_t m_mayReturn = 0;
};
} // namespace tarn::kiln::support
