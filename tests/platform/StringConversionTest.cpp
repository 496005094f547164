#include "sill/i18n/StringConversion.h"

#include <gtest/gtest.h>
#include <rapidcheck.h>

#include <string>
#include <vector>

namespace {

using sill::i18n::to_string;
using sill::i18n::to_ustring;

std::string bytes(std::initializer_list<int> values)
{
    return std::string(values.begin(), values.end());
}

TEST(ToUstring, ReadsWellFormedUtf8OfEveryLength)
{
    EXPECT_EQ(to_ustring(""), u"");
    EXPECT_EQ(to_ustring(std::string("a\0\x7F", 3)), std::u16string(u"a\0\u007F", 3));
    EXPECT_EQ(to_ustring("\u0080\u07FF"), u"\u0080\u07FF");
    EXPECT_EQ(to_ustring("\u0800\uD7FF\uE000\uFFFF"), u"\u0800\uD7FF\uE000\uFFFF");
    EXPECT_EQ(to_ustring("\U00010000\U0010FFFF"), u"\U00010000\U0010FFFF");
}

TEST(ToString, WritesWellFormedUtf8OfEveryLength)
{
    EXPECT_EQ(to_string(u""), "");
    EXPECT_EQ(to_string(std::u16string(u"a\0\u007F", 3)), std::string("a\0\x7F", 3));
    EXPECT_EQ(to_string(u"\u0080\u07FF"), "\u0080\u07FF");
    EXPECT_EQ(to_string(u"\u0800\uD7FF\uE000\uFFFF"), "\u0800\uD7FF\uE000\uFFFF");
    EXPECT_EQ(to_string(u"\U00010000\U0010FFFF"), "\U00010000\U0010FFFF");
}

TEST(ToUstring, EscapesEachByteThatIsNoUtf8)
{
    using Units = std::u16string;

    EXPECT_EQ(to_ustring(bytes({0x80, 'a', 0xFF})), (Units{0xDC80, u'a', 0xDCFF}));
    EXPECT_EQ(to_ustring(bytes({0xC3})), (Units{0xDCC3})) << "cut off";
    EXPECT_EQ(to_ustring(bytes({0xE2, 0x82, 'x'})), (Units{0xDCE2, 0xDC82, u'x'})) << "cut off";
    EXPECT_EQ(to_ustring(bytes({0xC1, 0xBF})), (Units{0xDCC1, 0xDCBF})) << "overlong";
    EXPECT_EQ(to_ustring(bytes({0xE0, 0x9F, 0xBF})), (Units{0xDCE0, 0xDC9F, 0xDCBF})) << "overlong";
    EXPECT_EQ(to_ustring(bytes({0xF0, 0x8F, 0xBF, 0xBF})), (Units{0xDCF0, 0xDC8F, 0xDCBF, 0xDCBF}))
        << "overlong";
    EXPECT_EQ(to_ustring(bytes({0xF4, 0x90, 0x80, 0x80})), (Units{0xDCF4, 0xDC90, 0xDC80, 0xDC80}))
        << "above U+10FFFF";
    EXPECT_EQ(to_ustring(bytes({0xED, 0xA0, 0x80})), (Units{0xDCED, 0xDCA0, 0xDC80}))
        << "a surrogate";
}

TEST(ToUstring, GoesOnBehindABadLeadByte)
{
    EXPECT_EQ(to_ustring(bytes({0xE2, 0xC3, 0xA9})), (std::u16string{0xDCE2, u'\u00E9'}));
}

TEST(ToString, BringsBackEveryByteAndEveryPairOfBytes)
{
    for (int first = 0; first < 256; ++first)
    {
        std::string const one = bytes({first});
        ASSERT_EQ(to_string(to_ustring(one)), one);
        for (int second = 0; second < 256; ++second)
        {
            std::string const two = bytes({first, second});
            ASSERT_EQ(to_string(to_ustring(two)), two);
        }
    }
}

TEST(ToString, BringsBackEveryByteBeforeAndBehindLongForms)
{
    std::vector<std::string> const neighbours = {"\u00E9", "\u20AC", "\U0001F525",
                                                 bytes({0xED, 0xA0, 0xBD})};
    for (int byte = 0; byte < 256; ++byte)
    {
        for (std::string const& neighbour : neighbours)
        {
            std::string const text = neighbour + bytes({byte}) + neighbour;
            ASSERT_EQ(to_string(to_ustring(text)), text);
        }
    }
}

TEST(ToString, BringsBackRandomBytes)
{
    EXPECT_TRUE(
        rc::check([](std::string const& text) { RC_ASSERT(to_string(to_ustring(text)) == text); }));
}

TEST(ToString, BringsBackRandomMixturesOfPartsOfLongForms)
{
    auto const anyByte = rc::gen::elementOf(bytes(
        {'a', 0x80, 0x8F, 0x90, 0x9F, 0xA0, 0xBF, 0xC1, 0xC3, 0xE0, 0xED, 0xEF, 0xF0, 0xF4, 0xF8}));
    EXPECT_TRUE(rc::check([&] {
        auto const text = *rc::gen::container<std::string>(anyByte);
        RC_ASSERT(to_string(to_ustring(text)) == text);
    }));
}

TEST(ToUstring, BringsBackEveryCodePoint)
{
    for (char32_t code = 0; code <= 0x10FFFF; ++code)
    {
        if (code >= 0xD800 && code <= 0xDFFF)
            continue;
        std::u16string text(1, static_cast<char16_t>(code));
        if (code >= 0x10000)
            text = {static_cast<char16_t>(0xD800 + ((code - 0x10000) >> 10)),
                    static_cast<char16_t>(0xDC00 + (code & 0x3FF))};
        ASSERT_EQ(to_ustring(to_string(text)), text);
    }
}

TEST(ToString, WritesALoneSurrogateAsItsByteOrInThreeBytes)
{
    for (int unit = 0xD800; unit <= 0xDFFF; ++unit)
    {
        bool const standsForByte = unit >= 0xDC80 && unit <= 0xDCFF;
        std::string const expected =
            standsForByte
                ? bytes({unit - 0xDC00})
                : bytes({0xE0 | (unit >> 12), 0x80 | ((unit >> 6) & 0x3F), 0x80 | (unit & 0x3F)});

        ASSERT_EQ(to_string(std::u16string(1, static_cast<char16_t>(unit))), expected) << unit;
        ASSERT_EQ(to_string(to_ustring(expected)), expected) << unit;
    }
}

TEST(ToString, KeepsTheOrderOfSurrogatesThatDoNotPair)
{
    EXPECT_EQ(to_string(std::u16string{0xDE00, 0xD83D}),
              bytes({0xED, 0xB8, 0x80, 0xED, 0xA0, 0xBD}));
    EXPECT_EQ(to_string(std::u16string{0xD83D, 0xD83D, 0xDD25}),
              bytes({0xED, 0xA0, 0xBD, 0xF0, 0x9F, 0x94, 0xA5}));
}
}  // namespace
