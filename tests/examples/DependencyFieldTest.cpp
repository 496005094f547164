#include "reader/DependencyField.h"

#include "reader/SyntaxError.h"

#include <gtest/gtest.h>

#include <string>

using debian::PackageRelation;
using debian::parseDependencyField;
using debian::SyntaxError;
using debian::VersionRelation;

namespace {

/// The relation of a field that holds just one.
PackageRelation parseOne(std::string_view text)
{
    auto const groups = parseDependencyField(text);
    EXPECT_EQ(groups.size(), 1u);
    EXPECT_EQ(groups.at(0).size(), 1u);
    return groups.at(0).at(0);
}

std::string errorOf(std::string_view text)
{
    try
    {
        parseDependencyField(text);
    }
    catch (SyntaxError const& error)
    {
        return error.what();
    }
    ADD_FAILURE() << "\"" << text << "\" was accepted";
    return {};
}

}  // namespace

TEST(DependencyField, SplitsGroupsAtCommasAndAlternativesAtBars)
{
    auto const groups = parseDependencyField("a, b | c|d ,e");

    ASSERT_EQ(groups.size(), 3u);
    EXPECT_EQ(groups[0].at(0).package, "a");
    ASSERT_EQ(groups[1].size(), 3u);
    EXPECT_EQ(groups[1][0].package, "b");
    EXPECT_EQ(groups[1][1].package, "c");
    EXPECT_EQ(groups[1][2].package, "d");
    EXPECT_EQ(groups[2].at(0).package, "e");
}

TEST(DependencyField, HasNoGroupsIfItIsEmpty)
{
    EXPECT_TRUE(parseDependencyField("").empty());
    EXPECT_TRUE(parseDependencyField(" \n ").empty());
}

TEST(DependencyField, GivesAPlainNameNoConditions)
{
    auto const relation = parseOne("libstdc++-12-dev");

    EXPECT_EQ(relation.package, "libstdc++-12-dev");
    EXPECT_EQ(relation.architecture, "");
    EXPECT_FALSE(relation.bound);
    EXPECT_TRUE(relation.restrictions.empty());
}

TEST(DependencyField, ReadsTheArchitectureBehindAColon)
{
    auto const relation = parseOne("python3:any (>= 3.11)");

    EXPECT_EQ(relation.package, "python3");
    EXPECT_EQ(relation.architecture, "any");
    EXPECT_EQ(relation.bound->version.text(), "3.11");
}

TEST(DependencyField, ReadsAllRelations)
{
    EXPECT_EQ(parseOne("a (<< 1)").bound->relation, VersionRelation::StrictlyEarlier);
    EXPECT_EQ(parseOne("a (<= 1)").bound->relation, VersionRelation::EarlierOrEqual);
    EXPECT_EQ(parseOne("a (= 1)").bound->relation, VersionRelation::Equal);
    EXPECT_EQ(parseOne("a (>= 1)").bound->relation, VersionRelation::LaterOrEqual);
    EXPECT_EQ(parseOne("a (>> 1)").bound->relation, VersionRelation::StrictlyLater);
}

TEST(DependencyField, TakesTheLegacyRelationsAsInclusive)
{
    EXPECT_EQ(parseOne("a (< 1)").bound->relation, VersionRelation::EarlierOrEqual);
    EXPECT_EQ(parseOne("a (> 1)").bound->relation, VersionRelation::LaterOrEqual);
}

TEST(DependencyField, NeedsNoBlanksAndAllowsThemWithNewlinesBetweenParts)
{
    auto const dense = parseOne("a(>=1:2-3)[i386]<!nocheck>");
    auto const loose = parseOne("\n a\n (\t>=  1:2-3 ) [\n i386 ] < !nocheck > ");

    for (auto const& relation : {dense, loose})
    {
        EXPECT_EQ(relation.package, "a");
        EXPECT_EQ(relation.bound->version.text(), "1:2-3");
        ASSERT_EQ(relation.restrictions.size(), 1u);
        EXPECT_EQ(relation.restrictions[0].architecture, "i386");
    }
}

TEST(DependencyField, KeepsArchitectureListsInTheirOrder)
{
    auto const relation = parseOne("a [amd64 !i386 linux-any]");

    ASSERT_EQ(relation.restrictions.size(), 3u);
    EXPECT_EQ(relation.restrictions[0].architecture, "amd64");
    EXPECT_FALSE(relation.restrictions[0].excluded);
    EXPECT_EQ(relation.restrictions[1].architecture, "i386");
    EXPECT_TRUE(relation.restrictions[1].excluded);
    EXPECT_EQ(relation.restrictions[2].architecture, "linux-any");
    EXPECT_FALSE(relation.restrictions[2].excluded);
}

TEST(DependencyField, DropsBuildProfiles)
{
    auto const groups = parseDependencyField("a <!nocheck> <cross stage1>, b");

    ASSERT_EQ(groups.size(), 2u);
    EXPECT_EQ(groups[0].at(0).package, "a");
    EXPECT_EQ(groups[1].at(0).package, "b");
}

TEST(DependencyField, RefusesEmptyGroupsAndAlternatives)
{
    EXPECT_EQ(errorOf(", a"), "column 1: found \",\" instead of a package name");
    EXPECT_EQ(errorOf("a,,b"), "column 3: found \",\" instead of a package name");
    EXPECT_EQ(errorOf("a, "), "column 4: found the end of the field instead of a package name");
    EXPECT_EQ(errorOf("a | "), "column 5: found the end of the field instead of a package name");
    EXPECT_EQ(errorOf("|a"), "column 1: found \"|\" instead of a package name");
}

TEST(DependencyField, RefusesNamesThatBeginWrongly)
{
    EXPECT_EQ(errorOf("+a"), "column 1: found \"+\" instead of a package name");
    EXPECT_EQ(errorOf("a, \xC3\xA9"), "column 4: found byte 0xc3 instead of a package name");
    EXPECT_EQ(errorOf("a:"), "column 3: found the end of the field instead of an architecture");
    EXPECT_EQ(errorOf("a: any"), "column 3: found byte 0x20 instead of an architecture");
}

TEST(DependencyField, RefusesWhatFollowsARelationWithoutSeparator)
{
    EXPECT_EQ(errorOf("a b"), "column 3: found \"b\" instead of \",\" or \"|\"");
    EXPECT_EQ(errorOf("a (= 1) (= 2)"), "column 9: found \"(\" instead of \",\" or \"|\"");
    EXPECT_EQ(errorOf("a :any"), "column 3: found \":\" instead of \",\" or \"|\"");
}

TEST(DependencyField, RefusesUnknownRelations)
{
    EXPECT_EQ(errorOf("a (1.0)"), "column 4: found \"1\" instead of one of << <= = >= >>");
    EXPECT_EQ(errorOf("a (=> 1)"), "column 4: found \"=\" instead of one of << <= = >= >>");
    EXPECT_EQ(errorOf("a (== 1)"), "column 4: found \"=\" instead of one of << <= = >= >>");
    EXPECT_EQ(errorOf("a ("),
              "column 4: found the end of the field instead of one of << <= = >= >>");
}

TEST(DependencyField, RefusesBadVersionsAtTheirPlaceInTheField)
{
    EXPECT_EQ(errorOf("a (>= )"), "column 7: version is empty");
    EXPECT_EQ(errorOf("a (>= 1.0_1)"), "column 10: character not allowed in an upstream version");
    EXPECT_EQ(errorOf("a (>= 1 0)"), "column 9: found \"0\" instead of \")\"");
    EXPECT_EQ(errorOf("a (>= 1"), "column 8: found the end of the field instead of \")\"");
}

TEST(DependencyField, RefusesEmptyAndUnfinishedLists)
{
    EXPECT_EQ(errorOf("a []"), "column 4: found \"]\" instead of an architecture");
    EXPECT_EQ(errorOf("a [amd64"),
              "column 9: found the end of the field instead of an architecture");
    EXPECT_EQ(errorOf("a [! amd64]"), "column 5: found byte 0x20 instead of an architecture");
    EXPECT_EQ(errorOf("a <>"), "column 4: found \">\" instead of a build profile");
    EXPECT_EQ(errorOf("a <x"), "column 5: found the end of the field instead of a build profile");
}
