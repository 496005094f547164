#include "CommandLine.h"

#include <gtest/gtest.h>

namespace {

using debian::CommandLine;
using debian::parseCommandLine;

TEST(CommandLine, ReadsTheStatusFileByDefault)
{
    CommandLine const commandLine = parseCommandLine({});

    EXPECT_EQ(commandLine.file, "/var/lib/dpkg/status");
    EXPECT_FALSE(commandLine.available);
    EXPECT_FALSE(commandLine.wantsHelp);
}

TEST(CommandLine, TakesOneOrTwoFiles)
{
    EXPECT_EQ(parseCommandLine({"one"}).file, "one");
    EXPECT_EQ(parseCommandLine({"-", "two"}).file, "-");
    EXPECT_EQ(parseCommandLine({"one", "-"}).available, "-");
}

TEST(CommandLine, TakesAFileThatLooksLikeAnOptionBehindTwoHyphens)
{
    EXPECT_EQ(parseCommandLine({"--", "--help"}).file, "--help");
}

TEST(CommandLine, KnowsTheOptionForHelp)
{
    EXPECT_TRUE(parseCommandLine({"file", "--help"}).wantsHelp);
    EXPECT_TRUE(parseCommandLine({"-h"}).wantsHelp);
}

TEST(CommandLine, KnowsTheOptionsForFormAndFigures)
{
    EXPECT_FALSE(parseCommandLine({}).reflective);
    EXPECT_FALSE(parseCommandLine({}).figures);

    CommandLine const commandLine = parseCommandLine({"--reflective", "one", "--figures", "table"});

    EXPECT_TRUE(commandLine.reflective);
    EXPECT_EQ(commandLine.figures, "table");
    EXPECT_EQ(commandLine.file, "one");
}

TEST(CommandLine, RefusesWhatMakesNoSense)
{
    EXPECT_THROW(parseCommandLine({"--figures"}), debian::UsageError);
    EXPECT_THROW(parseCommandLine({"--fast"}), debian::UsageError);
    EXPECT_THROW(parseCommandLine({"a", "b", "c"}), debian::UsageError);
    EXPECT_THROW(parseCommandLine({"-", "-"}), debian::UsageError);
}

}  // namespace
