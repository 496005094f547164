/// \file
/// The count of those who share an object.
#pragma once
#include <atomic>
#include <cstdint>

#if __has_include(<sys/single_threaded.h>)
#    include <sys/single_threaded.h>
#endif

namespace tarn::kiln::support {

/// Whether no other thread can be at it: always right when it says so.
inline bool isOnlyThread() noexcept
{
#if __has_include(<sys/single_threaded.h>)
    return __libc_single_threaded;
#else
    return false;
#endif
}

/// A count that several threads may change, each step indivisible and sequentially consistent.
///
/// As long as the process has one thread, a step is spared what only other threads could see.
///
/// Threads: any, but for `set`.
class SharedCount
{
public:
    SharedCount() = default;
    explicit SharedCount(std::uint32_t count) : m_count(count) {}

    std::uint32_t get() const noexcept { return m_count.load(); }
    /// For one who is not disturbed by others.
    void set(std::uint32_t count) noexcept { m_count.store(count, std::memory_order_relaxed); }
    void increment() noexcept
    {
        if (isOnlyThread())
            m_count.store(alone() + 1, std::memory_order_relaxed);
        else
            m_count.fetch_add(1);
    }
    /// Whether it was 1.
    bool decrement() noexcept
    {
        if (!isOnlyThread())
            return m_count.fetch_sub(1) == 1;
        std::uint32_t const before = alone();
        m_count.store(before - 1, std::memory_order_relaxed);
        return before == 1;
    }

private:
    std::uint32_t alone() const noexcept { return m_count.load(std::memory_order_relaxed); }

    std::atomic<std::uint32_t> m_count{0};
};
}  // namespace tarn::kiln::support
