#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/collections/TotalLess.h"

#include "tests/support/ExpectRaises.h"

#include <boost/date_time/posix_time/posix_time.hpp>

#include <limits>

namespace tarn::kiln {
namespace {

double const NOT_A_NUMBER = std::numeric_limits<double>::quiet_NaN();

template <class T> std::vector<T> listOf(PrimitiveSequence<T> const& sequence)
{
    return {sequence.begin(), sequence.end()};
}

TEST(PrimitiveSequenceSnapshot, KeepsTheOrderAndDuplicates)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());

    sequence.push_back(3);
    sequence.push_back(1);
    sequence.push_back(3);

    EXPECT_EQ(listOf(sequence), (std::vector<int>{3, 1, 3}));
    EXPECT_EQ(sequence.size(), 3u);
}

TEST(PrimitiveSequenceSnapshot, IgnoresADuplicateIfUnique)
{
    PrimitiveSequence<ustring> sequence(nullptr, /*unique=*/true, Feature());
    sequence.push_back(u"a");
    sequence.push_back(u"b");

    sequence.push_back(u"a");
    auto const place = sequence.insert(sequence.end(), u"a");

    EXPECT_EQ(listOf(sequence), (std::vector<ustring>{u"a", u"b"}));
    EXPECT_EQ(place, sequence.begin()) << "where the equal value is";
}

TEST(PrimitiveSequenceSnapshot, InsertsBeforeAPosition)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(1);
    sequence.push_back(3);

    auto const place = sequence.insert(sequence.begin() + 1, 2);

    EXPECT_EQ(place - sequence.begin(), 1);
    EXPECT_EQ(listOf(sequence), (std::vector<int>{1, 2, 3}));
}

TEST(PrimitiveSequenceSnapshot, InsertsAValueOutOfItself)
{
    PrimitiveSequence<ustring> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(u"a text that is too long to be kept in place");

    for (int round = 0; round < 10; ++round)
        sequence.push_back(*sequence.begin());

    EXPECT_EQ(sequence[10], u"a text that is too long to be kept in place");
}

TEST(PrimitiveSequenceSnapshot, ErasesAtAPositionAndGoesOnBehindIt)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(1);
    sequence.push_back(2);

    auto const next = sequence.erase(sequence.begin());

    ASSERT_EQ(next, sequence.begin());
    EXPECT_EQ(*next, 2);
    auto const last = sequence.erase(next);
    EXPECT_EQ(last, sequence.end());
    EXPECT_TRUE(sequence.empty());
}

TEST(PrimitiveSequenceSnapshot, RemovesTheFirstOfEqualValues)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());
    for (int const value : {1, 2, 1, 3})
        sequence.push_back(value);

    sequence.remove(1);
    EXPECT_EQ(listOf(sequence), (std::vector<int>{2, 1, 3}));

    sequence.remove(9);
    EXPECT_EQ(sequence.size(), 3u);
}

TEST(PrimitiveSequenceSnapshot, OverwritesAnEntry)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(1);
    sequence.push_back(2);

    sequence.replace(0, 2);

    EXPECT_EQ(listOf(sequence), (std::vector<int>{2, 2}));
}

TEST(PrimitiveSequenceSnapshot, DoesNotOverwriteWithAValueThatItHoldsIfUnique)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/true, Feature());
    sequence.push_back(1);
    sequence.push_back(2);

    sequence.replace(0, 2);
    sequence.replace(0, 1);
    EXPECT_EQ(listOf(sequence), (std::vector<int>{1, 2}));

    sequence.replace(0, 3);
    EXPECT_EQ(listOf(sequence), (std::vector<int>{3, 2}));
}

TEST(PrimitiveSequenceSnapshot, HoldsPackedBools)
{
    PrimitiveSequence<bool> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(true);
    sequence.push_back(false);

    sequence.replace(1, true);
    sequence.insert(sequence.begin(), false);

    EXPECT_EQ(listOf(sequence), (std::vector<bool>{false, true, true}));
    EXPECT_EQ(sequence.find(true) - sequence.begin(), 1);
}

TEST(PrimitiveSequenceSnapshot, CopiesContentsExactly)
{
    PrimitiveSequence<int> source(nullptr, /*unique=*/false, Feature());
    source.push_back(1);
    source.push_back(1);
    PrimitiveSequence<int> copy(nullptr, /*unique=*/false, Feature());
    copy.push_back(7);

    copy.copyContents(source);
    source.push_back(2);

    EXPECT_EQ(listOf(copy), (std::vector<int>{1, 1}));
}

TEST(PrimitiveSequenceSnapshot, EmptiesItself)
{
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature());
    sequence.push_back(1);

    sequence.clear();
    sequence.clear();

    EXPECT_TRUE(sequence.empty());
}

TEST(PrimitiveSequenceSnapshot, IsASequenceWithAGenericView)
{
    PrimitiveSequence<int> const sequence(nullptr, /*unique=*/false, Feature());

    EXPECT_EQ(sequence.getKind(), 1);
    EXPECT_NE(dynamic_cast<GenericPrimitiveSequenceInterface*>(sequence.getGenericInterface()),
              nullptr);
}

TEST(PrimitiveSetSnapshot, HoldsEachValueOnceAscending)
{
    PrimitiveSet<int> set(nullptr, Feature());

    for (int const value : {3, 1, 3, 2})
        set.insert(value);

    EXPECT_EQ(std::vector<int>(set.begin(), set.end()), (std::vector<int>{1, 2, 3}));
    EXPECT_TRUE(set.contains(2));
}

TEST(PrimitiveSetSnapshot, RemovesAValueAndIgnoresOneThatIsAbsent)
{
    PrimitiveSet<ustring> set(nullptr, Feature());
    set.insert(u"a");
    set.insert(u"b");

    set.erase(u"a");
    set.erase(u"x");
    set.erase(*set.begin());

    EXPECT_TRUE(set.empty());
}

TEST(PrimitiveSetSnapshot, CopiesContentsExactly)
{
    PrimitiveSet<int> source(nullptr, Feature());
    source.insert(1);
    PrimitiveSet<int> copy(nullptr, Feature());
    copy.insert(7);

    copy.copyContents(source);
    source.clear();

    EXPECT_EQ(std::vector<int>(copy.begin(), copy.end()), (std::vector<int>{1}));
}

TEST(PrimitiveSetSnapshot, IsASetWithoutGenericView)
{
    PrimitiveSet<int> const set(nullptr, Feature());

    EXPECT_EQ(set.getKind(), 0);
    EXPECT_EQ(set.getGenericInterface(), nullptr);
}

TEST(PrimitiveSetSnapshot, FindsValuesBesideOneThatIsNotANumber)
{
    PrimitiveSet<double> set(nullptr, Feature());
    set.insert(NOT_A_NUMBER);
    set.insert(2);
    set.insert(-NOT_A_NUMBER);
    set.insert(1);

    EXPECT_EQ(set.size(), 3u) << "all that is not a number is one value";
    EXPECT_TRUE(set.contains(1));
    EXPECT_TRUE(set.contains(2));
    EXPECT_TRUE(set.contains(NOT_A_NUMBER));
    set.erase(NOT_A_NUMBER);
    EXPECT_EQ(set.size(), 2u);
}

TEST(PrimitiveSetSnapshot, HoldsNegativeZeroAndZeroAsOneValue)
{
    PrimitiveSet<double> set(nullptr, Feature());

    set.insert(0.0);
    set.insert(-0.0);

    EXPECT_EQ(set.size(), 1u);
}

TEST(TotalOrder, PutsWhatIsNotANumberBehindInfinity)
{
    support::TotalLess<double> const less;
    double const infinity = std::numeric_limits<double>::infinity();

    EXPECT_TRUE(less(infinity, NOT_A_NUMBER));
    EXPECT_FALSE(less(NOT_A_NUMBER, infinity));
    EXPECT_FALSE(less(NOT_A_NUMBER, NOT_A_NUMBER));
    EXPECT_TRUE(less(-infinity, 0));
}

TEST(TotalOrder, PutsWhatIsNotADateTimeBeforeAllTimes)
{
    support::TotalLess<boost::posix_time::ptime> const less;
    boost::posix_time::ptime const none;
    boost::posix_time::ptime const first(boost::posix_time::neg_infin);
    boost::posix_time::ptime const day(boost::gregorian::date(2024, 2, 29));

    EXPECT_TRUE(less(none, first));
    EXPECT_FALSE(less(first, none));
    EXPECT_FALSE(less(none, none));
    EXPECT_TRUE(less(first, day));
}
}  // namespace
}  // namespace tarn::kiln
