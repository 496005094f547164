#include "tarnkiln/collections/SaturatedBloomFilter.h"

#include <algorithm>

namespace tarn::kiln {

void SaturatedBloomFilter::add(UUID const& uuid)
{
    for (std::uint8_t const byte : uuid.data)
    {
        if (m_counters[byte] != SATURATED)
            ++m_counters[byte];
    }
}

void SaturatedBloomFilter::remove(UUID const& uuid)
{
    for (std::uint8_t const byte : uuid.data)
    {
        if (m_counters[byte] != SATURATED)
            --m_counters[byte];
    }
}

bool SaturatedBloomFilter::contains(UUID const& uuid) const
{
    return std::all_of(std::begin(uuid.data), std::end(uuid.data),
                       [this](std::uint8_t byte) { return m_counters[byte] != 0; });
}
}  // namespace tarn::kiln
