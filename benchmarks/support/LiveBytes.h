/// \file
/// How much memory is in use.
#pragma once
#include <cstddef>

namespace benchkit {

/// The bytes that this thread has allocated less those that it has freed, as the allocator rounds
/// them.
///
/// Counted by the replaced `operator new` and `operator delete` of LiveBytes.cpp.
std::size_t liveBytes();
}  // namespace benchkit
