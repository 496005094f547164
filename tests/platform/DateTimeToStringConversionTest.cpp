#include "tarn/utils/DateTimeToStringConversion.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <cstdint>
#include <limits>
#include <string>
#include <typeinfo>

namespace {

using boost::gregorian::date;
using boost::posix_time::hours;
using boost::posix_time::microseconds;
using boost::posix_time::ptime;
using boost::posix_time::time_duration;
using tarn::utils::DateTimeToStringConversion;

std::u16string toText(ptime const& time)
{
    return DateTimeToStringConversion::toUstring(time);
}

ptime fromText(std::u16string const& text)
{
    return DateTimeToStringConversion::fromUstring(text);
}

/// Days are numbered in one sequence; day 0 lies 4713 years before our era.
ptime ticksFromDayZero(std::int64_t ticks)
{
    ptime const epoch(date(1970, 1, 1));
    time_duration const distance(0, 0, 0, 2440588 * hours(24).ticks());
    return (epoch - distance) + time_duration(0, 0, 0, ticks);
}

TEST(DateTimeText, IsExtendedIsoWithAFractionWhereThereIsOne)
{
    EXPECT_EQ(toText(ptime(date(2024, 2, 29))), u"2024-02-29T00:00:00");
    EXPECT_EQ(toText(ptime(date(1999, 12, 31), time_duration(23, 59, 58))), u"1999-12-31T23:59:58");
    EXPECT_EQ(toText(ptime(date(1970, 1, 1), microseconds(1))), u"1970-01-01T00:00:00.000001");
    EXPECT_EQ(toText(ptime(date(1969, 12, 31), hours(24) - microseconds(500000))),
              u"1969-12-31T23:59:59.500000");
}

TEST(DateTimeText, NamesTheSpecialValues)
{
    ptime const none;
    ptime const future(boost::posix_time::pos_infin);
    ptime const past(boost::posix_time::neg_infin);

    EXPECT_EQ(toText(none), u"not-a-date-time");
    EXPECT_EQ(toText(future), u"+infinity");
    EXPECT_EQ(toText(past), u"-infinity");
    EXPECT_TRUE(fromText(u"not-a-date-time").is_not_a_date_time());
    EXPECT_EQ(fromText(u"+infinity"), future);
    EXPECT_EQ(fromText(u"-infinity"), past);
}

TEST(DateTimeText, ReachesTheLimitsOfTheCalendar)
{
    ptime const first(boost::posix_time::min_date_time);
    ptime const last(boost::posix_time::max_date_time);

    EXPECT_EQ(toText(first), u"1400-01-01T00:00:00");
    EXPECT_EQ(toText(last), u"9999-12-31T23:59:59.999999");
    EXPECT_EQ(fromText(toText(first)), first);
    EXPECT_EQ(fromText(toText(last)), last);
}

TEST(DateTimeText, GoesBeyondTheCalendarWithASignedYear)
{
    ptime const after = ptime(date(9999, 12, 31)) + hours(24);
    ptime const dayZero = ticksFromDayZero(0);

    EXPECT_EQ(toText(after), u"+10000-01-01T00:00:00");
    EXPECT_EQ(fromText(u"+10000-01-01T00:00:00"), after);
    EXPECT_EQ(toText(dayZero), u"-4713-11-24T00:00:00");
    EXPECT_EQ(fromText(u"-4713-11-24T00:00:00"), dayZero);
    EXPECT_EQ(toText(dayZero - microseconds(1)), u"-4713-11-23T23:59:59.999999");
    EXPECT_EQ(toText(fromText(u"0000-02-29T12:00:00")), u"0000-02-29T12:00:00");
}

TEST(DateTimeText, ReachesTheEndsOfTheClock)
{
    constexpr std::int64_t LOWEST = std::numeric_limits<std::int64_t>::min();
    constexpr std::int64_t HIGHEST = std::numeric_limits<std::int64_t>::max();

    // The lowest count and the two highest stand for the special values.
    for (std::int64_t const ticks : {LOWEST + 1, HIGHEST - 2})
    {
        ptime const end = ticksFromDayZero(ticks);
        ASSERT_FALSE(end.is_special());
        EXPECT_EQ(fromText(toText(end)), end);
    }
    EXPECT_EQ(toText(ticksFromDayZero(HIGHEST - 2)), u"+287564-12-03T04:00:54.775805");
    EXPECT_EQ(toText(ticksFromDayZero(LOWEST + 1)), u"-296990-11-15T19:59:05.224193");
}

TEST(DateTimeText, AgreesWithTheCalendarOnEveryDayOfFourCenturies)
{
    for (date day(1800, 1, 1); day < date(2201, 1, 1); day += boost::gregorian::days(1))
    {
        auto const parts = day.year_month_day();
        auto const number = [](int value) {
            std::string const digits = std::to_string(value);
            return std::u16string(digits.size() < 2 ? 1 : 0, u'0') +
                   std::u16string(digits.begin(), digits.end());
        };
        std::u16string const expected = number(parts.year) + u"-" + number(parts.month) + u"-" +
                                        number(parts.day) + u"T00:00:00";
        ASSERT_EQ(toText(ptime(day)), expected);
        ASSERT_EQ(fromText(expected), ptime(day));
    }
}

TEST(DateTimeText, BringsBackRandomPointsInTime)
{
    constexpr std::int64_t LOWEST = std::numeric_limits<std::int64_t>::min();
    constexpr std::int64_t HIGHEST = std::numeric_limits<std::int64_t>::max();
    auto const anyTicks = rc::gen::inRange<std::int64_t>(LOWEST + 1, HIGHEST - 1);
    EXPECT_TRUE(rc::check([&] {
        ptime const time = ticksFromDayZero(*rc::gen::resize(100, anyTicks));
        RC_ASSERT(fromText(toText(time)) == time);
    }));
}

TEST(DateTimeText, RefusesWhatItNeverGives)
{
    for (std::u16string const text : {u"",
                                      u"2024",
                                      u"2024-02-29",
                                      u"2024-02-29T",
                                      u"2024-02-29T00:00",  // too short
                                      u" 2024-02-29T00:00:00",
                                      u"2024-02-29T00:00:00 ",
                                      u"2024-02-29T00:00:00Z",
                                      u"2024-02-29 00:00:00",
                                      u"2024-02-29t00:00:00",
                                      u"20240229T000000",
                                      u"2024-2-29T00:00:00",
                                      u"24-02-29T00:00:00",
                                      u"02024-02-29T00:00:00",
                                      u"+2024-02-29T00:00:00",
                                      u"-0000-02-29T00:00:00",
                                      u"+012024-02-29T00:00:00",
                                      u"2023-02-29T00:00:00",
                                      u"1900-02-29T00:00:00",
                                      u"2024-00-01T00:00:00",  // no such day
                                      u"2024-13-01T00:00:00",
                                      u"2024-04-31T00:00:00",
                                      u"2024-01-00T00:00:00",
                                      u"2024-01-01T24:00:00",
                                      u"2024-01-01T00:60:00",
                                      u"2024-01-01T00:00:60",
                                      u"2024-01-01T00:00:00.",
                                      u"2024-01-01T00:00:00.5",
                                      u"2024-01-01T00:00:00,500000",
                                      u"2024-01-01T00:00:00.5000001",
                                      u"2024-01-01T00:00:00.000000",
                                      u"+999999-01-01T00:00:00",
                                      u"-999999-01-01T00:00:00",  // beyond the clock
                                      u"not-a-date",
                                      u"NOT-A-DATE-TIME",
                                      u"infinity",
                                      u"+infinity ",
                                      u"+infin",
                                      u"\u0662\u0660\u0662\u0664-01-01T00:00:00"})
        EXPECT_THROW(fromText(text), std::bad_cast) << testing::PrintToString(text);
}

TEST(DateTimeText, RefusesTheCountsThatStandForSpecialValues)
{
    std::u16string const last =
        toText(ticksFromDayZero(std::numeric_limits<std::int64_t>::max() - 2));
    std::u16string next = last;
    ++next.back();

    EXPECT_THROW(fromText(next), std::bad_cast);
}
}  // namespace
