#include "tarnkiln/kernel/ValuePayload.h"

namespace tarn::kiln {

void ValuePayload::takeObject(ValuePayload& other) noexcept
{
    if (m_functions->isTrivial)
        std::memcpy(m_place, other.m_place, ROOM);
    else
        m_functions->relocate(other.m_place, m_place);
    m_data = m_place;
    other.m_data = nullptr;
}

void ValuePayload::swap(ValuePayload& other) noexcept
{
    ValuePayload kept(std::move(*this));
    m_functions = other.m_functions;
    take(other);
    other.m_functions = kept.m_functions;
    other.take(kept);
}

bool ValuePayload::operator==(ValuePayload const& other) const
{
    if (!m_functions || !m_data || !other.m_data)
        return m_data == other.m_data;
    return m_functions == other.m_functions && m_functions->equals(m_data, other.m_data);
}
}  // namespace tarn::kiln
