#include "tarnkiln/query/internal/NativeResultSet.h"

#include "tarnkiln/query/internal/prefetch.h"

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
}  // namespace tarn::kiln::internal
