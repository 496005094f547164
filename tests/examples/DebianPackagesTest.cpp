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
using testing::EndsWith;
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
class FilesOfACase : public testing::Test
{
protected:
    FilesOfACase()
        : directory(std::filesystem::temp_directory_path() /
                    ("debian-packages-test-" + std::to_string(getpid())))
    {
        std::filesystem::create_directory(directory);
    }
    ~FilesOfACase() override { std::filesystem::remove_all(directory); }

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
    /// \param command  as a shell takes it.
    Outcome runCommand(std::string const& command, std::string const& input) const
    {
        write("input", input);
        int const status = test::runProgram(
            {"sh", "-c",
             command + " <" + path("input") + " >" + path("output") + " 2>" + path("errors")});
        return {status, read("output"), read("errors")};
    }

    std::filesystem::path directory;
};

/// Runs the program, its parameter being the option for the form.
class DebianPackages : public FilesOfACase, public testing::WithParamInterface<std::string>
{
protected:
    Outcome run(std::string const& arguments, std::string const& input = "") const
    {
        return runCommand(DEBIAN_PACKAGES_PROGRAM " " + GetParam() + ' ' + arguments, input);
    }
};

INSTANTIATE_TEST_SUITE_P(OfBothForms, DebianPackages, testing::Values("", "--reflective"),
                         [](auto const& form) {
                             return std::string(form.param.empty() ? "Generated" : "Reflective");
                         });

std::string const INDEX = paragraph("base", "Essential: yes\nPre-Depends: lib\n") +
                          paragraph("lib") + paragraph("editor", "Depends: spell, lib, gone\n") +
                          paragraph("spell", "Suggests: lost\n");

TEST_P(DebianPackages, RefusesReportsAndTakesBack)
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

TEST_P(DebianPackages, EndsWithATableOfFigures)
{
    Outcome const result = run(write("index", INDEX));

    std::string const table = result.output.substr(result.output.find("\nFigures\n"));
    for (char const* name : {"elements", "bytes per element", "load",
                             "refused removal and rollback", "removal and commit", "undo"})
        EXPECT_THAT(table, HasSubstr(std::string("\n  ") + name + ' ')) << name;
}

TEST_P(DebianPackages, AsksAllQuestionsIfNoneIsAsked)
{
    Outcome const result = run(write("index", INDEX));

    for (char const* title : {"Unmet dependencies", "Unmet recommendations",
                              "Packages that depend on one of the same maintainer",
                              "The largest packages that match \"^lib\"", "Dependencies on lib",
                              "Tagging as obsolete the packages that match \"-dev$\": 0",
                              "Packages with the tag", "Packages with the tag after the rollback"})
        EXPECT_THAT(result.output, HasSubstr(std::string("\n\n") + title + '\n')) << title;
    EXPECT_THAT(result.output, testing::ContainsRegex("  editor   1 all    Depends: gone\n"
                                                      "  1 row in [0-9.]+ ms\n"));
    EXPECT_THAT(result.output, testing::ContainsRegex("\n  query: same maintainer +[0-9.]+ ms\n"));
}

TEST_P(DebianPackages, AnswersTheQuestionsAskedAndNoOthers)
{
    Outcome const result = run("--limit 1 --reverse lib --tag ^spell$ " + write("index", INDEX));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, AllOf(Not(HasSubstr("Removing")), Not(HasSubstr("Unmet"))));
    EXPECT_THAT(result.output,
                testing::ContainsRegex("\nDependencies on lib\n"
                                       "  package  release  dependency\n"
                                       "  -------  -------  ----------------\n"
                                       "  base     1 all    Pre-Depends: lib\n"
                                       "  ... and 1 more\n"
                                       "  2 rows in [0-9.]+ ms\n"
                                       "\n"
                                       "Tagging as obsolete the packages that match .*: 1\n"
                                       "\n"
                                       "Packages with the tag\n"
                                       "  package  releases\n"
                                       "  -------  --------\n"
                                       "  spell           1\n"
                                       "  1 row in [0-9.]+ ms\n"
                                       "\n"
                                       "Packages with the tag after the rollback\n"
                                       "  0 rows in [0-9.]+ ms\n"));
}

TEST_P(DebianPackages, ReportsAPatternThatIsNone)
{
    for (std::string const option : {"--largest", "--tag"})
    {
        Outcome const result = run(option + " '(lib' " + write("index", INDEX));

        EXPECT_EQ(result.status, 1);
        EXPECT_THAT(result.errors, AllOf(testing::StartsWith("debian-packages: "),
                                         EndsWith(" of the pattern \"(lib\"\n")));
    }
}

TEST_P(DebianPackages, ReportsANameThatNobodyKnows)
{
    Outcome const result = run("--reverse other " + write("index", INDEX));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.errors,
              "debian-packages: neither a package nor a dependency is called \"other\"\n");
}

TEST_P(DebianPackages, ReadsStandardInput)
{
    Outcome const result = run("-", INDEX);

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("standard input: 4 packages with 4 releases"));
}

TEST_P(DebianPackages, ResolvesMissingPackagesInTheSecondFile)
{
    Outcome const result =
        run(write("index", INDEX) + ' ' + write("available", paragraph("gone") + paragraph("x")));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("available: 2 packages with 2 releases"));
    EXPECT_THAT(result.output,
                HasSubstr("of the missing packages of the first file 1 are here, 1 are not\n"));
    EXPECT_THAT(result.output, HasSubstr("  after the undo all 19 elements are as they were\n"));
}

TEST_P(DebianPackages, SaysIfThereIsNothingToRefuse)
{
    Outcome const result = run(write("index", paragraph("a")));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, HasSubstr("No essential package needs another"));
    EXPECT_THAT(result.output, HasSubstr("Removing a with what only it needs: 1 packages\n"));
}

TEST_P(DebianPackages, ReportsAMissingFile)
{
    Outcome const result = run(path("nothing"));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.output, "");
    EXPECT_EQ(result.errors, "debian-packages: " + path("nothing") +
                                 ": cannot be opened: No such file or directory\n");
}

TEST_P(DebianPackages, ReportsAnEmptyFile)
{
    Outcome const result = run(write("index", ""));

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr("debian-packages: " + path("index") + ": "));
}

TEST_P(DebianPackages, ReportsWhereAFileIsCutOff)
{
    Outcome const result = run(write("index", INDEX + "Package: half\nVersi"));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.output, "");
    EXPECT_THAT(result.errors, HasSubstr(path("index") + ":22: file ends inside this line"));
}

TEST_P(DebianPackages, ReportsWhereAFileIsMalformed)
{
    Outcome const result = run("-", INDEX + "Package: a\nnonsense\n");

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.errors,
              "debian-packages: standard input:22: line has no colon after a field name\n");
}

TEST_P(DebianPackages, ReportsAMalformedSecondFile)
{
    Outcome const result = run(write("index", INDEX) + ' ' + write("available", "Package: a\n"));

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr(path("available") + ":1: "));
}

TEST_P(DebianPackages, ReportsADirectory)
{
    Outcome const result = run(directory.string());

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, HasSubstr(directory.string()));
}

TEST_P(DebianPackages, ExplainsItself)
{
    Outcome const result = run("--help");

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output,
                HasSubstr("Usage: debian-packages [OPTION]... [FILE [AVAILABLE]]\n"));
}

TEST_P(DebianPackages, RefusesUnknownOptions)
{
    Outcome const result = run("--fast");

    EXPECT_EQ(result.status, 2);
    EXPECT_EQ(result.output, "");
    EXPECT_EQ(result.errors, "debian-packages: unknown option: --fast\n"
                             "Try debian-packages --help\n");
}

TEST_P(DebianPackages, DrawsNoProgressIntoAFile)
{
    Outcome const result = run(write("index", INDEX));

    EXPECT_THAT(result.errors, Not(HasSubstr("\r")));
}

TEST_P(DebianPackages, WritesTheFiguresIntoAFile)
{
    Outcome const result = run("--figures " + path("figures") + ' ' + write("index", INDEX));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, Not(HasSubstr("Figures")));
    EXPECT_THAT(read("figures"), AllOf(HasSubstr("elements\t19\n"), HasSubstr("\nload\t"),
                                       HasSubstr("\nundo\t"), EndsWith(" ms\n")));
}

TEST_P(DebianPackages, ReportsThatTheFiguresCanNotBeWritten)
{
    std::string const place = path("no folder/figures");

    Outcome const result = run("--figures '" + place + "' " + write("index", INDEX));

    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.errors, "debian-packages: " + place + ": cannot be written\n");
}

/// Runs a program in both forms.
class SideBySide : public FilesOfACase
{
protected:
    Outcome run(std::string const& arguments, std::string const& input = "") const
    {
        return runProgram(DEBIAN_PACKAGES_PROGRAM, arguments, input);
    }
    Outcome runProgram(std::string const& program, std::string const& arguments,
                       std::string const& input = "") const
    {
        return runCommand(DEBIAN_PACKAGES_SIDE_BY_SIDE " " + program + ' ' + arguments, input);
    }
};

TEST_F(SideBySide, PrintsTheResultsOnceAndTheFiguresOfBothForms)
{
    Outcome const result = run(write("index", INDEX) + ' ' + write("more", paragraph("gone")));

    EXPECT_EQ(result.status, 0);
    EXPECT_EQ(result.errors, "");
    std::size_t const end = result.output.find(" generated  ");
    ASSERT_NE(end, std::string::npos);
    std::string const results = result.output.substr(0, end);
    EXPECT_NE(results.find("Removing editor"), std::string::npos);
    EXPECT_EQ(results.find("Removing editor"), results.rfind("Removing editor"));
    EXPECT_THAT(result.output.substr(end),
                AllOf(testing::ContainsRegex("generated +run-time\n"),
                      testing::ContainsRegex("\n  elements +19 +19\n"),
                      testing::ContainsRegex("\n  load +[0-9.]+ ms +[0-9.]+ ms\n")));
}

TEST_F(SideBySide, GivesStandardInputToBoth)
{
    Outcome const result = run("-", INDEX);

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output, testing::ContainsRegex("\n  elements +19 +19\n"));
}

TEST_F(SideBySide, AsksBothFormsTheQuestions)
{
    Outcome const result = run("--same-maintainer --unmet " + write("index", INDEX));

    EXPECT_EQ(result.status, 0);
    EXPECT_THAT(result.output,
                AllOf(testing::ContainsRegex("\n  1 row in [0-9.]+ ms\n"),
                      testing::ContainsRegex("\n  query: unmet dependencies +[0-9.]+ ms +[0-9.]+ "
                                             "ms\n")));
}

TEST_F(SideBySide, FailsAsTheProgramDoes)
{
    Outcome const malformed = run("-", INDEX + "nonsense\n");
    Outcome const misused = run("--fast");

    EXPECT_EQ(malformed.status, 1);
    EXPECT_EQ(malformed.output, "");
    EXPECT_EQ(malformed.errors,
              "debian-packages: standard input:21: line has no colon after a field name\n");
    EXPECT_EQ(misused.status, 2);
}

TEST_F(SideBySide, FailsIfTheResultsDiffer)
{
    std::string const program =
        write("program", "#!/bin/sh\nprintf 'load\\t1 ms\\n' > \"$2\"\necho \"$3\"\n");

    std::filesystem::permissions(program, std::filesystem::perms::owner_all);

    Outcome const result = runProgram(program, "index");

    EXPECT_EQ(result.status, 1);
    EXPECT_THAT(result.errors, AllOf(HasSubstr("the forms have different results"),
                                     HasSubstr("\n-index\n"), HasSubstr("\n+--reflective\n")));
}

}  // namespace
