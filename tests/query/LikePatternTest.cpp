#include "tarnkiln/query/internal/likePattern.h"

#include <gtest/gtest.h>

namespace testkit {
namespace {

using tarn::kiln::internal::likeToRegex;

TEST(LikePattern, TurnsItsTwoWildcardsIntoRegularExpressions)
{
    EXPECT_EQ(likeToRegex("a%"), "a.*");
    EXPECT_EQ(likeToRegex("_b"), ".b");
    EXPECT_EQ(likeToRegex("100%_"), "100.*.");
    EXPECT_EQ(likeToRegex("%%"), ".*.*");
    EXPECT_EQ(likeToRegex(""), "");
}

TEST(LikePattern, EscapesWhatHasAMeaningInRegularExpressions)
{
    EXPECT_EQ(likeToRegex("a.b"), "a\\.b");
    EXPECT_EQ(likeToRegex("^$\\.*+?()[]{}|"), "\\^\\$\\\\\\.\\*\\+\\?\\(\\)\\[\\]\\{\\}\\|");
    EXPECT_EQ(likeToRegex("-/,:<>=!&~#\"'"), "-/,:<>=!&~#\"'");
}

TEST(LikePattern, HasNoWayToEscapeAWildcard)
{
    EXPECT_EQ(likeToRegex("\\%"), "\\\\.*");
    EXPECT_EQ(likeToRegex("\\_"), "\\\\.");
}
}  // namespace
}  // namespace testkit
