#include "tarnkiln/query/internal/NativeResultSet.h"

#include <iterator>

namespace tarn::kiln::internal {

NativeResultSet::NativeResultSet(std::size_t instances, std::size_t width)
    : m_instances(instances),
      m_width(width)
{}

void NativeResultSet::getRow(std::size_t number, std::vector<ModelElement>& row) const
{
    auto const first = std::next(m_cells.begin(), static_cast<std::ptrdiff_t>(number * m_width));
    row.assign(first, std::next(first, static_cast<std::ptrdiff_t>(m_width)));
}
}  // namespace tarn::kiln::internal
