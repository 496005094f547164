/// \file
/// Memory that runs out when a test wants it to.
///
/// A program that links FailingAllocation.cpp has its own `operator new`.
#pragma once

namespace testkit {

enum class Failing
{
    Once,        ///< One allocation fails, and later ones succeed.
    FromThereOn  ///< So do all later ones.
};

/// While it lives, allocations of this thread fail with `std::bad_alloc` from a given one.
class FailingAllocation
{
public:
    /// \param number  of the first to fail, counted from 1.
    FailingAllocation(unsigned long number, Failing mode);
    ~FailingAllocation();
    FailingAllocation(FailingAllocation const&) = delete;
    FailingAllocation& operator=(FailingAllocation const&) = delete;

    /// Whether any has failed.
    bool hasFailed() const;

    /// How many blocks this thread has allocated and not freed.
    static long liveBlocks();
};
}  // namespace testkit
