#include "CommandLine.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using debian::CommandLine;
using debian::parseCommandLine;
using debian::Question;
using testing::ElementsAre;
using testing::IsEmpty;

std::string errorOf(std::vector<std::string> const& arguments)
{
    try
    {
        parseCommandLine(arguments);
    }
    catch (debian::UsageError const& error)
    {
        return error.what();
    }
    ADD_FAILURE() << "no UsageError";
    return {};
}

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

TEST(CommandLine, KeepsQuestionsInTheirOrder)
{
    CommandLine const commandLine = parseCommandLine(
        {"--tag", "-dev$", "one", "--unmet", "--reverse", "libc6", "--unmet-recommended",
         "--largest", "^lib", "--same-maintainer", "--reverse", "--unmet"});

    EXPECT_THAT(commandLine.questions, ElementsAre(Question{Question::Kind::Tag, "-dev$"},
                                                   Question{Question::Kind::Unmet, ""},
                                                   Question{Question::Kind::Reverse, "libc6"},
                                                   Question{Question::Kind::UnmetRecommended, ""},
                                                   Question{Question::Kind::Largest, "^lib"},
                                                   Question{Question::Kind::SameMaintainer, ""},
                                                   Question{Question::Kind::Reverse, "--unmet"}));
    EXPECT_EQ(commandLine.file, "one");
    EXPECT_THAT(parseCommandLine({}).questions, IsEmpty());
}

TEST(CommandLine, LimitsTheRowsOfAnswers)
{
    EXPECT_EQ(parseCommandLine({}).maxRows, 10u);
    EXPECT_EQ(parseCommandLine({"--limit", "25"}).maxRows, 25u);
    EXPECT_EQ(parseCommandLine({"--limit", "0"}).maxRows, 0u);
}

TEST(CommandLine, RefusesWhatMakesNoSense)
{
    EXPECT_EQ(errorOf({"--figures"}), "--figures needs the name of a file");
    EXPECT_EQ(errorOf({"--fast"}), "unknown option: --fast");
    EXPECT_EQ(errorOf({"a", "b", "c"}), "more than two files: c");
    EXPECT_EQ(errorOf({"-", "-"}), "standard input can be read only once");
    EXPECT_EQ(errorOf({"--largest"}), "--largest needs a pattern");
    EXPECT_EQ(errorOf({"--tag"}), "--tag needs a pattern");
    EXPECT_EQ(errorOf({"--reverse"}), "--reverse needs the name of a package");
    EXPECT_EQ(errorOf({"--limit"}), "--limit needs a number of rows");
    for (std::string const number : {"", "-1", "+1", "ten", "1x", "99999999999999999999"})
        EXPECT_EQ(errorOf({"--limit", number}), "no number of rows: " + number);
}

}  // namespace
