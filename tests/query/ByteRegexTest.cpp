#include "tarnkiln/query/internal/ByteRegex.h"

#include <gtest/gtest.h>

#include <chrono>
#include <random>
#include <string>

namespace testkit {
namespace {

using tarn::kiln::internal::ByteRegex;
using namespace std::regex_constants;

bool matches(std::string const& text, std::string const& pattern)
{
    return ByteRegex(pattern).matches(text);
}

/// Expects that `call` throws a `std::regex_error` with that code.
template <class Call> void expectRegexError(error_type code, Call const& call)
{
    try
    {
        call();
        ADD_FAILURE() << "threw nothing";
    }
    catch (std::regex_error const& error)
    {
        EXPECT_EQ(error.code(), code) << error.what();
    }
}

TEST(ByteRegex, MatchesWholeTextsOnly)
{
    EXPECT_TRUE(matches("abc", "abc"));
    EXPECT_FALSE(matches("xabc", "abc"));
    EXPECT_FALSE(matches("abcx", "abc"));
    EXPECT_TRUE(matches("abcabc", "(abc)+"));
    EXPECT_FALSE(matches("abcab", "(abc)+"));
}

TEST(ByteRegex, KnowsTheSyntaxOfECMAScript)
{
    EXPECT_TRUE(matches("a1_ ", "\\w\\d_\\s"));
    EXPECT_TRUE(matches("foobar", "foo(?=bar)bar"));
    EXPECT_FALSE(matches("foobaz", "foo(?!baz)ba."));
    EXPECT_TRUE(matches("]", "[\\]]"));
    EXPECT_TRUE(matches("aaa", "a{2,}"));
    EXPECT_FALSE(matches("aaaa", "a{2,3}"));
    EXPECT_TRUE(matches("b", "a|b|c"));
    EXPECT_TRUE(matches("colour", "colou?r"));
}

TEST(ByteRegex, RefersBackToGroups)
{
    EXPECT_TRUE(matches("abab", "(ab)\\1"));
    EXPECT_FALSE(matches("abba", "(ab)\\1"));
    EXPECT_TRUE(matches("hello hello", "(\\w+) \\1"));
}

TEST(ByteRegex, DoesNotLetADotPassLineEnds)
{
    for (char const* const pattern : {"a.b", "(a).b", "a.*b", "(a).*b"})
    {
        EXPECT_TRUE(matches("axb", pattern)) << pattern;
        EXPECT_FALSE(matches("a\nb", pattern)) << pattern;
        EXPECT_FALSE(matches("a\rb", pattern)) << pattern;
    }
    EXPECT_TRUE(matches("a\nb", "a\nb"));
}

TEST(ByteRegex, FailsForWhatIsNoRegularExpression)
{
    expectRegexError(error_paren, [] { ByteRegex("(a"); });
    expectRegexError(error_brack, [] { ByteRegex("[a"); });
    EXPECT_THROW(ByteRegex("*a"), std::regex_error);
    expectRegexError(error_escape, [] { ByteRegex("a\\"); });
    expectRegexError(error_backref, [] { ByteRegex("\\1"); });
}

// Plain characters, "." and ".*" are matched without the standard library, which must not show.
TEST(ByteRegex, MatchesSimplePatternsAsTheStandardLibraryDoes)
{
    std::mt19937 random(7);  // NOLINT: the same texts each time
    auto const pick = [&](std::string const& letters, std::size_t most) {
        std::string result;
        for (std::size_t left = random() % (most + 1); left > 0; --left)
            result += letters[random() % letters.size()];
        return result;
    };
    int found = 0;
    for (int round = 0; round < 3000; ++round)
    {
        std::string const text = pick("aab\n", 8);
        std::string pattern;
        for (std::size_t left = random() % 5; left > 0; --left)
        {
            char const* const items[] = {".", ".*", "a", "b", "\n", ".*", "\\*"};
            pattern += items[random() % 7];
        }

        bool const expected = std::regex_match(text, std::regex(pattern));

        ASSERT_EQ(matches(text, pattern), expected) << pattern << " and " << text;
        found += expected;
    }
    EXPECT_GT(found, 200);
}

TEST(ByteRegex, RefusesPatternsThatAreTooLargeWhenWrittenOut)
{
    std::string const longest(ByteRegex::MOST_ITEMS, 'a');
    EXPECT_TRUE(matches(longest, longest));
    expectRegexError(error_space, [&] { ByteRegex(longest + "a"); });
    expectRegexError(error_space, [] { ByteRegex("a{100000}"); });
    expectRegexError(error_space, [] { ByteRegex("(a?){99}{99}"); });
    expectRegexError(error_space, [] { ByteRegex("((a{30}){30}){30}"); });
    expectRegexError(error_space, [] { ByteRegex("(){1000000000}"); });
    expectRegexError(error_space, [] { ByteRegex("a{99999999999999999999,}"); });
}

TEST(ByteRegex, RefusesPatternsThatAreNestedTooDeeply)
{
    auto const nested = [](std::size_t depth) {
        return std::string(depth, '(') + 'a' + std::string(depth, ')');
    };

    EXPECT_TRUE(matches("a", nested(ByteRegex::DEEPEST_NESTING)));
    expectRegexError(error_stack, [&] { ByteRegex(nested(ByteRegex::DEEPEST_NESTING + 1)); });
    expectRegexError(error_stack, [&] { ByteRegex(std::string(1'000'000, '(')); });
}

TEST(ByteRegex, EndsSoonForHostilePatterns)
{
    auto const begin = std::chrono::steady_clock::now();
    std::string const hostile = std::string(2000, 'a') + '!';

    EXPECT_FALSE(matches(hostile, "(a*)*b"));
    EXPECT_FALSE(matches(hostile, "(a|aa)+"));
    EXPECT_FALSE(matches(hostile, "(.*a){12}b"));
    EXPECT_FALSE(matches(std::string(100'000, 'a'), "[a-z]*!"));
    expectRegexError(error_complexity,
                     [] { matches(std::string(1'000'000, 'a'), "(a|a|a|a|a|a|a|a|a|a|a)*b"); });
    expectRegexError(error_complexity, [] {
        matches(std::string(100'000, 'a'), ".*" + std::string(4000, 'a') + "b");
    });
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(60));
}

TEST(ByteRegex, EndsSoonForHostilePatternsThatReferBack)
{
    auto const begin = std::chrono::steady_clock::now();

    expectRegexError(error_complexity,
                     [] { matches(std::string(30, 'a') + '!', "(a*)*(b)?\\1c"); });
    expectRegexError(error_stack, [] { matches(std::string(100'000, 'a'), "(.)*\\1"); });
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(60));
}
}  // namespace
}  // namespace testkit
