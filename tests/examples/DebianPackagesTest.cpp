#include "tests/examples/LoadText.h"
#include "tests/examples/RunProgram.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <unistd.h>

namespace {

using test::paragraph;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

/// What a run of the program left behind.
struct Outcome
{
    int status;
    std::string output;
    std::string errors;
};

/// A directory with the files of one case, removed in the end.
class DebianPackages : public testing::Test
{
protected:
    DebianPackages()
        : directory(std::filesystem::temp_directory_path() /
                    ("debian-packages-test-" + std::to_string(getpid())))
    {
        std::filesystem::create_directory(directory);
    }
    ~DebianPackages() override { std::filesystem::remove_all(directory); }

    std::string path(std::string const& name) const { return directory / name; }
    std::string write(std::string const& name, std::string const& text) const
    {
        std::ofstream(path(name), std::ios::binary) << text;
        return path(name);
    }
    std::string read(std::string const& name) const
    {
        std::ifstream file(path(name), std::ios::binary);
        return std::string(std::istreambuf_iterator<char>(file), {});
    }
    /// \param arguments  as a shell takes them.
    Outcome run(std::string const& arguments, std::string const& input = "") const
    {
        write("input", input);
        int const status =
            test::runProgram({"sh", "-c",
                              DEBIAN_PACKAGES_PROGRAM " " + arguments + " <" + path("input") +
                                  " >" + path("output") + " 2>" + path("errors")});
        return {status, read("output"), read("errors")};
    }

    std::filesystem::path directory;
};

std::string const INDEX = paragraph("base", "Essential: yes\nPre-Depends: lib\n") +
                          paragraph("lib") + paragraph("editor", "Depends: spell, lib, gone\n") +
                          paragraph("spell", "Suggests: lost\n");

TEST_F(DebianPackages, RefusesReportsAndTakesBack)
{
    Outcome const result = run(write("index", INDEX));

    EXPECT_EQ(result.status, 0);
    EXPECT_EQ(result.errors, "");
    EXPECT_THAT(result.output, HasSubstr("index: 4 packages with 4 releases, 5 dependencies with 5 "
                                         "alternatives\n"));
    EXPECT_THAT(result.output, HasSubstr("named, but not in the file: 2\n"));
    EXPECT_THAT(result.output,
                HasSubstr("Removing lib, which an essential package needs\n"
                          "  refused: base 1 all has nothing left for Pre-Depends: lib\n"
                          "  after the rollback all 19 elements are as they were\n"));
    EXPECT_THAT(result.output, HasSubstr("Removing editor with what only it needs: 2 packages\n"));
    EXPECT_THAT(result.output,
                HasSubstr("destroyed Package spell; had releases = {spell 1 all}\n"));
    EXPECT_THAT(result.output, HasSubstr("  after the undo all 19 elements are as they were\n"));
}

TEST_F(DebianPackages, EndsWithATableOfFigures)
{
    Outcome const result = run(write("index", INDEX));

    std::string const table = result.output.substr(result.output.find("\nFigures\n"));
    for (char const* name : {"elements", "bytes per element", "load",
                             "refused removal and rollback", "removal and commit", "undo"})
        EXPECT_THAT(table, HasSubstr(std::string("\n  ") + name + ' ')) << name;
}

TEST_F(DebianPackages, ReadsStandardInput)
{
    Outcome const result = run("-", INDEX);

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("standard input: 4 packages with 4 releases"));
}

TEST_F(DebianPackages, ResolvesMissingPackagesInTheSecondFile)
{
    Outcome const result =
        run(write("index", INDEX) + ' ' + write("available", paragraph("gone") + paragraph("x")));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("available: 2 packages with 2 releases"));
    EXPECT_THAT(result.output,
                HasSubstr("of the missing packages of the first file 1 are here, 1 are not\n"));
    EXPECT_THAT(result.output, HasSubstr("  after the undo all 19 elements are as they were\n"));
}

TEST_F(DebianPackages, SaysIfThereIsNothingToRefuse)
{
    Outcome const result = run(write("index", paragraph("a")));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("No essential package needs another"));
    EXPECT_THAT(result.output, HasSubstr("Removing a with what only it needs: 1 packages\n"));
}

TEST_F(DebianPackages, ReportsAMissingFile)
{
    Outcome const result = run(path("nothing"));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.output, "");
    EXPECT_EQ(result.errors, "debian-packages: " + path("nothing") +
                                 ": cannot be opened: No such file or directory\n");
}

TEST_F(DebianPackages, ReportsAnEmptyFile)
{
    Outcome const result = run(write("index", ""));

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr("debian-packages: " + path("index") + ": "));
}

TEST_F(DebianPackages, ReportsWhereAFileIsCutOff)
{
    Outcome const result = run(write("index", INDEX + "Package: half\nVersi"));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.output, "");
    EXPECT_THAT(result.errors, HasSubstr(path("index") + ":22: file ends inside this line"));
}

TEST_F(DebianPackages, ReportsWhereAFileIsMalformed)
{
    Outcome const result = run("-", INDEX + "Package: a\nnonsense\n");

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.errors,
              "debian-packages: standard input:22: line has no colon after a field name\n");
}

TEST_F(DebianPackages, ReportsAMalformedSecondFile)
{
    Outcome const result = run(write("index", INDEX) + ' ' + write("available", "Package: a\n"));

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr(path("available") + ":1: "));
}

TEST_F(DebianPackages, ReportsADirectory)
{
    Outcome const result = run(directory.string());

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr(directory.string()));
}

TEST_F(DebianPackages, ExplainsItself)
{
    Outcome const result = run("--help");

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("Usage: debian-packages [FILE [AVAILABLE]]\n"));
}

TEST_F(DebianPackages, RefusesUnknownOptions)
{
    Outcome const result = run("--fast");

    EXPECT_EQ(result.status, 2);
    EXPECT_EQ(result.output, "");
    EXPECT_EQ(result.errors, "debian-packages: unknown option: --fast\n"
                             "Try debian-packages --help\n");
}

TEST_F(DebianPackages, DrawsNoProgressIntoAFile)
{
    Outcome const result = run(write("index", INDEX));

    EXPECT_THAT(result.errors, Not(HasSubstr("\r")));
}

}  // namespace
