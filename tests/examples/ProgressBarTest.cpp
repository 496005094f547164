#include "ProgressBar.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>

namespace {

using debian::ProgressBar;
using testing::EndsWith;
using testing::HasSubstr;

constexpr ProgressBar::Milliseconds AT_ONCE(0);

TEST(ProgressBar, DrawsHowFarTheWorkHasCome)
{
    std::ostringstream output;
    ProgressBar bar(output, /*isTerminal=*/true, "Reading x", 200, AT_ONCE);

    bar.update(100);

    EXPECT_THAT(output.str(), EndsWith("Reading x [###############               ] 50 %"));
}

TEST(ProgressBar, ErasesItselfInTheEnd)
{
    std::ostringstream output;
    {
        ProgressBar bar(output, /*isTerminal=*/true, "Reading x", 200, AT_ONCE);
        bar.update(300);
        EXPECT_THAT(output.str(), HasSubstr("] 100 %"));
    }
    EXPECT_THAT(output.str(), EndsWith("\r\x1b[K"));
}

TEST(ProgressBar, TellsTheAmountIfTheTotalIsNotKnown)
{
    std::ostringstream output;
    ProgressBar bar(output, /*isTerminal=*/true, "Reading x", 0, AT_ONCE);

    bar.update(2048);

    EXPECT_THAT(output.str(), EndsWith("Reading x 2 KiB"));
}

TEST(ProgressBar, WritesNothingWithoutATerminal)
{
    std::ostringstream output;
    {
        ProgressBar bar(output, /*isTerminal=*/false, "Reading x", 200, AT_ONCE);
        bar.update(100);
    }
    EXPECT_EQ(output.str(), "");
}

TEST(ProgressBar, WritesNothingDuringShortWork)
{
    std::ostringstream output;
    {
        ProgressBar bar(output, /*isTerminal=*/true, "Reading x", 200, std::chrono::hours(1));
        bar.update(100);
    }
    EXPECT_EQ(output.str(), "");
}

}  // namespace
