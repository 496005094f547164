#include "tarnkiln/query/AbstractQuery.h"

#include "tarnkiln/query/NativeTarnkilnQuery.h"

namespace tarn::kiln::query {

AbstractQuery::AbstractQuery() : m_query(createNativeQuery()) {}

AbstractQuery::AbstractQuery(Model const& model) : AbstractQuery()
{
    m_query->setModel(model);
}

AbstractQuery::~AbstractQuery() = default;

void AbstractQuery::setResultLimit(unsigned long limit)
{
    m_query->setResultLimit(limit);
}

void AbstractQuery::setResultOffset(unsigned long offset)
{
    m_query->setResultOffset(offset);
}
}  // namespace tarn::kiln::query
