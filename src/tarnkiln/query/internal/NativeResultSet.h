/// \file
/// The rows of a finished run.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/query/internal/prefetch.h"

#include <cstddef>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {

/// A table of elements, row after row in one block.
class NativeResultSet
{
public:
    /// \param instances  the search instances of the query.
    /// \param width      the columns of a row; not 0.
    NativeResultSet(std::size_t instances, std::size_t width)
        : m_instances(instances),
          m_width(width)
    {}
    NativeResultSet(NativeResultSet&&) = default;
    NativeResultSet& operator=(NativeResultSet&&) = delete;
    ~NativeResultSet()
    {
        for (std::size_t at = 0; at < m_cells.size(); ++at)
        {
            if (at + AHEAD < m_cells.size())
                prefetch(m_cells[at + AHEAD].getImpl());
            ModelElement const dropped(std::move(m_cells[at]));
        }
    }

    void reserve(std::size_t rows) { m_cells.reserve(rows * m_width); }
    /// Rows are given cell by cell.
    void addCell(ModelElement::Impl* element) { m_cells.emplace_back(element); }
    /// All cells at once, where there were none.
    void setCells(std::vector<ModelElement> cells) { m_cells = std::move(cells); }

    std::size_t getInstanceCount() const { return m_instances; }
    std::size_t getRowCount() const { return m_cells.size() / m_width; }
    /// Moves the next row, from the first on, to `row`; false if there is none, and `row` stays.
    bool takeRow(std::vector<ModelElement>& row)
    {
        if (m_taken == m_cells.size())
            return false;
        row.resize(m_width);
        for (ModelElement& cell : row)
            cell = std::move(m_cells[m_taken++]);
        return true;
    }

private:
    std::size_t m_instances;
    std::size_t m_width;
    std::vector<ModelElement> m_cells;
    std::size_t m_taken = 0;  ///< Cells.
};
}  // namespace tarn::kiln::internal
