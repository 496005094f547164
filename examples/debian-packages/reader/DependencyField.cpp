#include "reader/DependencyField.h"

#include "reader/Ascii.h"
#include "reader/PackageName.h"
#include "reader/SyntaxError.h"

#include <array>
#include <cstdio>
#include <utility>

namespace debian {
namespace {

struct Operator
{
    std::string_view text;
    VersionRelation relation;
};

constexpr std::array<Operator, 7> OPERATORS = {{
    {"<<", VersionRelation::StrictlyEarlier},
    {"<=", VersionRelation::EarlierOrEqual},
    {"=", VersionRelation::Equal},
    {">=", VersionRelation::LaterOrEqual},
    {">>", VersionRelation::StrictlyLater},
    {"<", VersionRelation::EarlierOrEqual},
    {">", VersionRelation::LaterOrEqual},
}};

bool isSpace(char c)
{
    return ascii::isBlank(c) || c == '\n';
}

bool mayStandInOperator(char c)
{
    return c == '<' || c == '=' || c == '>';
}

bool mayStandInVersion(char c)
{
    return c != ')' && !isSpace(c);
}

/// A recursive-descent parser; each function reads the grammar rule that it is named after.
class Parser
{
public:
    explicit Parser(std::string_view text) : m_text(text) {}

    std::vector<RelationGroup> readField()
    {
        std::vector<RelationGroup> groups;
        skipSpace();
        if (atEnd())
            return groups;
        do
            groups.push_back(readGroup());
        while (accept(','));
        if (!atEnd())
            fail("\",\" or \"|\"");
        return groups;
    }

private:
    RelationGroup readGroup()
    {
        RelationGroup group;
        do
            group.push_back(readRelation());
        while (accept('|'));
        return group;
    }

    PackageRelation readRelation()
    {
        skipSpace();
        PackageRelation relation;
        relation.package = readName(mayStandInPackageName, "a package name");
        if (!atEnd() && m_text[m_position] == ':')
        {
            ++m_position;
            relation.architecture = readName(mayStandInArchitecture, "an architecture");
        }
        if (accept('('))
            relation.bound = readBound();
        if (accept('['))
            relation.restrictions = readRestrictions();
        while (accept('<'))
            skipProfiles();
        return relation;
    }

    VersionBound readBound()
    {
        skipSpace();
        VersionRelation const relation = readOperator();
        skipSpace();
        std::size_t const begin = m_position;
        std::string_view const text = takeWhile(mayStandInVersion);
        expect(')');
        try
        {
            return {relation, Version(std::string(text))};
        }
        catch (SyntaxError const& error)
        {
            // Its column counts from the start of the version.
            throw SyntaxError(begin + error.column(), error.reason());
        }
    }

    VersionRelation readOperator()
    {
        std::size_t const begin = m_position;
        std::string_view const text = takeWhile(mayStandInOperator);
        for (Operator const& candidate : OPERATORS)
        {
            if (candidate.text == text)
                return candidate.relation;
        }
        m_position = begin;
        fail("one of << <= = >= >>");
    }

    std::vector<ArchitectureRestriction> readRestrictions()
    {
        std::vector<ArchitectureRestriction> restrictions;
        do
        {
            bool const excluded = accept('!');
            restrictions.push_back({readName(mayStandInArchitecture, "an architecture"), excluded});
        }
        while (!accept(']'));
        return restrictions;
    }

    void skipProfiles()
    {
        do
        {
            accept('!');
            readName(mayStandInPackageName, "a build profile");
        }
        while (!accept('>'));
    }

    std::string readName(bool (*mayStand)(char), char const* what)
    {
        if (atEnd() || !ascii::isLetterOrDigit(m_text[m_position]))
            fail(what);
        return std::string(takeWhile(mayStand));
    }

    std::string_view takeWhile(bool (*mayStand)(char))
    {
        std::size_t const begin = m_position;
        while (!atEnd() && mayStand(m_text[m_position]))
            ++m_position;
        return m_text.substr(begin, m_position - begin);
    }

    /// Passes over blanks, and `c` with the blanks behind it if it comes next; tells whether it
    /// did.
    bool accept(char c)
    {
        skipSpace();
        if (atEnd() || m_text[m_position] != c)
            return false;
        ++m_position;
        // Nothing may come between `!` and what it negates.
        if (c != '!')
            skipSpace();
        return true;
    }

    void expect(char c)
    {
        if (!accept(c))
            fail(std::string("\"") + c + '"');
    }

    void skipSpace() { takeWhile(isSpace); }
    bool atEnd() const { return m_position == m_text.size(); }

    [[noreturn]] void fail(std::string const& wanted) const
    {
        throw SyntaxError(m_position + 1, "found " + describeNext() + " instead of " + wanted);
    }

    std::string describeNext() const
    {
        if (atEnd())
            return "the end of the field";
        char const c = m_text[m_position];
        if (c > ' ' && c <= '~')
            return std::string("\"") + c + '"';
        std::array<char, 16> text{};
        std::snprintf(text.data(), text.size(), "byte 0x%02x", static_cast<unsigned char>(c));
        return text.data();
    }

    std::string_view m_text;
    std::size_t m_position = 0;
};

}  // namespace

std::vector<RelationGroup> parseDependencyField(std::string_view value)
{
    return Parser(value).readField();
}

}  // namespace debian
