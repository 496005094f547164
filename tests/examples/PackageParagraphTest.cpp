#include "reader/PackageParagraph.h"

#include "tests/examples/ReadText.h"

#include <gmock/gmock.h>

#include <string>

using debian::DEPENDENCY_KINDS;
using debian::DependencyKind;
using debian::MultiArch;
using debian::PackageParagraph;
using testing::HasSubstr;

namespace {

std::string const SMALLEST = "Package: a\nVersion: 1\nArchitecture: all\n";

PackageParagraph readOne(std::string const& text)
{
    return test::readPackages(text).at(0);
}

std::string errorOf(std::string const& text)
{
    return test::errorOf(test::readPackages, text);
}

}  // namespace

TEST(PackageParagraph, HoldsAllFieldsOfAnInstalledPackage)
{
    auto const package = readOne(R"(
Package: zlib1g
Essential: yes
Status: install ok installed
Priority: required
Section: libs
Installed-Size: 168
Maintainer: Mark Brown <broonie@debian.org>
Architecture: amd64
Multi-Arch: same
Version: 1:1.2.13.dfsg-1
Description: compression library - runtime
 zlib is a library implementing the deflate compression method.
)");

    EXPECT_EQ(package.line, 2u);
    EXPECT_EQ(package.package, "zlib1g");
    EXPECT_TRUE(package.essential);
    EXPECT_EQ(package.status, "install ok installed");
    EXPECT_EQ(package.priority, "required");
    EXPECT_EQ(package.section, "libs");
    EXPECT_EQ(package.installedSize, 168u);
    EXPECT_EQ(package.maintainer, "Mark Brown <broonie@debian.org>");
    EXPECT_EQ(package.architecture, "amd64");
    EXPECT_EQ(package.multiArch, MultiArch::Same);
    EXPECT_EQ(package.version.text(), "1:1.2.13.dfsg-1");
    EXPECT_EQ(package.description, "compression library - runtime");
}

TEST(PackageParagraph, NeedsNoMoreThanNameVersionAndArchitecture)
{
    auto const package = readOne(SMALLEST);

    EXPECT_EQ(package.status, "");
    EXPECT_FALSE(package.essential);
    EXPECT_EQ(package.priority, "");
    EXPECT_EQ(package.section, "");
    EXPECT_EQ(package.maintainer, "");
    EXPECT_FALSE(package.installedSize);
    EXPECT_EQ(package.description, "");
    EXPECT_EQ(package.multiArch, MultiArch::No);
    for (DependencyKind const kind : DEPENDENCY_KINDS)
        EXPECT_TRUE(package.dependenciesOf(kind).empty());
    EXPECT_TRUE(package.provides.empty());
}

TEST(PackageParagraph, KeepsDependenciesOfEachKindApart)
{
    auto const package = readOne(SMALLEST + R"(Pre-Depends: pre
Depends: libc6 (>= 2.36), one | two
Recommends: rec
Suggests: sug | other
Conflicts: con
Breaks: bre (<< 2)
Replaces: rep
Enhances: enh
)");

    auto firstOf = [&](DependencyKind kind) {
        return package.dependenciesOf(kind).at(0).at(0).package;
    };
    EXPECT_EQ(firstOf(DependencyKind::PreDepends), "pre");
    EXPECT_EQ(firstOf(DependencyKind::Depends), "libc6");
    EXPECT_EQ(firstOf(DependencyKind::Recommends), "rec");
    EXPECT_EQ(firstOf(DependencyKind::Suggests), "sug");
    EXPECT_EQ(firstOf(DependencyKind::Conflicts), "con");
    EXPECT_EQ(firstOf(DependencyKind::Breaks), "bre");
    EXPECT_EQ(firstOf(DependencyKind::Replaces), "rep");
    EXPECT_EQ(firstOf(DependencyKind::Enhances), "enh");
    EXPECT_EQ(package.dependenciesOf(DependencyKind::Depends).at(1).at(1).package, "two");
}

TEST(PackageParagraph, ReadsDependenciesFoldedOverLines)
{
    auto const package = readOne(SMALLEST + "Depends:\n one (>= 1),\n# not this\n two\n");

    ASSERT_EQ(package.dependenciesOf(DependencyKind::Depends).size(), 2u);
    EXPECT_EQ(package.dependenciesOf(DependencyKind::Depends)[1].at(0).package, "two");
}

TEST(PackageParagraph, ReadsWhatItProvides)
{
    auto const package = readOne(SMALLEST + "Provides: mail-transport-agent, liba-abi (= 1.2)\n");

    ASSERT_EQ(package.provides.size(), 2u);
    EXPECT_EQ(package.provides[0].package, "mail-transport-agent");
    EXPECT_FALSE(package.provides[0].bound);
    EXPECT_EQ(package.provides[1].bound->version.text(), "1.2");
}

TEST(PackageParagraph, ReadsEveryValueOfMultiArch)
{
    EXPECT_EQ(readOne(SMALLEST + "Multi-Arch: no\n").multiArch, MultiArch::No);
    EXPECT_EQ(readOne(SMALLEST + "Multi-Arch: same\n").multiArch, MultiArch::Same);
    EXPECT_EQ(readOne(SMALLEST + "Multi-Arch: foreign\n").multiArch, MultiArch::Foreign);
    EXPECT_EQ(readOne(SMALLEST + "Multi-Arch: allowed\n").multiArch, MultiArch::Allowed);
    EXPECT_EQ(
        errorOf(SMALLEST + "Multi-Arch: some\n"),
        "index:4: field \"Multi-Arch\": \"some\" is none of \"no\", \"same\", \"foreign\" and "
        "\"allowed\"");
}

TEST(PackageParagraph, ReadsEssentialAsYesOrNo)
{
    EXPECT_TRUE(readOne(SMALLEST + "Essential: yes\n").essential);
    EXPECT_FALSE(readOne(SMALLEST + "Essential: no\n").essential);
    EXPECT_EQ(errorOf(SMALLEST + "Essential: 1\n"),
              "index:4: field \"Essential\": \"1\" is neither \"yes\" nor \"no\"");
}

TEST(PackageParagraph, RefusesASizeThatIsNoNumber)
{
    EXPECT_EQ(errorOf(SMALLEST + "Installed-Size: 12k\n"),
              "index:4: field \"Installed-Size\": \"12k\" is not a number of 64 bits");
    EXPECT_EQ(errorOf(SMALLEST + "Installed-Size: -1\n"),
              "index:4: field \"Installed-Size\": \"-1\" is not a number of 64 bits");
    EXPECT_EQ(
        errorOf(SMALLEST + "Installed-Size: 18446744073709551616\n"),
        "index:4: field \"Installed-Size\": \"18446744073709551616\" is not a number of 64 bits");
    EXPECT_EQ(errorOf(SMALLEST + "Installed-Size:\n"),
              "index:4: field \"Installed-Size\": \"\" is not a number of 64 bits");
}

TEST(PackageParagraph, RefusesAParagraphThatLacksAMandatoryField)
{
    std::string const good = SMALLEST + "\n";

    EXPECT_EQ(errorOf(good + "Version: 1\nArchitecture: all\n"),
              "index:5: paragraph has no field \"Package\"; the file may be cut off or no package "
              "index");
    EXPECT_THAT(errorOf(good + "Package: b\n"),
                HasSubstr("index:5: paragraph has no field \"Version\""));
    EXPECT_THAT(errorOf(good + "Package: b\nVersion:\nArchitecture: all\n"),
                HasSubstr("index:5: paragraph has no field \"Version\""));
    EXPECT_THAT(errorOf(good + "Package: b\nVersion: 1\n"),
                HasSubstr("index:5: paragraph has no field \"Architecture\""));
}

TEST(PackageParagraph, RefusesImpossibleNamesAndArchitectures)
{
    EXPECT_EQ(errorOf("Package: a b\nVersion: 1\nArchitecture: all\n"),
              "index:1: field \"Package\": \"a b\" is not allowed");
    EXPECT_EQ(errorOf("Package: -a\nVersion: 1\nArchitecture: all\n"),
              "index:1: field \"Package\": \"-a\" is not allowed");
    EXPECT_EQ(errorOf("Package: a\nVersion: 1\nArchitecture: any_64\n"),
              "index:3: field \"Architecture\": \"any_64\" is not allowed");
}

TEST(PackageParagraph, RefusesABadVersionWithLineAndColumn)
{
    EXPECT_EQ(errorOf("Package: a\nVersion: 1-\nArchitecture: all\n"),
              "index:2: field \"Version\": column 3: revision is empty");
}

TEST(PackageParagraph, RefusesABadDependencyWithLineAndColumn)
{
    EXPECT_EQ(errorOf(SMALLEST + "DEPENDS: b (>= 1\n"),
              "index:4: field \"DEPENDS\": column 8: found the end of the field instead of \")\"");
}

TEST(PackageParagraph, RefusesAlternativesWhereEveryPackageCounts)
{
    for (std::string const field : {"Conflicts", "Breaks", "Replaces", "Provides"})
    {
        EXPECT_EQ(errorOf(SMALLEST + field + ": x, b | c\n"),
                  "index:4: field \"" + field + "\": alternatives to \"b\" are not allowed");
    }
}

TEST(PackageParagraph, RefusesToProvideARangeOfVersions)
{
    EXPECT_EQ(errorOf(SMALLEST + "Provides: b (>= 1)\n"),
              "index:4: field \"Provides\": \"b\" has another relation than \"=\"");
}
