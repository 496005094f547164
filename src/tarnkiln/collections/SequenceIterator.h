/// \file
/// The iterator of `ElementSequence`.
#pragma once
#include "tarnkiln/collections/SequenceEntries.h"

#include <compare>
#include <cstddef>
#include <cstdint>
#include <iterator>

namespace tarn::kiln {
template <class T> class ElementSequence;

namespace support {

/// A position in an `ElementSequence`, which resolves the entry there when it is read.
///
/// It keeps the entries beside those that it has read at hand, so that walking takes one step an
/// entry. Does not survive a change of the sequence.
template <class T> class SequenceIterator
{
public:
    using iterator_category = std::random_access_iterator_tag;
    using value_type = T;
    using difference_type = std::ptrdiff_t;
    using pointer = T const*;
    using reference = T const&;

    SequenceIterator() = default;
    SequenceIterator(ElementSequence<T> const& sequence, std::size_t index)
        : m_sequence(&sequence),
          m_index(static_cast<difference_type>(index))
    {}

    /// The position, counted from 0.
    std::size_t index() const { return static_cast<std::size_t>(m_index); }

    reference operator*() const
    {
        SequenceEntries const& entries = m_sequence->m_entries;
        if (entries.mayHoldProxies())
            return m_sequence->at(index());
        if (m_version != entries.version() || index() < m_near.begin || index() >= m_near.end)
        {
            m_near = entries.runAt(index());
            m_version = entries.version();
            if (!m_near.first)
                return m_sequence->at(index());
        }
        return static_cast<reference>(m_near.first[index() - m_near.begin]);
    }
    pointer operator->() const { return &**this; }
    reference operator[](difference_type distance) const { return *(*this + distance); }

    SequenceIterator& operator++() { return *this += 1; }
    SequenceIterator& operator--() { return *this -= 1; }
    SequenceIterator operator++(int)
    {
        SequenceIterator const before = *this;
        ++*this;
        return before;
    }
    SequenceIterator operator--(int)
    {
        SequenceIterator const before = *this;
        --*this;
        return before;
    }
    SequenceIterator& operator+=(difference_type distance)
    {
        m_index += distance;
        return *this;
    }
    SequenceIterator& operator-=(difference_type distance) { return *this += -distance; }

    friend SequenceIterator operator+(SequenceIterator position, difference_type distance)
    {
        return position += distance;
    }
    friend SequenceIterator operator+(difference_type distance, SequenceIterator position)
    {
        return position += distance;
    }
    friend SequenceIterator operator-(SequenceIterator position, difference_type distance)
    {
        return position -= distance;
    }
    friend difference_type operator-(SequenceIterator const& left, SequenceIterator const& right)
    {
        return left.m_index - right.m_index;
    }
    friend bool operator==(SequenceIterator const& left, SequenceIterator const& right)
    {
        return left.m_index == right.m_index;
    }
    friend auto operator<=>(SequenceIterator const& left, SequenceIterator const& right)
    {
        return left.m_index <=> right.m_index;
    }

private:
    ElementSequence<T> const* m_sequence = nullptr;
    difference_type m_index = 0;
    mutable SequenceEntries::Run m_near;  ///< Of the entries at `m_version`.
    mutable std::uint32_t m_version = 0;
};
}  // namespace support
}  // namespace tarn::kiln
