#include "reader/Utf8.h"

#include <gtest/gtest.h>

#include <string>

using debian::findInvalidUtf8;

namespace {
constexpr std::size_t VALID = std::string_view::npos;
}

TEST(Utf8Check, AcceptsTheFirstAndLastCodePointOfEachLength)
{
    EXPECT_EQ(findInvalidUtf8(""), VALID);
    EXPECT_EQ(findInvalidUtf8("\x01\x7F"), VALID);
    EXPECT_EQ(findInvalidUtf8("\xC2\x80\xDF\xBF"), VALID);
    EXPECT_EQ(findInvalidUtf8("\xE0\xA0\x80\xEF\xBF\xBF"), VALID);
    EXPECT_EQ(findInvalidUtf8("\xF0\x90\x80\x80\xF4\x8F\xBF\xBF"), VALID);
}

TEST(Utf8Check, RefusesOverlongForms)
{
    EXPECT_EQ(findInvalidUtf8("a\xC0\x80"), 1u);
    EXPECT_EQ(findInvalidUtf8("a\xC1\xBF"), 1u);
    EXPECT_EQ(findInvalidUtf8("a\xE0\x9F\xBF"), 1u);
    EXPECT_EQ(findInvalidUtf8("a\xF0\x8F\xBF\xBF"), 1u);
}

TEST(Utf8Check, RefusesSurrogatesAndWhatIsAboveTheLastCodePoint)
{
    EXPECT_EQ(findInvalidUtf8("\xED\x9F\xBF\xED\xA0\x80"), 3u);
    EXPECT_EQ(findInvalidUtf8("\xED\xBF\xBF"), 0u);
    EXPECT_EQ(findInvalidUtf8("\xF4\x90\x80\x80"), 0u);
    EXPECT_EQ(findInvalidUtf8("\xF5\x80\x80\x80"), 0u);
    EXPECT_EQ(findInvalidUtf8("\xFF"), 0u);
}

TEST(Utf8Check, ReportsTheFirstByteOfASequenceThatIsCutOffOrBroken)
{
    EXPECT_EQ(findInvalidUtf8("ab\xC3"), 2u);
    EXPECT_EQ(findInvalidUtf8("ab\xE2\x82"), 2u);
    EXPECT_EQ(findInvalidUtf8("ab\xE2\x82z"), 2u);
    EXPECT_EQ(findInvalidUtf8("ab\x80"), 2u);
}

TEST(Utf8Check, FindsAFaultAtEveryPlaceOfALongAsciiText)
{
    for (std::size_t place = 0; place < 40; ++place)
    {
        std::string text(40, 'x');
        text[place] = '\xE9';

        EXPECT_EQ(findInvalidUtf8(text), place);
    }
}
