/// \file
/// Fetching memory before it is needed.
#pragma once
#include <cstddef>

namespace tarn::kiln::internal {

/// How many elements earlier. Elements lie anywhere in memory, and the processor waits for many at
/// a time if it is told of them.
constexpr std::size_t AHEAD = 32;

/// Any address will do, also one where nothing is.
///
/// Functions that do nothing else must be inlined, or the compiler takes their calls for idle.
[[gnu::always_inline]] inline void prefetch(void const* place)
{
    __builtin_prefetch(place);
}
}  // namespace tarn::kiln::internal
