#include "tarnkiln/support/SharedCount.h"

#include <gtest/gtest.h>

#include <thread>
#include <vector>

namespace {

using tarn::kiln::support::isOnlyThread;
using tarn::kiln::support::SharedCount;

/// Each time from a count of one, so that it never falls to zero.
void countUpAndDown(SharedCount& count)
{
    for (int i = 0; i < 20000; ++i)
    {
        count.increment();
        EXPECT_FALSE(count.decrement());
    }
}

TEST(ASharedCount, TellsWhenTheLastOneGoes)
{
    SharedCount count;
    EXPECT_EQ(count.get(), 0u);
    count.increment();
    count.increment();
    EXPECT_EQ(count.get(), 2u);

    EXPECT_FALSE(count.decrement());
    EXPECT_TRUE(count.decrement());
    EXPECT_EQ(count.get(), 0u);
}

TEST(ASharedCount, GoesOnFromWhereItIsSet)
{
    SharedCount count(7);
    EXPECT_EQ(count.get(), 7u);
    count.set(0xDEAD);
    count.increment();
    EXPECT_EQ(count.get(), 0xDEAEu);
}

TEST(ASharedCount, LosesNoStepOfSeveralThreads)
{
    SharedCount count(1);
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i)
        threads.emplace_back([&count] {
            EXPECT_FALSE(isOnlyThread());
            countUpAndDown(count);
        });
    countUpAndDown(count);
    for (std::thread& thread : threads)
        thread.join();

    EXPECT_EQ(count.get(), 1u);
    EXPECT_TRUE(count.decrement());
}
}  // namespace
