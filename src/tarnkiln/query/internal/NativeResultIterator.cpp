#include "tarnkiln/query/internal/NativeResultIterator.h"

#include <utility>

namespace tarn::kiln::query {

NativeTarnkilnQuery::NativeResultIterator::NativeResultIterator(internal::NativeResultSet rows)
    : m_rows(std::move(rows))
{}

NativeTarnkilnQuery::NativeResultIterator::~NativeResultIterator() = default;

bool NativeTarnkilnQuery::NativeResultIterator::next(std::vector<ModelElement>& row)
{
    if (m_rows.takeRow(row))
        return true;
    row.assign(m_rows.getInstanceCount(), ModelElement());
    return false;
}
}  // namespace tarn::kiln::query
