/// \file
/// A small set of UUIDs that can say "certainly not in here".
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <array>
#include <cstdint>

namespace tarn::kiln {

/// A counting filter by which a long sequence rules out an element without a scan.
///
/// Each of the 16 bytes of a UUID indexes one of 256 counters; UUIDs are random, so they need no
/// hash function. A counter that has reached 255 never comes down again, so the filter may answer
/// true for a UUID that is not in it, but after matching calls of `add` and `remove` it never
/// answers false for one that is.
///
/// Danger: `remove` of a UUID that was never added takes from the counters of others.
///
/// Threads: as the collection that it serves.
class TARNKILN_EXPORT SaturatedBloomFilter
{
public:
    void add(UUID const& uuid);
    /// Takes one `add` back. A counter at 0 wraps to 255 and stays there.
    void remove(UUID const& uuid);
    /// False if `uuid` was certainly not added.
    bool contains(UUID const& uuid) const;

private:
    static constexpr std::uint8_t SATURATED = 255;

    std::array<std::uint8_t, 256> m_counters{};
};
}  // namespace tarn::kiln
