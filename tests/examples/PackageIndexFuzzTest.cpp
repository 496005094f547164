// Random input: every text is read or refused, and nothing else happens.

#include "reader/DependencyField.h"
#include "reader/SyntaxError.h"
#include "reader/Version.h"

#include "tests/examples/ReadText.h"

#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <vector>

using debian::ReadError;
using debian::SyntaxError;
using debian::Version;

namespace {

std::string const INDEX = R"(Package: one
Status: install ok installed
Version: 1:2.0-3
Architecture: amd64
Installed-Size: 12
Multi-Arch: same
Depends: libc6 (>= 2.36), two:any | three [amd64 !i386] <!nocheck>
Provides: four (= 2)
Description: first line
 second line with )"
                          "\xC3\xA9\n"
                          R"(
# comment
Package: two
Version: 3
Architecture: all
Conflicts: five (<< 1~)
)";

/// Pieces that the grammars are made of; random sequences of them get further than random bytes.
std::string joinPieces(std::vector<std::string> const& pieces)
{
    auto const sequence = *rc::gen::container<std::vector<std::string>>(rc::gen::elementOf(pieces));
    std::string text;
    for (std::string const& piece : sequence)
        text += piece;
    return text;
}

/// Reads an index. Any exception but `ReadError` fails the property; a located error names a line
/// that the text has.
void readOrRefuse(std::string const& text)
{
    try
    {
        for (auto const& package : test::readPackages(text))
        {
            RC_ASSERT(!package.package.empty());
            RC_ASSERT(!package.version.text().empty());
        }
    }
    catch (ReadError const& error)
    {
        auto const newlines = static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
        RC_ASSERT(error.line() <= newlines + 1);
        RC_ASSERT(!error.reason().empty());
    }
}

}  // namespace

RC_GTEST_PROP(PackageIndexFuzz, RandomBytesAreReadOrRefused, (std::string const& bytes))
{
    readOrRefuse(bytes);
}

RC_GTEST_PROP(PackageIndexFuzz, RandomLinesAreReadOrRefused, ())
{
    readOrRefuse(joinPieces({"Package",
                             "Version",
                             "Architecture",
                             "Depends",
                             "Status",
                             ": ",
                             ":",
                             "a",
                             "1",
                             "1.0-1",
                             "all",
                             "installed",
                             " ",
                             "\n",
                             "\n",
                             "\n\n",
                             "\r\n",
                             "#",
                             ",",
                             "|",
                             "(",
                             ">=",
                             ")",
                             "\t",
                             "-",
                             std::string(1, '\0'),
                             "\xC3",
                             "\xA9",
                             "Package: a\nVersion: 1\nArchitecture: all\n"}));
}

RC_GTEST_PROP(PackageIndexFuzz, AnIndexWithOneByteChangedIsReadOrRefused, (char byte))
{
    std::string text = INDEX;
    text[*rc::gen::inRange<std::size_t>(0, text.size())] = byte;

    readOrRefuse(text);
}

TEST(PackageIndexFuzz, AnIndexCutOffAnywhereIsRefusedUnlessAPackageIsComplete)
{
    std::size_t readable = 0;
    for (std::size_t length = 0; length < INDEX.size(); ++length)
    {
        std::string const text = INDEX.substr(0, length);
        try
        {
            test::readPackages(text);
            ++readable;
            EXPECT_TRUE(text.ends_with('\n'));
        }
        catch (ReadError const&)
        {
            EXPECT_TRUE(length == 0 || !text.ends_with('\n') ||
                        text.find("Architecture") == text.npos ||
                        text.rfind("Package:") > text.rfind("Architecture:"));
        }
    }
    // After each line from the first architecture on, save those from the second package's name to
    // its version.
    EXPECT_EQ(readable, 10u);
}

RC_GTEST_PROP(VersionFuzz, EveryTextIsAVersionOrRefused, ())
{
    std::string const text = *rc::gen::oneOf(
        rc::gen::arbitrary<std::string>(),
        rc::gen::container<std::string>(rc::gen::elementOf(std::string("019a~.+-:"))));
    try
    {
        Version const version(text);
        RC_ASSERT(version == version);
        RC_ASSERT(version.text() == text);
    }
    catch (SyntaxError const& error)
    {
        RC_ASSERT(error.column() >= 1u);
        RC_ASSERT(error.column() <= text.size() + 1);
    }
}

RC_GTEST_PROP(VersionFuzz, TheOrderIsTransitiveAndSymmetric, ())
{
    std::array<std::string, 3> texts;
    for (std::string& text : texts)
        text = "1" + *rc::gen::container<std::string>(rc::gen::elementOf(std::string("01a~.+:")));
    for (std::string& text : texts)
    {
        if (text.find(':') != text.npos)
            text = "0:" + text;
    }
    Version const a(texts[0]);
    Version const b(texts[1]);
    Version const c(texts[2]);

    RC_ASSERT((a < b) == (b > a));
    RC_ASSERT((a == b) == (b == a));
    if (a <= b && b <= c)
        RC_ASSERT(a <= c);
    if (a >= b && b >= c)
        RC_ASSERT(a >= c);
}

RC_GTEST_PROP(DependencyFieldFuzz, EveryTextIsAFieldOrRefused, ())
{
    std::string const text =
        *rc::gen::arbitrary<bool>()
            ? *rc::gen::arbitrary<std::string>()
            : joinPieces({"a",  "libc6", ":", "any", " ",   "(",        ")",        "<<",
                          ">=", "=",     "<", ">",   "1.0", "-",        "[",        "]",
                          "!",  "amd64", ",", "|",   "\n",  "a (>= 1)", "b [!i386]"});
    try
    {
        for (auto const& group : debian::parseDependencyField(text))
        {
            RC_ASSERT(!group.empty());
            RC_ASSERT(!group.front().package.empty());
        }
    }
    catch (SyntaxError const& error)
    {
        RC_ASSERT(error.column() >= 1u);
        RC_ASSERT(error.column() <= text.size() + 1);
    }
}
