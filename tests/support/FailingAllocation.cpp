#include "tests/support/FailingAllocation.h"

#include <cstddef>
#include <cstdlib>
#include <new>

namespace testkit {

namespace {

struct Countdown
{
    unsigned long remaining = 0;  ///< 0: allocations succeed.
    Failing mode = Failing::Once;
    bool failed = false;
    long liveBlocks = 0;
};

thread_local constinit Countdown countdown;

void* allocate(std::size_t size, std::size_t alignment = alignof(std::max_align_t))
{
    if (countdown.remaining != 0 && --countdown.remaining == 0)
    {
        countdown.failed = true;
        if (countdown.mode == Failing::FromThereOn)
            countdown.remaining = 1;
        throw std::bad_alloc();
    }
    void* block = nullptr;
    if (posix_memalign(&block, alignment, size != 0 ? size : 1) != 0)
        throw std::bad_alloc();
    ++countdown.liveBlocks;
    return block;
}

/// `std::stable_sort` and its like take their buffers this way.
void* allocateOrNothing(std::size_t size) noexcept
{
    try
    {
        return allocate(size);
    }
    catch (std::bad_alloc const&)
    {
        return nullptr;
    }
}

void release(void* block)
{
    if (block)
        --countdown.liveBlocks;
    std::free(block);
}

}  // namespace

FailingAllocation::FailingAllocation(unsigned long number, Failing mode)
{
    countdown.mode = mode;
    countdown.failed = false;
    countdown.remaining = number;
}

FailingAllocation::~FailingAllocation()
{
    countdown.remaining = 0;
}

bool FailingAllocation::hasFailed() const
{
    return countdown.failed;
}

long FailingAllocation::liveBlocks()
{
    return countdown.liveBlocks;
}
}  // namespace testkit

// NOLINTBEGIN(misc-definitions-in-headers): these replace the ones of the language
void* operator new(std::size_t size)
{
    return testkit::allocate(size);
}
void* operator new[](std::size_t size)
{
    return testkit::allocate(size);
}
void* operator new(std::size_t size, std::nothrow_t const&) noexcept
{
    return testkit::allocateOrNothing(size);
}
void* operator new[](std::size_t size, std::nothrow_t const&) noexcept
{
    return testkit::allocateOrNothing(size);
}
void* operator new(std::size_t size, std::align_val_t alignment)
{
    return testkit::allocate(size, static_cast<std::size_t>(alignment));
}
void operator delete(void* block) noexcept
{
    testkit::release(block);
}
void operator delete(void* block, std::align_val_t) noexcept
{
    testkit::release(block);
}
void operator delete(void* block, std::size_t, std::align_val_t) noexcept
{
    testkit::release(block);
}
void operator delete[](void* block) noexcept
{
    testkit::release(block);
}
void operator delete(void* block, std::size_t) noexcept
{
    testkit::release(block);
}
void operator delete[](void* block, std::size_t) noexcept
{
    testkit::release(block);
}
// NOLINTEND(misc-definitions-in-headers)
