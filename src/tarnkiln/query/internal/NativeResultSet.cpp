#include "tarnkiln/query/internal/NativeResultSet.h"

#include <algorithm>

namespace tarn::kiln::internal {

void NativeResultSet::takeRow(std::size_t number, std::vector<ModelElement>& row)
{
    auto const first = m_cells.begin() + static_cast<std::ptrdiff_t>(number * m_width);
    row.resize(m_width);
    std::move(first, first + static_cast<std::ptrdiff_t>(m_width), row.begin());
}
}  // namespace tarn::kiln::internal
