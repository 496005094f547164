/// \file
/// A list that only grows.
#pragma once
#include <array>
#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::support {

/// Keeps its items in blocks: a long one needs hardly more memory than its items, and moves none of
/// them when it grows.
template <class T> class BlockList
{
public:
    std::size_t size() const { return m_size; }
    T& operator[](std::size_t index) { return (*m_blocks[index / BLOCK])[index % BLOCK]; }
    T const& operator[](std::size_t index) const
    {
        return (*m_blocks[index / BLOCK])[index % BLOCK];
    }
    /// Leaves all as it was if memory runs out.
    void push_back(T item)
    {
        if (m_size == m_blocks.size() * BLOCK)
            m_blocks.push_back(std::make_unique<Block>());
        (*this)[m_size] = std::move(item);
        ++m_size;
    }

private:
    static constexpr std::size_t BLOCK = 128;
    using Block = std::array<T, BLOCK>;

    std::vector<std::unique_ptr<Block>> m_blocks;
    std::size_t m_size = 0;
};
}  // namespace tarn::kiln::support
