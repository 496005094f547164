#include "tarnkiln/Assert.h"

namespace {

struct NoText
{};

#ifdef TARNKILN_CHECKED

TEST(Assertion, EvaluatesOnlyItsConditionWhenThatHolds)
{
    int conditions = 0;
    int operands = 0;

    TARNKILN_ASSERT(++conditions == 1, "the first call", ++operands);

    EXPECT_EQ(1, conditions);
    EXPECT_EQ(0, operands);
}

TEST(AssertionDeathTest, PrintsSentenceConditionOperandsAndPlace)
{
    int const answer = 41;
    std::u16string const question = u"6 \u00D7 7 \U0001F600";

    EXPECT_DEATH(TARNKILN_ASSERT(answer == 42, "the answer is known", answer, question, NoText()),
                 "assertion failed: the answer is known\n"
                 "  must hold: answer == 42\n"
                 "  with answer, question, NoText\\(\\):\n"
                 "    41\n"
                 "    6 \xC3\x97 7 \xF0\x9F\x98\x80\n"
                 "    \\(a value that has no text\\)\n"
                 "  at .*AssertTest\\.cpp:[0-9]+\n");
}

TEST(AssertionDeathTest, PrintsALoneSurrogateAsTheReplacementCharacter)
{
    std::u16string const text = {u'a', char16_t(0xD83D), u'b', char16_t(0xDE00)};

    EXPECT_DEATH(TARNKILN_ASSERT(text.empty(), "nothing is left over", text), "    a\xEF\xBF\xBD"
                                                                              "b\xEF\xBF\xBD\n");
}

#else

TEST(Assertion, EvaluatesNothingInAnUncheckedBuild)
{
    int calls = 0;

    TARNKILN_ASSERT(++calls == 0, "never called", ++calls);

    EXPECT_EQ(0, calls);
}

#endif

}  // namespace
