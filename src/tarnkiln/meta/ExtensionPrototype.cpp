#include "tarnkiln/meta/ExtensionPrototype.h"

#include <tuple>

namespace tarn::kiln::meta {

int ExtensionPrototype::compareWith(ExtensionPrototype const& other) const
{
    auto const mine = std::tie(m_lower, m_upper, m_isOrdered, m_isUnique, m_name, m_typeName);
    auto const theirs = std::tie(other.m_lower, other.m_upper, other.m_isOrdered, other.m_isUnique,
                                 other.m_name, other.m_typeName);
    return mine < theirs ? -1 : theirs < mine ? 1 : 0;
}
}  // namespace tarn::kiln::meta
