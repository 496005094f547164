#include "tarnkiln/kernel/internal/Slabs.h"

#include "tests/support/FailingAllocation.h"

#include <gmock/gmock.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <new>
#include <vector>

namespace {

using tarn::kiln::internal::Slabs;

// Under the address sanitizer, which is to see each object by itself, there are no slabs.
#if !defined(__SANITIZE_ADDRESS__)

using testkit::Failing;
using testkit::FailingAllocation;

/// As many objects as several slabs hold, given back in the end.
class Slab : public testing::Test
{
protected:
    static constexpr std::size_t SIZE = 136;

    ~Slab() override { freeAll(); }

    void freeLast()
    {
        Slabs::free(objects.back());
        objects.pop_back();
    }
    std::byte* add()
    {
        objects.push_back(static_cast<std::byte*>(slabs.allocate(SIZE)));
        return objects.back();
    }
    void add(int number)
    {
        for (int i = 0; i < number; ++i)
            add();
    }
    void freeAll()
    {
        for (std::byte* const object : objects)
            Slabs::free(object);
        objects.clear();
    }

    Slabs slabs;
    std::vector<std::byte*> objects;
};

TEST_F(Slab, HasItsObjectsSideBySide)
{
    std::byte* const first = add();
    EXPECT_EQ(add(), first + SIZE);
    EXPECT_EQ(add(), first + 2 * SIZE);
}

TEST_F(Slab, TakesTheNextObjectWhereOneWas)
{
    add(3);
    std::byte* const gone = objects[1];
    objects.erase(objects.begin() + 1);
    Slabs::free(gone);
    EXPECT_EQ(add(), gone);
}

TEST_F(Slab, OfManyTakesHundredObjectsOfAHundredBytes)
{
    long const before = FailingAllocation::liveBlocks();
    objects.reserve(12'000);
    add(12'000);
    EXPECT_LE(FailingAllocation::liveBlocks() - before, 12'000 / 100);
}

TEST_F(Slab, IsSmallAtFirst)
{
    add();
    std::byte* last = objects.back();
    std::size_t neighbours = 1;
    while (add() == last + SIZE)
    {
        last = objects.back();
        ++neighbours;
    }
    EXPECT_LE(neighbours * SIZE, Slabs::SLAB_SIZE / 8);
}

TEST_F(Slab, GoesWithItsLastObjectIfAnotherHasRoom)
{
    objects.reserve(1'000);
    long const before = FailingAllocation::liveBlocks();
    add(1'000);
    freeAll();
    EXPECT_EQ(FailingAllocation::liveBlocks() - before, 1);
    std::byte* const object = add();
    freeLast();
    EXPECT_EQ(add(), object);
    EXPECT_EQ(FailingAllocation::liveBlocks() - before, 1);
}

TEST_F(Slab, GoesAtTheLatestWithItsOwner)
{
    long const before = FailingAllocation::liveBlocks();
    {
        Slabs others;
        Slabs::free(others.allocate(SIZE));
        EXPECT_EQ(FailingAllocation::liveBlocks() - before, 1);
    }
    EXPECT_EQ(FailingAllocation::liveBlocks(), before);
}

TEST_F(Slab, OfALargeObjectHasNoOther)
{
    long const before = FailingAllocation::liveBlocks();
    void* const large = slabs.allocate(5 * Slabs::SLAB_SIZE);
    void* const other = slabs.allocate(5 * Slabs::SLAB_SIZE);
    EXPECT_EQ(FailingAllocation::liveBlocks() - before, 2);
    Slabs::free(large);
    EXPECT_EQ(FailingAllocation::liveBlocks() - before, 1);
    Slabs::free(other);
    EXPECT_EQ(FailingAllocation::liveBlocks(), before);
}

TEST_F(Slab, ThatCannotBeHadLeavesTheOthersAsTheyAre)
{
    objects.reserve(1'000);
    add();
    bool hasFailed = false;
    while (!hasFailed)
    {
        FailingAllocation const failing(1, Failing::Once);
        try
        {
            add();
        }
        catch (std::bad_alloc const&)
        {
            hasFailed = true;
        }
    }
    std::byte* const last = objects.back();
    freeLast();
    EXPECT_EQ(add(), last);
    add(1);  // a further slab
    EXPECT_NE(objects.back(), last + SIZE);
}

#endif

/// An object that was filled with its number.
struct Filled
{
    std::uint64_t* words;
    std::uint64_t number;
    std::size_t size;

    bool isIntact() const
    {
        return std::all_of(words, words + size / sizeof *words,
                           [this](std::uint64_t word) { return word == number; });
    }
};

RC_GTEST_PROP(Slabs, LetNoObjectTouchAnother, ())
{
    std::size_t const size = 8 * *rc::gen::element<std::size_t>(1, 2, 17, 128, 129, 300);
    auto const slabs = std::make_unique<Slabs>();
    std::vector<Filled> all;
    std::uint64_t number = 0;
    // A number to add, or to free from a place on if it is negative.
    auto const steps = *rc::gen::container<std::vector<int>>(rc::gen::inRange(-300, 300));
    for (int const step : steps)
    {
        for (int i = 0; i < step; ++i)
        {
            auto* const words = static_cast<std::uint64_t*>(slabs->allocate(size));
            std::fill_n(words, size / sizeof *words, ++number);
            all.push_back({words, number, size});
        }
        for (int i = 0; i > step && !all.empty(); --i)
        {
            std::size_t const place = static_cast<std::size_t>(-step) * 7 % all.size();
            RC_ASSERT(all[place].isIntact());
            Slabs::free(all[place].words);
            all.erase(all.begin() + static_cast<std::ptrdiff_t>(place));
        }
    }
    for (Filled const& one : all)
    {
        RC_ASSERT(one.isIntact());
        Slabs::free(one.words);
    }
}
}  // namespace
