#include "tarnkiln/kernel/internal/Slabs.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <thread>
#include <vector>

namespace {

using tarn::kiln::internal::Slabs;

constexpr std::size_t SIZE = 64;
constexpr std::size_t NUMBER = 5'000;

/// Each object filled with `mark`.
std::vector<char*> make(Slabs& slabs, char mark)
{
    std::vector<char*> made;
    for (std::size_t i = 0; i < NUMBER; ++i)
    {
        made.push_back(static_cast<char*>(slabs.allocate(SIZE)));
        std::fill_n(made.back(), SIZE, mark);
    }
    return made;
}

/// Gives all back; how many were filled with `mark`.
std::size_t takeBack(std::vector<char*> const& made, char mark)
{
    std::size_t intact = 0;
    for (char* const object : made)
    {
        intact += std::all_of(object, object + SIZE, [mark](char c) { return c == mark; }) ? 1 : 0;
        Slabs::free(object);
    }
    return intact;
}

TEST(SlabsOfThreads, GiveAndTakeObjectsBackOnAnyThread)
{
    Slabs slabs;
    std::vector<char*> const first = make(slabs, 'a');
    std::size_t intactOfFirst = 0;
    std::vector<char*> second;
    std::thread freeing([&] { intactOfFirst = takeBack(first, 'a'); });
    std::thread making([&] { second = make(slabs, 'b'); });
    std::vector<char*> const third = make(slabs, 'c');
    freeing.join();
    making.join();
    EXPECT_EQ(intactOfFirst, NUMBER);
    EXPECT_EQ(takeBack(second, 'b'), NUMBER);
    EXPECT_EQ(takeBack(third, 'c'), NUMBER);
}
}  // namespace
