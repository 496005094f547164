#include "AllocatedBytes.h"

#include <atomic>
#include <cstdlib>
#include <malloc.h>
#include <new>

namespace {

std::atomic<std::size_t> liveBytes = 0;

void* counted(void* block)
{
    if (!block)
        throw std::bad_alloc();
    liveBytes.fetch_add(malloc_usable_size(block), std::memory_order_relaxed);
    return block;
}

void release(void* block) noexcept
{
    if (block)
        liveBytes.fetch_sub(malloc_usable_size(block), std::memory_order_relaxed);
    std::free(block);
}

}  // namespace

std::size_t debian::allocatedBytes()
{
    return liveBytes.load(std::memory_order_relaxed);
}

// The other forms call these, except under the sanitizers, whose own forms for arrays fit each
// other.
void* operator new(std::size_t size)
{
    return counted(std::malloc(size == 0 ? 1 : size));
}
void* operator new(std::size_t size, std::nothrow_t const& /*tag*/) noexcept
{
    void* const block = std::malloc(size == 0 ? 1 : size);
    return block ? counted(block) : nullptr;
}
void* operator new(std::size_t size, std::align_val_t alignment)
{
    auto const step = static_cast<std::size_t>(alignment);
    return counted(std::aligned_alloc(step, (size + step - 1) / step * step));
}
void operator delete(void* block) noexcept
{
    release(block);
}
void operator delete(void* block, std::size_t /*size*/) noexcept
{
    release(block);
}
void operator delete(void* block, std::align_val_t /*alignment*/) noexcept
{
    release(block);
}
void operator delete(void* block, std::size_t /*size*/, std::align_val_t /*alignment*/) noexcept
{
    release(block);
}
