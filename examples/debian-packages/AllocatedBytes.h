/// \file
/// How much memory the program has from operator new.
#pragma once
#include <cstddef>

namespace debian {

/// The bytes that were allocated and not freed, as large as the heap made each block, in this
/// program and its libraries. Any thread may ask.
std::size_t allocatedBytes();

}  // namespace debian
