#include "benchmarks/support/LiveBytes.h"

#include <malloc.h>

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

std::atomic<std::size_t> bytesInUse{0};

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
    bytesInUse.fetch_add(malloc_usable_size(block), std::memory_order_relaxed);
    return block;
}

void operator delete(void* block) noexcept
{
    if (block)
        bytesInUse.fetch_sub(malloc_usable_size(block), std::memory_order_relaxed);
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept
{
    operator delete(block);
}
