#include "benchmarks/support/LiveBytes.h"

#include <malloc.h>

#include <cstdlib>
#include <new>

namespace {

/// Each thread counts for itself: one count for all would be what threads wait for.
thread_local constinit std::size_t bytesInUse = 0;

void* counted(void* block)
{
    if (!block)
        throw std::bad_alloc();
    bytesInUse += malloc_usable_size(block);
    return block;
}
}  // namespace

std::size_t benchkit::liveBytes()
{
    return bytesInUse;
}

void* operator new(std::size_t size)
{
    return counted(std::malloc(size != 0 ? size : 1));
}

void* operator new(std::size_t size, std::align_val_t alignment)
{
    void* block = nullptr;
    if (posix_memalign(&block, static_cast<std::size_t>(alignment), size != 0 ? size : 1) != 0)
        throw std::bad_alloc();
    return counted(block);
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

void operator delete(void* block, std::align_val_t) noexcept
{
    operator delete(block);
}

void operator delete(void* block, std::size_t, std::align_val_t) noexcept
{
    operator delete(block);
}
