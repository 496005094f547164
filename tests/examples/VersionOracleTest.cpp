// Versions, judged by the dpkg of the machine.

#include "reader/SyntaxError.h"
#include "reader/Version.h"

#include "tests/examples/RunProgram.h"

#include <gtest/gtest.h>

#include <array>
#include <random>
#include <string>
#include <string_view>

using debian::Version;

namespace {

class VersionOracle : public testing::Test
{
protected:
    void SetUp() override
    {
        if (test::runProgram({"dpkg", "--version"}) != 0)
            GTEST_SKIP() << "dpkg is not installed";
    }
};

/// What `dpkg --compare-versions` calls the order of the two.
std::string relationOf(Version const& left, Version const& right)
{
    auto const order = left <=> right;
    return order < 0 ? "lt" : order > 0 ? "gt" : "eq";
}

bool dpkgConfirms(std::string const& left, std::string const& relation, std::string const& right)
{
    return test::runProgram({"dpkg", "--compare-versions", left, relation, right}) == 0;
}

struct Pair
{
    char const* left;
    char const* relation;
    char const* right;
};

constexpr Pair PAIRS[] = {
    // Numbers are numbers.
    {"1.9", "lt", "1.10"},
    {"1", "lt", "1.0"},
    {"1.0", "lt", "1.0.0"},
    {"1.2", "gt", "1.1.99"},
    {"09", "lt", "10"},
    {"9", "eq", "09"},
    {"1.001", "eq", "1.1"},
    {"1.0010", "eq", "1.10"},
    {"1.0", "eq", "1.000"},
    {"1.", "eq", "1.0"},
    {"1a", "eq", "1a0"},
    {"1.0.", "eq", "1.0.0"},
    // Digit runs longer than any machine word.
    {"1.18446744073709551616", "gt", "1.18446744073709551615"},
    {"1.99999999999999999999999", "lt", "1.100000000000000000000000"},
    {"1.000000000000000000000000000002", "gt", "1.1"},
    {"1.000000000000000000000000000001", "eq", "1.1"},
    {"20240101000000000000000001", "gt", "20240101000000000000000000"},
    // A tilde sorts before everything, even the end.
    {"1.0~rc1", "lt", "1.0"},
    {"1.0~", "lt", "1.0"},
    {"1.0~~", "lt", "1.0~"},
    {"1.0~~a", "lt", "1.0~"},
    {"1.0~rc1", "lt", "1.0~rc2"},
    {"1.0~rc1", "gt", "1.0~beta9"},
    {"1.0~rc10", "gt", "1.0~rc9"},
    {"1.0~1", "gt", "1.0~"},
    {"1.0~0", "eq", "1.0~"},
    {"1.0~", "lt", "1.0a"},
    {"1.0-1~bpo12+1", "lt", "1.0-1"},
    {"1.0-1~bpo12+1", "gt", "1.0-1~bpo11+1"},
    {"1.0~-1", "lt", "1.0-1"},
    // Letters sort before other characters, and by ASCII.
    {"1.0a", "lt", "1.0+"},
    {"1.0Z", "lt", "1.0a"},
    {"1.0a", "gt", "1.0"},
    {"1.0a", "lt", "1.0b"},
    {"1.0a", "lt", "1.0aa"},
    {"1.0a1", "lt", "1.0aa"},
    {"1.0a", "lt", "1.0.1"},
    {"1.0+", "lt", "1.0."},
    {"1.0+dfsg", "gt", "1.0"},
    {"1.0+dfsg", "lt", "1.0.1"},
    {"1.0+dfsg1", "lt", "1.0+dfsg2"},
    {"1.0+git20240101", "gt", "1.0+dfsg9"},
    {"1.0+-1", "lt", "1.0--1"},
    {"1.0-a-1", "lt", "1.0.a-1"},
    {"1a2", "lt", "1a10"},
    {"1a2b", "gt", "1a2"},
    // Epochs win, and zero is the default.
    {"1:0.1", "gt", "99.9"},
    {"0:1.0", "eq", "1.0"},
    {"00:1.0", "eq", "0:1.0"},
    {"010:1.0", "gt", "9:2.0"},
    {"2:1.0", "gt", "1:9.0"},
    {"2147483647:1", "gt", "2147483646:2"},
    {"1:2:3", "lt", "1:2:4"},
    {"1:2:3", "gt", "1:2.3"},
    // Revisions count last, and zero is the default.
    {"1.0", "eq", "1.0-0"},
    {"1.0-0", "eq", "1.0-00"},
    {"1.0", "lt", "1.0-1"},
    {"1.0", "gt", "1.0-~"},
    {"1.0", "lt", "1.0-a"},
    {"1.0-1", "lt", "1.0-1.1"},
    {"1.0-1", "lt", "1.0-1+b1"},
    {"1.0-2", "lt", "1.0-10"},
    {"1.0-9", "lt", "1.0.1-1"},
    {"1.0-1-1", "gt", "1.0-1"},
    {"1.0-1ubuntu1", "gt", "1.0-1build2"},
};

/// Makes valid versions from few characters, so that two of them often begin alike.
class VersionMaker
{
public:
    std::string makeVersion()
    {
        std::string version;
        if (chance(4))
            version += pick("0123") + std::string(":");
        version += pick("0129") + makePart("0012a.+~B9", 6);
        if (chance(2))
            version += "-" + makePart("0012a.+~9", 4) + pick("01a~");
        return version;
    }

    /// The version, or one that differs from it by a character more or less behind its beginning.
    std::string makeNeighbour(std::string version)
    {
        std::size_t const begin = version.find(':') == version.npos ? 1 : version.find(':') + 2;
        std::size_t const place = begin + next(version.size() - begin + 1);
        if (place + 1 < version.size() && version[place] != '-' && chance(3))
            version.erase(place, 1);
        else
            version.insert(place, 1, pick("01a.+~"));
        return version;
    }

    bool chance(std::size_t outOf) { return next(outOf) == 0; }

private:
    std::size_t next(std::size_t bound) { return m_random() % bound; }
    char pick(std::string_view characters) { return characters[next(characters.size())]; }

    std::string makePart(std::string_view characters, std::size_t maximum)
    {
        std::string part;
        for (std::size_t length = next(maximum + 1); length > 0; --length)
            part += pick(characters);
        return part;
    }

    std::mt19937 m_random{20230610};
};

constexpr std::array INVALID = {
    "",     " ",       "abc",   "1.0-",         ":1",           "a:1",   "1:",
    "1:-1", "1.0_2",   "1 0",   "2147483648:1", "1.0-a_b",      "1.0:2", "~1",
    "+1",   "1.0-1:2", "0x1:2", "1.0/2",        "1.0-\xC3\xA9",
};

}  // namespace

TEST_F(VersionOracle, AgreesOnPairsPickedByHand)
{
    for (auto const& [left, relation, right] : PAIRS)
    {
        SCOPED_TRACE(std::string(left) + " " + relation + " " + right);

        EXPECT_EQ(relationOf(Version(left), Version(right)), relation);
        std::string const reversed(relation == std::string("lt")   ? "gt"
                                   : relation == std::string("gt") ? "lt"
                                                                   : "eq");
        EXPECT_EQ(relationOf(Version(right), Version(left)), reversed);
        EXPECT_TRUE(dpkgConfirms(left, relation, right));
    }
}

TEST_F(VersionOracle, AgreesOnRandomVersions)
{
    VersionMaker maker;
    for (int i = 0; i < 160; ++i)
    {
        std::string const left = maker.makeVersion();
        std::string const right = maker.chance(4) ? maker.makeVersion() : maker.makeNeighbour(left);
        std::string const relation = relationOf(Version(left), Version(right));

        EXPECT_TRUE(dpkgConfirms(left, relation, right)) << left << ' ' << relation << ' ' << right;
    }
}

TEST_F(VersionOracle, AgreesOnWhatIsNoVersion)
{
    for (std::string const text : INVALID)
    {
        EXPECT_THROW(Version{text}, debian::SyntaxError) << text;
        EXPECT_NE(test::runProgram({"dpkg", "--validate-version", text}), 0) << text;
    }
}
