/// \file
/// A hash of UUIDs.
#pragma once
#include "tarnkiln/kernel/Types.h"

#include <cstddef>
#include <cstdint>
#include <cstring>

namespace tarn::kiln::internal {

/// Spreads the first eight bytes of a UUID; the version digit among them is not random.
struct UUIDHasher
{
    std::size_t operator()(UUID const& uuid) const noexcept
    {
        std::uint64_t word = 0;
        std::memcpy(&word, uuid.data, sizeof word);
        return word * 0x9E3779B97F4A7C15u;
    }
};
}  // namespace tarn::kiln::internal
