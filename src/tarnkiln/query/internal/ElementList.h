/// \file
/// A list of elements that is filled fast.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

#include <cstddef>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {

/// Takes elements, or does not, without a jump in the program, which a processor would guess wrong
/// for every second element where half of them are wanted.
class ElementList
{
public:
    std::size_t size() const { return m_size; }
    ModelElement::Impl* operator[](std::size_t number) const { return m_cells[number]; }

    /// Takes memory for so many at once, which costs nothing where it isn't used.
    void reserve(std::size_t count) { m_cells.reserve(count); }
    /// So many more can be added.
    void makeRoom(std::size_t count)
    {
        if (m_cells.size() < m_size + count)
            m_cells.resize(m_size + count);
    }
    /// There must be room.
    void addIf(bool isWanted, ModelElement::Impl* element)
    {
        m_cells[m_size] = element;
        m_size += isWanted ? 1 : 0;
    }
    void clear() { m_size = 0; }
    /// Leaves nothing behind.
    std::vector<ModelElement::Impl*> take()
    {
        m_cells.resize(std::exchange(m_size, 0));
        return std::move(m_cells);
    }

private:
    std::vector<ModelElement::Impl*> m_cells;  ///< Behind those that were added, anything.
    std::size_t m_size = 0;
};
}  // namespace tarn::kiln::internal
