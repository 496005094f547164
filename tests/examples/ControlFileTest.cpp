#include "reader/ControlFile.h"

#include "tests/examples/ReadText.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <unistd.h>

using debian::ControlFile;
using debian::Paragraph;
using debian::ReadError;
using test::readParagraphs;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

std::string errorOf(std::string const& text)
{
    return test::errorOf(readParagraphs, text);
}

/// A path below the directory for temporary files, gone at the end of the test.
class TemporaryPath
{
public:
    TemporaryPath()
        : m_path(std::filesystem::path(testing::TempDir()) /
                 ("control-file-test-" + std::to_string(getpid())))
    {}
    ~TemporaryPath() { std::filesystem::remove(m_path); }
    TemporaryPath(TemporaryPath const&) = delete;
    TemporaryPath& operator=(TemporaryPath const&) = delete;

    std::filesystem::path const& get() const { return m_path; }

private:
    std::filesystem::path m_path;
};

}  // namespace

TEST(ControlFile, GivesTheFieldsOfAParagraphInTheirOrder)
{
    auto const paragraphs = readParagraphs("Package: zlib1g\nVersion:1.2\nEmpty:\n");

    ASSERT_EQ(paragraphs.size(), 1u);
    ASSERT_EQ(paragraphs[0].fieldCount(), 3u);
    EXPECT_EQ(paragraphs[0].fieldAt(0).name, "Package");
    EXPECT_EQ(paragraphs[0].fieldAt(0).value, "zlib1g");
    EXPECT_EQ(paragraphs[0].fieldAt(1).value, "1.2");
    EXPECT_EQ(paragraphs[0].fieldAt(2).value, "");
}

TEST(ControlFile, SeparatesParagraphsByEmptyAndBlankLines)
{
    auto const paragraphs = readParagraphs("\n \t\nA: 1\n\nA: 2\n \t \n\nA: 3\n\n\n");

    ASSERT_EQ(paragraphs.size(), 3u);
    EXPECT_EQ(paragraphs[0].find("A")->value, "1");
    EXPECT_EQ(paragraphs[1].find("A")->value, "2");
    EXPECT_EQ(paragraphs[2].find("A")->value, "3");
}

TEST(ControlFile, JoinsTheLinesOfAFoldedField)
{
    auto const paragraphs = readParagraphs("A: one  \n two\n\t.\nB:\n three\n");

    EXPECT_EQ(paragraphs.at(0).find("A")->value, "one\n two\n\t.");
    EXPECT_EQ(paragraphs.at(0).find("B")->value, "\n three");
}

TEST(ControlFile, IgnoresCommentsEvenInsideAFoldedField)
{
    auto const paragraphs = readParagraphs("# head\nA: one\n#: not a field\n two\n#\nB: 2\n");

    ASSERT_EQ(paragraphs.size(), 1u);
    EXPECT_EQ(paragraphs[0].fieldCount(), 2u);
    EXPECT_EQ(paragraphs[0].find("A")->value, "one\n two");
}

TEST(ControlFile, KeepsAHashThatDoesNotBeginALine)
{
    EXPECT_EQ(readParagraphs("A: # b\n # c\n").at(0).find("A")->value, "# b\n # c");
}

TEST(ControlFile, FindsFieldsInAnyCase)
{
    auto const paragraph = readParagraphs("Multi-Arch: same\n").at(0);

    EXPECT_EQ(paragraph.find("MULTI-arch")->value, "same");
    EXPECT_EQ(paragraph.find("multi-arch")->name, "Multi-Arch");
    EXPECT_FALSE(paragraph.find("Multi"));
    EXPECT_FALSE(paragraph.find("Multi-Arch-"));
}

TEST(ControlFile, TakesCarriageReturnsBeforeNewlinesAsPartOfTheLineEnd)
{
    auto const paragraphs = readParagraphs("A: one\r\n two\r\n\r\nA: x\ry\r\n");

    ASSERT_EQ(paragraphs.size(), 2u);
    EXPECT_EQ(paragraphs[0].find("A")->value, "one\n two");
    EXPECT_EQ(paragraphs[1].find("A")->value, "x\ry");
}

TEST(ControlFile, KnowsTheLineOfEachField)
{
    auto const paragraph = readParagraphs("\n# comment\nA: 1\n 2\n#\nB: 3\n").at(0);

    EXPECT_EQ(paragraph.line(), 3u);
    EXPECT_EQ(paragraph.find("A")->line, 3u);
    EXPECT_EQ(paragraph.find("B")->line, 6u);
}

TEST(ControlFile, KeepsColonsAndUnicodeInValues)
{
    EXPECT_EQ(readParagraphs("A: b: \xC3\xA9\n").at(0).find("A")->value, "b: \xC3\xA9");
}

TEST(ControlFile, LeavesTheParagraphEmptyAtTheEndHoweverOftenItIsAsked)
{
    std::istringstream stream("A: 1\n");
    ControlFile file(stream, "index");
    Paragraph paragraph;

    EXPECT_TRUE(file.next(paragraph));
    EXPECT_FALSE(file.next(paragraph));
    EXPECT_TRUE(paragraph.isEmpty());
    EXPECT_FALSE(file.next(paragraph));
}

TEST(ControlFile, ReadsLinesAndParagraphsLongerThanABlock)
{
    std::string const longLine(700'000, 'x');
    std::string text = "A: " + longLine + "\n";
    for (int i = 0; i < 60'000; ++i)
        text += " line " + std::to_string(i) + "\n";
    text += "\nB: 2\n";

    auto const paragraphs = readParagraphs(text);

    ASSERT_EQ(paragraphs.size(), 2u);
    EXPECT_THAT(std::string(paragraphs[0].find("A")->value), StartsWith(longLine + "\n line 0\n"));
    EXPECT_THAT(std::string(paragraphs[0].find("A")->value), EndsWith("\n line 59999"));
    EXPECT_EQ(paragraphs[1].line(), 60'003u);
}

TEST(ControlFile, ReadsAFileOfTheDisk)
{
    TemporaryPath const path;
    std::ofstream(path.get()) << "A: 1\n\nA: 2\n";

    ControlFile file(path.get());
    Paragraph paragraph;

    EXPECT_TRUE(file.next(paragraph));
    EXPECT_TRUE(file.next(paragraph));
    EXPECT_EQ(paragraph.find("A")->value, "2");
    EXPECT_FALSE(file.next(paragraph));
}

TEST(ControlFile, RefusesAMissingFile)
{
    TemporaryPath const path;

    try
    {
        ControlFile file(path.get());
        FAIL() << "the file was opened";
    }
    catch (ReadError const& error)
    {
        EXPECT_EQ(error.file(), path.get().string());
        EXPECT_EQ(error.line(), 0u);
        EXPECT_EQ(error.reason(), "cannot be opened: No such file or directory");
    }
}

TEST(ControlFile, RefusesADirectory)
{
    auto const readDirectory = [] {
        ControlFile file(std::filesystem::path(testing::TempDir()));
        Paragraph paragraph;
        file.next(paragraph);
    };

    EXPECT_THROW(readDirectory(), ReadError);
}

TEST(ControlFile, RefusesAFileWithoutParagraph)
{
    EXPECT_EQ(errorOf(""), "index: file has no paragraph");
    EXPECT_EQ(errorOf("\n \n# only a comment\n"), "index: file has no paragraph");
}

TEST(ControlFile, RefusesAFileThatEndsInsideALine)
{
    EXPECT_EQ(errorOf("A: 1\n\nA: 2"), "index:3: file ends inside this line; it may be cut off");
    EXPECT_EQ(errorOf("A: 1\n "), "index:2: file ends inside this line; it may be cut off");
}

TEST(ControlFile, RefusesALineWithoutColon)
{
    EXPECT_EQ(errorOf("A: 1\nversion\n"), "index:2: line has no colon after a field name");
}

TEST(ControlFile, RefusesAContinuationThatContinuesNothing)
{
    EXPECT_EQ(errorOf(" a\n"), "index:1: continuation line before any field");
    EXPECT_EQ(errorOf("A: 1\n\n\tb\n"), "index:3: continuation line before any field");
}

TEST(ControlFile, RefusesWrongCharactersInFieldNames)
{
    EXPECT_EQ(errorOf("A b: 1\n"), "index:1: character not allowed in a field name at column 2");
    EXPECT_EQ(errorOf("A : 1\n"), "index:1: character not allowed in a field name at column 2");
    EXPECT_EQ(errorOf("-A: 1\n"), "index:1: character not allowed in a field name at column 1");
    EXPECT_EQ(errorOf("\xC3\xA4: 1\n"),
              "index:1: character not allowed in a field name at column 1");
    EXPECT_EQ(errorOf("A\x7F: 1\n"), "index:1: character not allowed in a field name at column 2");
    EXPECT_EQ(errorOf(": 1\n"), "index:1: field name is empty");
}

TEST(ControlFile, RefusesAFieldThatStandsTwiceInAParagraphInWhateverCase)
{
    EXPECT_EQ(errorOf("Aa: 1\nB: 1\naA: 2\n"),
              "index:3: field \"aA\" stands twice in its paragraph");
}

TEST(ControlFile, RefusesNulBytesAlsoInComments)
{
    EXPECT_EQ(errorOf(std::string("A: x\0y\n", 7)), "index:1: NUL byte at column 5");
    EXPECT_EQ(errorOf(std::string("A: 1\n#\0\n", 8)), "index:2: NUL byte at column 2");
}

TEST(ControlFile, RefusesInvalidUtf8)
{
    EXPECT_EQ(errorOf("A: caf\xE9\n"), "index:1: invalid UTF-8 at column 7");
    EXPECT_EQ(errorOf("A: 1\nB: \xC3\n\xA9\n"), "index:2: invalid UTF-8 at column 4");
}

TEST(ControlFile, RefusesAParagraphWithTooManyFields)
{
    std::string text;
    for (std::size_t i = 0; i < ControlFile::MAX_FIELDS; ++i)
        text += "Field-" + std::to_string(i) + ": x\n";

    EXPECT_EQ(readParagraphs(text).size(), 1u);
    EXPECT_EQ(errorOf(text + "One-More: x\n"), "index:257: paragraph has more than 256 fields");
}

TEST(ControlFile, RefusesAParagraphThatIsTooLong)
{
    std::string const line = " " + std::string(1'000'000, 'x') + "\n";
    std::string text = "A:\n";
    for (int i = 0; i < 17; ++i)
        text += line;

    EXPECT_EQ(errorOf(text), "index:18: paragraph is longer than 16777216 bytes");
}

TEST(ControlFile, RefusesALineThatIsTooLong)
{
    std::string const text = "A: 1\nB: " + std::string(std::size_t(40) << 20, 'x') + "\n";

    EXPECT_EQ(errorOf(text), "index:2: line is longer than 16777216 bytes");
}
