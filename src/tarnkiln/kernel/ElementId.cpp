#include "tarnkiln/kernel/ElementId.h"

#include <utility>

namespace tarn::kiln {

// Before all other static objects, which may use it.
[[gnu::init_priority(101)]] ustring const ElementId::UUID_TYPE = u"uuid";

ElementId::ElementId(ustring type, ustring id) : m_type(std::move(type)), m_id(std::move(id)) {}

int ElementId::compare(ElementId const& other) const
{
    int const byType = m_type.compare(other.m_type);
    return byType != 0 ? byType : m_id.compare(other.m_id);
}
}  // namespace tarn::kiln
