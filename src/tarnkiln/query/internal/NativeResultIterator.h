/// \file
/// The cursor over the rows of a native query.
#pragma once
#include "tarnkiln/query/NativeTarnkilnQuery.h"
#include "tarnkiln/query/internal/NativeResultSet.h"

namespace tarn::kiln::query {

class NativeTarnkilnQuery::NativeResultIterator final : public ReflectiveQuery::ResultIterator
{
public:
    explicit NativeResultIterator(internal::NativeResultSet rows);
    ~NativeResultIterator() override;

    bool next(std::vector<ModelElement>& row) override;

private:
    internal::NativeResultSet m_rows;
};
}  // namespace tarn::kiln::query
