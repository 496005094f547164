#include "benchmarks/support/LiveBytes.h"

#include <malloc.h>

#include <cstdlib>
#include <new>

namespace {

/// Each thread counts for itself: one count for all would be what threads wait for.
thread_local constinit std::size_t bytesInUse = 0;

}  // namespace

std::size_t benchkit::liveBytes()
{
    return bytesInUse;
}

void* operator new(std::size_t size)
{
    void* const block = std::malloc(size != 0 ? size : 1);
    if (!block)
        throw std::bad_alloc();
    bytesInUse += malloc_usable_size(block);
    return block;
}

void operator delete(void* block) noexcept
{
    if (block)
        bytesInUse -= malloc_usable_size(block);
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept
{
    operator delete(block);
}
