/// \file
/// Rows by the hash of a key.
#pragma once
#include <algorithm>
#include <bit>
#include <cstddef>
#include <vector>

namespace tarn::kiln::internal {

/// Finds the rows that may have a key, in ascending order.
///
///     RowIndex index(rows);
///     for (std::size_t row = rows; row-- > 0;)
///         index.addBefore(row, hashOf(row));
///     for (std::size_t row = index.first(hash); row != RowIndex::NONE; row = index.next(row))
///         ...  // the key of the row may be another one
class RowIndex
{
public:
    static constexpr std::size_t NONE = ~std::size_t{0};

    explicit RowIndex(std::size_t rows)
        : m_firsts(std::max(std::bit_ceil(rows + 1), LEAST), NONE),
          m_nexts(rows, NONE)
    {}

    /// Rows must be added from the last to the first.
    void addBefore(std::size_t row, std::size_t hash)
    {
        std::size_t& first = m_firsts[place(hash)];
        m_nexts[row] = first;
        first = row;
    }
    std::size_t first(std::size_t hash) const { return m_firsts[place(hash)]; }
    std::size_t next(std::size_t row) const { return m_nexts[row]; }

private:
    /// So many that few places lead to a row, where few rows are sought for many keys.
    static constexpr std::size_t LEAST = 256;

    /// Spreads hashes that differ in high bits only, as those of addresses and numbers may.
    std::size_t place(std::size_t hash) const
    {
        std::size_t const mixed = hash * 0x9E3779B97F4A7C15u;
        return (mixed ^ mixed >> 32) & (m_firsts.size() - 1);
    }

    std::vector<std::size_t> m_firsts;  ///< As many as a power of two.
    std::vector<std::size_t> m_nexts;
};
}  // namespace tarn::kiln::internal
