#include "reader/Version.h"

#include "reader/Ascii.h"
#include "reader/SyntaxError.h"

#include <algorithm>
#include <charconv>
#include <utility>

namespace debian {
namespace {

constexpr std::uint32_t MAX_EPOCH = 2147483647;

/// Where a character sorts among non-digits: `~` before the end of the text, then letters, then all
/// else. A digit counts as the end, because it ends the run of non-digits.
int rank(char c)
{
    if (ascii::isDigit(c))
        return 0;
    if (ascii::isLetter(c))
        return c;
    if (c == '~')
        return -1;
    return static_cast<unsigned char>(c) + 256;
}

int rankAt(std::string_view text, std::size_t index)
{
    return index < text.size() ? rank(text[index]) : 0;
}

/// Takes the longest run of digits from the front of `text`, leading zeros dropped.
std::string_view takeNumber(std::string_view& text)
{
    auto const isDigit = [](char c) { return ascii::isDigit(c); };
    auto const end = std::find_if_not(text.begin(), text.end(), isDigit);
    auto const begin = std::find_if_not(text.begin(), end, [](char c) { return c == '0'; });
    std::string_view const number(begin, end);
    text.remove_prefix(static_cast<std::size_t>(end - text.begin()));
    return number;
}

/// Compares the runs of non-digits that two texts begin with, and drops them if they are equal.
std::weak_ordering compareNonDigits(std::string_view& left, std::string_view& right)
{
    auto const atNonDigit = [](std::string_view text, std::size_t index) {
        return index < text.size() && !ascii::isDigit(text[index]);
    };
    std::size_t i = 0;
    for (; atNonDigit(left, i) || atNonDigit(right, i); ++i)
    {
        if (auto const order = rankAt(left, i) <=> rankAt(right, i); order != 0)
            return order;
    }
    left.remove_prefix(i);
    right.remove_prefix(i);
    return std::weak_ordering::equivalent;
}

/// Compares two upstream versions or two revisions: runs of non-digits and numbers in turn. Numbers
/// stay texts, so that no length overflows.
std::weak_ordering compareParts(std::string_view left, std::string_view right)
{
    while (!left.empty() || !right.empty())
    {
        if (auto const order = compareNonDigits(left, right); order != 0)
            return order;
        std::string_view const leftNumber = takeNumber(left);
        std::string_view const rightNumber = takeNumber(right);
        if (auto const order = leftNumber.size() <=> rightNumber.size(); order != 0)
            return order;
        if (auto const order = leftNumber <=> rightNumber; order != 0)
            return order;
    }
    return std::weak_ordering::equivalent;
}

}  // namespace

std::string_view toString(VersionRelation relation)
{
    switch (relation)
    {
    case VersionRelation::StrictlyEarlier:
        return "<<";
    case VersionRelation::EarlierOrEqual:
        return "<=";
    case VersionRelation::Equal:
        return "=";
    case VersionRelation::LaterOrEqual:
        return ">=";
    case VersionRelation::StrictlyLater:
        return ">>";
    }
    return {};
}

Version::Version(std::string text) : m_text(std::move(text))
{
    if (m_text.empty())
        throw SyntaxError(1, "version is empty");
    readEpoch();
    readRevision();
    checkCharacters();
}

void Version::readEpoch()
{
    std::size_t const colon = m_text.find(':');
    if (colon == std::string::npos)
        return;
    if (colon == 0)
        throw SyntaxError(1, "epoch is empty");

    char const* const end = m_text.data() + colon;
    for (char const* c = m_text.data(); c != end; ++c)
    {
        if (!ascii::isDigit(*c))
            throw SyntaxError(static_cast<std::size_t>(c - m_text.data()) + 1,
                              "epoch is not a number");
    }
    auto const result = std::from_chars(m_text.data(), end, m_epoch);
    if (result.ec != std::errc() || m_epoch > MAX_EPOCH)
        throw SyntaxError(1, "epoch is above " + std::to_string(MAX_EPOCH));
    m_upstreamBegin = colon + 1;
    if (m_upstreamBegin == m_text.size())
        throw SyntaxError(m_text.size() + 1, "nothing follows the epoch");
}

void Version::readRevision()
{
    std::size_t const hyphen = m_text.rfind('-');
    bool const hasRevision = hyphen != std::string::npos && hyphen >= m_upstreamBegin;
    m_upstreamEnd = hasRevision ? hyphen : m_text.size();
    m_revisionBegin = hasRevision ? hyphen + 1 : m_text.size();
    if (hasRevision && m_revisionBegin == m_text.size())
        throw SyntaxError(m_text.size() + 1, "revision is empty");
}

void Version::checkCharacters() const
{
    if (m_upstreamBegin == m_upstreamEnd)
        throw SyntaxError(m_upstreamBegin + 1, "upstream version is empty");
    if (!ascii::isDigit(m_text[m_upstreamBegin]))
        throw SyntaxError(m_upstreamBegin + 1, "upstream version does not begin with a digit");

    auto const check = [this](std::size_t begin, std::size_t end, std::string_view others,
                              char const* reason) {
        for (std::size_t i = begin; i != end; ++i)
        {
            if (!ascii::isLetterOrDigit(m_text[i]) && others.find(m_text[i]) == others.npos)
                throw SyntaxError(i + 1, reason);
        }
    };
    check(m_upstreamBegin, m_upstreamEnd, ".+-~:", "character not allowed in an upstream version");
    check(m_revisionBegin, m_text.size(), ".+~", "character not allowed in a revision");
}

std::string_view Version::upstream() const
{
    return std::string_view(m_text).substr(m_upstreamBegin, m_upstreamEnd - m_upstreamBegin);
}

std::string_view Version::revision() const
{
    return std::string_view(m_text).substr(m_revisionBegin);
}

bool Version::satisfies(VersionRelation relation, Version const& bound) const
{
    auto const order = *this <=> bound;
    switch (relation)
    {
    case VersionRelation::StrictlyEarlier:
        return order < 0;
    case VersionRelation::EarlierOrEqual:
        return order <= 0;
    case VersionRelation::Equal:
        return order == 0;
    case VersionRelation::LaterOrEqual:
        return order >= 0;
    case VersionRelation::StrictlyLater:
        return order > 0;
    }
    return false;
}

std::weak_ordering Version::operator<=>(Version const& other) const
{
    if (auto const order = m_epoch <=> other.m_epoch; order != 0)
        return order;
    if (auto const order = compareParts(upstream(), other.upstream()); order != 0)
        return order;
    return compareParts(revision(), other.revision());
}

}  // namespace debian
