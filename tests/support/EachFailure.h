/// \file
/// Calls that run out of memory, and one round of a test for each allocation that can fail in it.
#pragma once
#include "tests/support/FailingAllocation.h"
#include "tests/support/Node.h"
#include "tests/support/PlainElement.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <new>
#include <string>

namespace testkit {

/// A call during which the allocation with that number fails, and perhaps all later ones.
struct Attempt
{
    template <class Call> Attempt(unsigned long number, Failing mode, Call const& call)
    {
        FailingAllocation const failing(number, mode);
        try
        {
            call();
        }
        catch (std::bad_alloc const&)
        {
            threw = true;
        }
        failed = failing.hasFailed();
    }

    bool failed = false;  ///< Whether there was such an allocation.
    bool threw = false;
};

/// Calls `round(number, mode)` for each allocation that can fail, until it says that none has.
/// No round may leave anything behind.
template <class Round>
void forEachFailure(Round const& round,
                    std::initializer_list<Failing> modes = {Failing::Once, Failing::FromThereOn})
{
    round(1000000, Failing::Once);  // what is made once for all is made now
    for (Failing const mode : modes)
    {
        for (unsigned long number = 1;; ++number)
        {
            SCOPED_TRACE("allocation " + std::to_string(number) +
                         (mode == Failing::Once ? " fails" : " and all later ones fail"));
            long const nodes = Node::liveCount();
            long const plain = Plain::Impl::inMemory;
            long const blocks = FailingAllocation::liveBlocks();
            bool const failed = round(number, mode);
            long const left = FailingAllocation::liveBlocks() - blocks;
            EXPECT_EQ(nodes, Node::liveCount());
            EXPECT_EQ(plain, Plain::Impl::inMemory);
            EXPECT_EQ(0, left) << "blocks of memory were left behind";
            if (!failed)
                break;
            if (testing::Test::HasFailure())
                return;
        }
    }
}
}  // namespace testkit
