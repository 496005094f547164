#include "reader/Version.h"

#include "reader/SyntaxError.h"

#include <gtest/gtest.h>

#include <string>

using debian::SyntaxError;
using debian::Version;
using debian::VersionRelation;

namespace {

std::string errorOf(std::string const& text)
{
    try
    {
        Version version(text);
    }
    catch (SyntaxError const& error)
    {
        return error.what();
    }
    ADD_FAILURE() << "\"" << text << "\" was accepted";
    return {};
}

}  // namespace

TEST(Version, IsTakenApartAtTheFirstColonAndTheLastHyphen)
{
    Version const version("2:1:3-b-4.5~6");

    EXPECT_EQ(version.text(), "2:1:3-b-4.5~6");
    EXPECT_EQ(version.epoch(), 2u);
    EXPECT_EQ(version.upstream(), "1:3-b");
    EXPECT_EQ(version.revision(), "4.5~6");
}

TEST(Version, HasEpochZeroAndNoRevisionUnlessWritten)
{
    Version const version("1.0");

    EXPECT_EQ(version.epoch(), 0u);
    EXPECT_EQ(version.upstream(), "1.0");
    EXPECT_EQ(version.revision(), "");
}

TEST(Version, StaysIntactWhenItsTextIsMovedAway)
{
    Version first("1:2-3");
    Version const second = std::move(first);

    EXPECT_EQ(second.upstream(), "2");
    EXPECT_EQ(second.revision(), "3");
}

TEST(Version, SatisfiesRelationsAccordingToItsOrder)
{
    Version const bound("1.0");
    auto satisfied = [&](char const* version) {
        std::string relations;
        for (VersionRelation relation :
             {VersionRelation::StrictlyEarlier, VersionRelation::EarlierOrEqual,
              VersionRelation::Equal, VersionRelation::LaterOrEqual,
              VersionRelation::StrictlyLater})
        {
            if (Version(version).satisfies(relation, bound))
                relations.append(toString(relation)).append(" ");
        }
        return relations;
    };

    EXPECT_EQ(satisfied("1.0~rc1"), "<< <= ");
    EXPECT_EQ(satisfied("0:1.00-0"), "<= = >= ");
    EXPECT_EQ(satisfied("1.0+b1"), ">= >> ");
}

TEST(VersionSyntax, AcceptsEveryAllowedCharacter)
{
    EXPECT_EQ(Version("2147483647:0aZ.+-~:9-aZ9.+~").revision(), "aZ9.+~");
}

TEST(VersionSyntax, GivesColumnAndReasonOfAFault)
{
    EXPECT_EQ(errorOf(""), "column 1: version is empty");
    EXPECT_EQ(errorOf(":1"), "column 1: epoch is empty");
    EXPECT_EQ(errorOf("1a:1"), "column 2: epoch is not a number");
    EXPECT_EQ(errorOf("1.0-1:2"), "column 2: epoch is not a number");
    EXPECT_EQ(errorOf("2147483648:1"), "column 1: epoch is above 2147483647");
    EXPECT_EQ(errorOf("99999999999999999999:1"), "column 1: epoch is above 2147483647");
    EXPECT_EQ(errorOf("1:"), "column 3: nothing follows the epoch");
    EXPECT_EQ(errorOf("1.0-"), "column 5: revision is empty");
    EXPECT_EQ(errorOf("1:-1"), "column 3: upstream version is empty");
    EXPECT_EQ(errorOf("-1"), "column 1: upstream version is empty");
    EXPECT_EQ(errorOf("1:a"), "column 3: upstream version does not begin with a digit");
    EXPECT_EQ(errorOf("1.0_2"), "column 4: character not allowed in an upstream version");
    EXPECT_EQ(errorOf("1 0"), "column 2: character not allowed in an upstream version");
    EXPECT_EQ(errorOf("1.0-a_b"), "column 6: character not allowed in a revision");
}
