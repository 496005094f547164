#include "sill/dtoa/NumberConversion.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <string>
#include <typeinfo>

namespace {

using sill::dtoa::to_ustring;
using sill::dtoa::detail::strtod;
using Limits = std::numeric_limits<double>;

bool returnsWithTheSameBits(double value)
{
    double const result = strtod<char16_t>(to_ustring(value));
    return std::bit_cast<std::uint64_t>(result) == std::bit_cast<std::uint64_t>(value);
}

TEST(NumberToText, IsTheShortestThatReadsBackAsTheSame)
{
    EXPECT_EQ(to_ustring(0.1), u"0.1");
    EXPECT_EQ(to_ustring(1), u"1");
    EXPECT_EQ(to_ustring(-1.5), u"-1.5");
    EXPECT_EQ(to_ustring(1e22), u"1e+22");
    EXPECT_EQ(to_ustring(1.0 / 3), u"0.3333333333333333");
    EXPECT_EQ(to_ustring(Limits::denorm_min()), u"5e-324");
    EXPECT_EQ(to_ustring(Limits::max()), u"1.7976931348623157e+308");
    EXPECT_EQ(to_ustring(-Limits::min()), u"-2.2250738585072014e-308");
}

TEST(NumberToText, KeepsTheSignOfZero)
{
    EXPECT_EQ(to_ustring(0.0), u"0");
    EXPECT_EQ(to_ustring(-0.0), u"-0");
    EXPECT_TRUE(returnsWithTheSameBits(0.0));
    EXPECT_TRUE(returnsWithTheSameBits(-0.0));
}

TEST(NumberToText, NamesTheSpecialValues)
{
    EXPECT_EQ(to_ustring(Limits::quiet_NaN()), u"NaN");
    EXPECT_EQ(to_ustring(-Limits::quiet_NaN()), u"NaN");
    EXPECT_EQ(to_ustring(Limits::infinity()), u"Infinity");
    EXPECT_EQ(to_ustring(-Limits::infinity()), u"-Infinity");
}

TEST(TextToNumber, ReadsTheSpecialValues)
{
    EXPECT_TRUE(std::isnan(strtod<char16_t>(u"NaN")));
    EXPECT_EQ(strtod<char16_t>(u"Infinity"), Limits::infinity());
    EXPECT_EQ(strtod<char16_t>(u"-Infinity"), -Limits::infinity());
}

TEST(TextToNumber, BringsBackTheLimits)
{
    for (double const value :
         {Limits::max(), Limits::lowest(), Limits::min(), Limits::epsilon(), Limits::denorm_min(),
          -Limits::denorm_min(), std::nextafter(Limits::min(), 0.0)})
        EXPECT_TRUE(returnsWithTheSameBits(value)) << value;
}

TEST(TextToNumber, BringsBackRandomBitPatterns)
{
    auto const anyBits =
        rc::gen::noShrink(rc::gen::resize(100, rc::gen::arbitrary<std::uint64_t>()));
    EXPECT_TRUE(rc::check([&] {
        for (int i = 0; i < 100; ++i)
        {
            double const value = std::bit_cast<double>(*anyBits);
            RC_ASSERT(std::isnan(value) || returnsWithTheSameBits(value));
        }
    }));
}

TEST(TextToNumber, ReadsOtherSpellingsOfNumbers)
{
    EXPECT_EQ(strtod<char16_t>(u"007.50"), 7.5);
    EXPECT_EQ(strtod<char16_t>(u"+1.5"), 1.5);
    EXPECT_EQ(strtod<char16_t>(u".5"), 0.5);
    EXPECT_EQ(strtod<char16_t>(u"5."), 5);
    EXPECT_EQ(strtod<char16_t>(u"1E3"), 1000);
    EXPECT_EQ(strtod<char16_t>(u"1e+3"), 1000);
    EXPECT_EQ(strtod<char16_t>(std::u16string(400, u'0') + u"1"), 1);
}

TEST(TextToNumber, RefusesWhatIsNoNumber)
{
    for (std::u16string const text :
         {u"",          u" 1",        u"1 ",     u"\t1",     u"1,5",   u"1/5",
          u"1.5.2",     u"1e",        u"e1",     u"+",       u"-",     u"+-1",
          u"-+1",       u"++1",       u".",      u"0x10",    u"1f",    u"nan",
          u"NAN",       u"-NaN",      u"NaN(1)", u"inf",     u"INF",   u"infinity",
          u"+Infinity", u"Infinity1", u"\u0661", u"1\u0131", u"\uFF11"})
        EXPECT_THROW(strtod<char16_t>(text), std::bad_cast) << testing::PrintToString(text);

    EXPECT_THROW(strtod<char16_t>(std::u16string(u"1\0", 2)), std::bad_cast);
}

TEST(TextToNumber, RefusesWhatNoDoubleCanHold)
{
    EXPECT_THROW(strtod<char16_t>(u"1e309"), std::bad_cast);
    EXPECT_THROW(strtod<char16_t>(u"-1e309"), std::bad_cast);
    EXPECT_THROW(strtod<char16_t>(u"1e-400"), std::bad_cast);
}
}  // namespace
