/// \file
/// UUIDs that tests can write down.
#pragma once
#include "tarnkiln/kernel/Types.h"

#include <cstdint>

namespace testkit {

/// One UUID for each number.
inline tarn::kiln::UUID uuidOf(std::uint32_t number)
{
    tarn::kiln::UUID result{};
    for (int byte = 0; byte < 4; ++byte)
        result.data[byte] = static_cast<std::uint8_t>(number >> (24 - 8 * byte));
    result.data[15] = 1;
    return result;
}
}  // namespace testkit
