#include "reader/PackageReader.h"

#include "tests/examples/ReadText.h"
#include "tests/examples/RunProgram.h"

#include <algorithm>
#include <filesystem>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

using debian::ControlFile;
using debian::PackageReader;

namespace {

std::string paragraph(std::string const& name, std::string const& status)
{
    return "Package: " + name + "\nStatus: " + status + "\nVersion: 1\nArchitecture: all\n\n";
}

}  // namespace

TEST(PackageReader, GivesOnlyTheInstalledPackagesOfAStatusFile)
{
    std::istringstream stream(
        paragraph("a", "install ok installed") + paragraph("b", "deinstall ok config-files") +
        paragraph("c", "install ok half-installed") + paragraph("d", "unknown ok not-installed") +
        paragraph("e", "install ok unpacked") + paragraph("f", "hold ok installed"));
    ControlFile file(stream, "index");
    PackageReader reader(file);

    EXPECT_EQ(reader.next()->package, "a");
    EXPECT_EQ(reader.next()->package, "f");
    EXPECT_FALSE(reader.next());
    EXPECT_EQ(reader.skippedCount(), 4u);
}

TEST(PackageReader, GivesAllPackagesOfAnIndexWithoutStatus)
{
    auto const packages = test::readPackages("Package: a\nVersion: 1\nArchitecture: all\n\n"
                                             "Package: a\nVersion: 2\nArchitecture: all\n");

    ASSERT_EQ(packages.size(), 2u);
    EXPECT_EQ(packages[0].version.text(), "1");
    EXPECT_EQ(packages[1].version.text(), "2");
}

TEST(PackageReader, DoesNotAskAPackageThatIsNotInstalledForItsVersion)
{
    auto const packages = test::readPackages("Package: a\nStatus: unknown ok not-installed\n\n" +
                                             paragraph("b", "install ok installed"));

    ASSERT_EQ(packages.size(), 1u);
    EXPECT_EQ(packages[0].package, "b");
}

TEST(PackageReader, GivesNothingFromAStatusFileWithoutInstalledPackages)
{
    EXPECT_TRUE(test::readPackages(paragraph("a", "unknown ok not-installed")).empty());
}

TEST(PackageReader, FindsThePackagesThatDpkgCallsInstalledOnThisMachine)
{
    std::filesystem::path const status = "/var/lib/dpkg/status";
    if (test::runProgram({"dpkg-query", "--version"}) != 0 || !std::filesystem::exists(status))
        GTEST_SKIP() << "dpkg-query or its status file is missing";

    std::vector<std::string> expected;
    std::istringstream lines(test::outputOf(
        {"dpkg-query", "-W", "-f", "${db:Status-Status} ${Package} ${Version} ${Architecture}\n"}));
    for (std::string line; std::getline(lines, line);)
    {
        if (line.starts_with("installed "))
            expected.push_back(line);
    }

    std::vector<std::string> found;
    ControlFile file(status);
    PackageReader reader(file);
    while (auto const package = reader.next())
        found.push_back("installed " + package->package + " " + package->version.text() + " " +
                        package->architecture);

    std::sort(expected.begin(), expected.end());
    std::sort(found.begin(), found.end());
    EXPECT_GT(found.size(), 0u);
    EXPECT_EQ(found, expected);
}
