#include "textkit/regex/Pattern.h"
#include "textkit/regex/RegexError.h"
#include "textkit/regex/RegexSearch.h"

#include <gtest/gtest.h>

#include <chrono>
#include <optional>
#include <random>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

namespace {

using testing::HasSubstr;
using textkit::regex::Pattern;
using textkit::regex::regex_search;
using textkit::regex::RegexError;

bool found(std::u16string const& pattern, std::u16string const& subject)
{
    return regex_search(subject, pattern, /*caseSensitive=*/true, /*options=*/0);
}

/// What the search is refused with; empty if it is not.
std::string refusal(std::u16string const& pattern, std::u16string const& subject = u"")
{
    try
    {
        found(pattern, subject);
        return "";
    }
    catch (RegexError const& error)
    {
        return error.what();
    }
}

std::u16string repeated(std::u16string const& part, int times)
{
    std::u16string text;
    for (int i = 0; i < times; ++i)
        text += part;
    return text;
}

/// Runs `search` and gives the seconds that it took.
template <class Search> double secondsOf(Search const& search)
{
    auto const start = std::chrono::steady_clock::now();
    search();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

TEST(RegexSearch, FindsThePatternAnywhere)
{
    EXPECT_TRUE(found(u"kiln", u"tarnkilns"));
    EXPECT_TRUE(found(u"^tarn", u"tarnkiln"));
    EXPECT_TRUE(found(u"kiln$", u"tarnkiln"));
    EXPECT_FALSE(found(u"^kiln", u"tarnkiln"));
    EXPECT_FALSE(found(u"tarn$", u"tarnkiln"));
    EXPECT_TRUE(found(u"", u""));
    EXPECT_TRUE(found(u"", u"x"));
    EXPECT_FALSE(found(u"x", u""));
}

TEST(RegexSearch, KnowsTheUsualSyntax)
{
    EXPECT_TRUE(found(u"^(ab|cd)+$", u"abcdab"));
    EXPECT_TRUE(found(u"^[a-c]{2,3}\\d*$", u"abc12"));
    EXPECT_FALSE(found(u"^[^a-c]$", u"b"));
    EXPECT_TRUE(found(u"^a\\.b\\*$", u"a.b*"));
    EXPECT_FALSE(found(u"^a\\.b$", u"axb"));
    EXPECT_TRUE(found(u"^(.)x\\1$", u"axa"));
    EXPECT_TRUE(found(u"(?<=a)b(?!c)", u"abd"));
    EXPECT_TRUE(found(u"^\\u00e4\\x41$", u"\u00e4A"));
}

TEST(RegexSearch, StopsADotAtLineEnds)
{
    for (std::u16string const lineEnd : {u"\n", u"\r", u"\r\n", u"\u0085", u"\u2028", u"\u2029"})
        EXPECT_FALSE(found(u"a.*b", u"a" + lineEnd + u"b"));
    EXPECT_TRUE(found(u"a.*b", u"a\tb"));
    EXPECT_TRUE(found(u"(?s)a.*b", u"a\nb"));
}

TEST(RegexSearch, AnchorsAtTheVeryEndsOfTheText)
{
    EXPECT_FALSE(found(u"a$", u"a\n"));
    EXPECT_FALSE(found(u"^b", u"a\nb"));
    EXPECT_TRUE(found(u"(?m)^b$", u"a\nb\nc"));
}

TEST(RegexSearch, TellsCasesApartUnlessToldOtherwise)
{
    EXPECT_FALSE(regex_search(u"K\u00c4SE", u"k\u00e4se", true, 0));
    EXPECT_TRUE(regex_search(u"K\u00c4SE", u"k\u00e4se", false, 0));
    EXPECT_FALSE(regex_search(u"KASE", u"k\u00e4se", false, 0));
}

TEST(RegexSearch, TakesASurrogatePairForOneCharacter)
{
    EXPECT_TRUE(found(u"^.$", u"\U0001F600"));
    EXPECT_FALSE(found(u"^..$", u"\U0001F600"));
    EXPECT_TRUE(found(u"^[\U0001F600-\U0001F64F]$", u"\U0001F610"));
    EXPECT_TRUE(found(u"\\p{Lu}", u"\u00c4"));
    EXPECT_FALSE(found(u"\\w", u"\u00c4"));
    EXPECT_FALSE(found(u"\\d", u"\u0663"));
}

TEST(RegexSearch, SearchesTheTextAroundUnpairedSurrogates)
{
    std::u16string const broken = {u'a', 0xD83D, u'b', 0xDE00, u'c', 0xD83D};

    EXPECT_TRUE(found(u"a", broken));
    EXPECT_TRUE(found(u"b", broken));
    EXPECT_TRUE(found(u"c", broken));
    EXPECT_FALSE(found(u"a.b", broken));
    EXPECT_FALSE(found(u"b.*c", broken));
    EXPECT_FALSE(found(u"x", broken));
    EXPECT_FALSE(found(u".", std::u16string(1, 0xDC00)));
}

TEST(RegexSearch, GoesBeyondZeroCharacters)
{
    std::u16string const text(u"a\0b", 3);

    EXPECT_TRUE(found(u"b", text));
    EXPECT_TRUE(found(text, u"x" + text));
    EXPECT_FALSE(found(text, u"ab"));
}

TEST(RegexSearch, RefusesUnknownOptions)
{
    EXPECT_THROW(regex_search(u"a", u"a", true, 1), RegexError);
}

TEST(RegexError, SaysWhatIsWrongAndWhere)
{
    EXPECT_EQ(refusal(u"(ab"), "missing closing parenthesis at 3 of the pattern \"(ab\"");
    EXPECT_EQ(refusal(u"a**+"),
              "quantifier does not follow a repeatable item at 2 of the pattern \"a**+\"");
    EXPECT_THAT(refusal(u"[b-a]"), HasSubstr("range out of order in character class at 3"));
    EXPECT_THAT(refusal(u"ab\\"), HasSubstr("\\ at end of pattern at 3"));
    EXPECT_THAT(refusal(u"(?P<n"), HasSubstr("at 5 of the pattern"));
    EXPECT_THAT(refusal(u"\u00e4("), HasSubstr("of the pattern \"\xc3\xa4(\""));
    EXPECT_THAT(refusal(u"\\C"), HasSubstr("disabled"));
}

TEST(RegexError, TellsThePlaceAsANumber)
{
    auto const placeOf = [](std::u16string const& pattern) -> std::optional<std::size_t> {
        try
        {
            Pattern{pattern};
        }
        catch (RegexError const& error)
        {
            return error.getPlace();
        }
        return std::nullopt;
    };

    EXPECT_EQ(placeOf(u"ab(cd"), 5u);
    EXPECT_EQ(placeOf(std::u16string(70'000, u'a')), std::nullopt);
}

TEST(RegexError, RefusesUnpairedSurrogatesInAPattern)
{
    EXPECT_THAT(refusal({u'a', 0xD83D, u'b'}), HasSubstr("UTF-16 error"));
    EXPECT_THAT(refusal({0xDE00}), HasSubstr("UTF-16 error"));
    EXPECT_THAT(refusal({0xD83D}), HasSubstr("UTF-16 error"));
    EXPECT_THAT(refusal(u"\\ud83d"), HasSubstr("disallowed Unicode code point"));
}

TEST(RegexError, ShowsTheBeginningOfALongPattern)
{
    std::u16string const pattern = std::u16string(1000, u'a') + u"(";

    EXPECT_EQ(refusal(pattern), "missing closing parenthesis at 1001 of the pattern \"" +
                                    std::string(60, 'a') + "...\"");
}

TEST(HostileRegex, EndsInsteadOfTryingExponentiallyManyWays)
{
    std::u16string const subject = std::u16string(5000, u'a') + u"!";

    for (std::u16string const pattern :
         {u"^(a+)+$", u"^(a|a)*$", u"^(a|aa)+$", u"^(.*)*[xy]$", u"(a*)*[bc]", u"(?:(?:a*)*)*[bc]",
          u"^(?=(a+)+$)", u"(x+x+)+y|(a+a+)+[yz]", u"^(\\w+\\s?)*$", u"((a*)*)*\\2[bc]"})
    {
        double const seconds =
            secondsOf([&] { EXPECT_THAT(refusal(pattern, subject), HasSubstr("given up")); });
        EXPECT_LT(seconds, 10) << testing::PrintToString(pattern);
    }
}

TEST(HostileRegex, EndsWhereEachBeginningCostsMuch)
{
    // Each place is cheap enough alone: only all of them together are too much.
    std::u16string const subject(200'000, u'a');

    double const seconds =
        secondsOf([&] { EXPECT_THAT(refusal(u"a*[bc][de]", subject), HasSubstr("given up")); });
    EXPECT_LT(seconds, 10);
}

TEST(HostileRegex, EndsBeforeItEatsTheMemory)
{
    std::u16string const subject(1'000'000, u'a');

    EXPECT_EQ(refusal(u"^(?:a|b)*c?(?:[xy])", subject),
              "search given up, as it would take too much memory in the pattern "
              "\"^(?:a|b)*c?(?:[xy])\"");
}

TEST(HostileRegex, EndsForEndlessRecursion)
{
    EXPECT_NE(refusal(u"^((?1)|a)+", u"aaaa"), "");
    EXPECT_NE(refusal(u"^(a(?1)?b?)*[xy]", std::u16string(2000, u'a')), "");
}

TEST(HostileRegex, IsRefusedWhenTooLong)
{
    EXPECT_THAT(refusal(std::u16string(65'537, u'a')), HasSubstr("longer than the limit"));
    EXPECT_THAT(refusal(std::u16string(10'000'000, u'(')), HasSubstr("longer than the limit"));
}

TEST(HostileRegex, IsRefusedWhenTooLargeOrTooDeep)
{
    EXPECT_THAT(refusal(u"(((a{1000}){1000}){1000}){1000}"), HasSubstr("too large"));
    EXPECT_THAT(refusal(repeated(u"(", 251) + repeated(u")", 251)),
                HasSubstr("parentheses are too deeply nested"));
    EXPECT_EQ(refusal(repeated(u"(", 250) + repeated(u")", 250)), "");
    EXPECT_THAT(refusal(u"a{65536}"), HasSubstr("number too big"));
    EXPECT_LT(secondsOf([] { refusal(repeated(u"(?:a|", 249) + repeated(u")", 249)); }), 10);
    EXPECT_LT(secondsOf([] { refusal(repeated(u"[^a-z\\p{L}]", 5'000)); }), 10);
}

TEST(RegexPattern, SearchesManyTexts)
{
    Pattern const pattern(u"^lib.*-dev$");

    EXPECT_TRUE(pattern.isFoundIn(u"libboost-dev"));
    EXPECT_FALSE(pattern.isFoundIn(u"boost-dev"));
    EXPECT_FALSE(pattern.isFoundIn({}));
    EXPECT_TRUE(pattern.isFoundIn(u"lib-dev"));
    EXPECT_FALSE(Pattern(u"A").isFoundIn(u"a"));
    EXPECT_TRUE(Pattern(u"A", /*caseSensitive=*/false).isFoundIn(u"a"));
    EXPECT_TRUE(Pattern({}).isFoundIn({}));
}

TEST(RegexPattern, SearchesAfreshAfterItGaveUp)
{
    Pattern const pattern(u"^(a+)+$");

    EXPECT_THROW(pattern.isFoundIn(std::u16string(5000, u'a') + u"!"), RegexError);
    EXPECT_TRUE(pattern.isFoundIn(u"aaa"));
    EXPECT_FALSE(pattern.isFoundIn(u"aab"));
    EXPECT_THROW(pattern.isFoundIn(std::u16string(5000, u'a') + u"!"), RegexError);
}

TEST(RegexPattern, IsEnoughForLongOrdinaryTexts)
{
    std::u16string const text = repeated(u"the quick brown fox jumps over the lazy dog\n", 20'000);

    EXPECT_TRUE(Pattern(u"cat|end of all").isFoundIn(text + u"the end of all"));
    EXPECT_FALSE(Pattern(u"fox.*cat").isFoundIn(text));
    EXPECT_FALSE(Pattern(u"\\bcow\\b").isFoundIn(text));
}

TEST(RegexPattern, FindsPlainCharactersAndDotsLikeAnyOtherPattern)
{
    std::mt19937 random(1);
    auto const below = [&](std::size_t bound) { return random() % bound; };
    std::vector<std::u16string> const items{u"a", u"b", u".", u".*", u".*", u"\\.", u"\\*", u"ab"};
    // Line ends, a surrogate pair, and halves of one.
    std::vector<std::u16string> const characters{u"a",
                                                 u"b",
                                                 u"a",
                                                 u"b",
                                                 u".",
                                                 u"*",
                                                 u"\n",
                                                 u"\r\n",
                                                 u"\x85",
                                                 u"\u2028",
                                                 u"\u2029",
                                                 u"\v",
                                                 u"\u0084",
                                                 u"\u2027",
                                                 u"\U0001F600",
                                                 std::u16string(1, 0xD83D),
                                                 std::u16string(1, 0xDE00)};
    int found = 0;
    for (int round = 0; round < 20'000; ++round)
    {
        std::u16string pattern;
        for (std::size_t left = below(6); left > 0; --left)
            pattern += items[below(items.size())];
        std::u16string subject;
        for (std::size_t left = below(9); left > 0; --left)
            subject += characters[below(round % 2 == 0 ? 4 : characters.size())];

        // The second way, which matches nothing, keeps all optimisations away.
        bool const expected = Pattern(u"(?:" + pattern + u"|[^\\s\\S])").isFoundIn(subject);
        ASSERT_EQ(Pattern(pattern).isFoundIn(subject), expected)
            << testing::PrintToString(pattern) << " in " << testing::PrintToString(subject);
        found += expected;
    }
    EXPECT_GT(found, 5'000);
    EXPECT_LT(found, 15'000);
}

TEST(RegexPattern, EndsForPlainCharactersThatAreComparedOften)
{
    std::u16string const mostly = std::u16string(200, u'a') + u"b";
    std::u16string const subject(100'000, u'a');

    EXPECT_FALSE(Pattern(mostly).isFoundIn(subject));
    double const seconds =
        secondsOf([&] { EXPECT_THAT(refusal(mostly, subject + u"b"), HasSubstr("given up")); });
    EXPECT_LT(seconds, 10);
}

TEST(RegexPattern, CanBeMovedButNotCopied)
{
    static_assert(!std::is_copy_constructible_v<Pattern>);
    Pattern first(u"a");
    Pattern second(std::move(first));
    Pattern third(u"b");

    third = std::move(second);

    EXPECT_TRUE(third.isFoundIn(u"a"));
    EXPECT_FALSE(third.isFoundIn(u"b"));
}
}  // namespace
