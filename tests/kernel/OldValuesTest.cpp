#include "tarnkiln/support/OldValues.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace {

using tarn::kiln::support::OldValues;

TEST(OldValuesOfSlots, AreAbsentAtFirst)
{
    OldValues const values{};

    EXPECT_EQ(nullptr, values.find<int>(0));
    EXPECT_EQ(nullptr, values.find<int>(7));
}

TEST(OldValuesOfSlots, AreFoundByTheirSlotWhateverTheirType)
{
    OldValues values;
    std::string const text(100, 'x');

    values.keep<int>(3, 30);
    values.keep<std::string>(4, text);
    values.keep<double>(90, 0.5);
    values.keep<bool>(1, true);

    ASSERT_NE(nullptr, values.find<int>(3));
    EXPECT_EQ(30, *values.find<int>(3));
    EXPECT_EQ(text, *values.find<std::string>(4));
    EXPECT_EQ(0.5, *values.find<double>(90));
    EXPECT_TRUE(*values.find<bool>(1));
    EXPECT_EQ(nullptr, values.find<int>(2));
}

TEST(OldValuesOfSlots, GiveWayToALaterOneOfTheSameSlot)
{
    OldValues values;
    values.keep<std::string>(4, "first");
    values.keep<int>(3, 1);

    values.keep<std::string>(4, "second");
    values.keep<int>(3, 2);

    EXPECT_EQ("second", *values.find<std::string>(4));
    EXPECT_EQ(2, *values.find<int>(3));
}

TEST(OldValuesOfSlots, CanBeExchangedWhereTheyStand)
{
    OldValues values;
    values.keep<int>(3, 1);
    int present = 5;

    std::swap(present, *values.find<int>(3));

    EXPECT_EQ(1, present);
    EXPECT_EQ(5, *values.find<int>(3));
}

TEST(OldValuesOfSlots, DieWithTheirList)
{
    auto const small = std::make_shared<int>(1);
    struct Large
    {
        std::shared_ptr<int> share;
        char rest[200];
    };
    {
        OldValues values;
        values.keep<std::unique_ptr<std::shared_ptr<int>>>(
            1, std::make_unique<std::shared_ptr<int>>(small));
        values.keep<std::shared_ptr<int>>(2, small);
        values.keep<Large>(3, Large{small, {}});
        EXPECT_EQ(4, small.use_count());
    }
    {
        OldValues values;
        values.keep<Large>(3, Large{small, {}});
        values.keep<std::unique_ptr<std::shared_ptr<int>>>(
            1, std::make_unique<std::shared_ptr<int>>(small));
        EXPECT_EQ(3, small.use_count());
    }

    EXPECT_EQ(1, small.use_count());
}
}  // namespace
