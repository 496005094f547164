#include "tarnkiln/query/internal/NativeResultSet.h"

#include "tarnkiln/query/internal/prefetch.h"

#include <algorithm>

namespace tarn::kiln::internal {

NativeResultSet::~NativeResultSet()
{
    for (std::size_t at = 0; at < m_cells.size(); ++at)
    {
        if (at + AHEAD < m_cells.size())
            prefetch(m_cells[at + AHEAD].getImpl());
        ModelElement const dropped(std::move(m_cells[at]));
    }
}

void NativeResultSet::takeRow(std::size_t number, std::vector<ModelElement>& row)
{
    auto const first = m_cells.begin() + static_cast<std::ptrdiff_t>(number * m_width);
    row.resize(m_width);
    std::move(first, first + static_cast<std::ptrdiff_t>(m_width), row.begin());
}
}  // namespace tarn::kiln::internal
