/// \file
/// How much memory is in use.
#pragma once
#include <cstddef>

namespace benchkit {

/// The bytes of all live allocations of the program, as the allocator rounds them.
///
/// Counted by the replaced `operator new` and `operator delete` of LiveBytes.cpp.
std::size_t liveBytes();
}  // namespace benchkit
