/// \file
/// A package version, `epoch:upstream-revision`, with the order that dpkg gives to versions.
#pragma once
#include <compare>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace debian {

/// How a version must stand to the bound of a dependency.
enum class VersionRelation
{
    StrictlyEarlier,  ///< `<<`
    EarlierOrEqual,   ///< `<=`, and the legacy `<`
    Equal,            ///< `=`
    LaterOrEqual,     ///< `>=`, and the legacy `>`
    StrictlyLater,    ///< `>>`
};

/// The relation as written today: "<<", "<=", "=", ">=" or ">>".
std::string_view toString(VersionRelation relation);

/// A well-formed version. Remembers how it was written.
///
/// The epoch is a number and 0 if absent; an absent revision is the same as "0". Equality is that
/// of the order: "1.0", "0:1.0" and "1.00-0" are equal although their texts differ. Therefore
/// versions that are to be told apart as texts, as in identifiers, are compared by `text()`.
class Version
{
public:
    /// Reads a version, as strictly as `dpkg --validate-version`, except that neither blanks around
    /// the version nor a sign before the epoch are allowed.
    ///
    /// \throws SyntaxError  if the text is empty; if the epoch is empty, no number or above
    ///     2147483647; if nothing follows the epoch; if a hyphen is followed by no revision; if the
    ///     upstream version is empty, does not begin with a digit or holds another character than
    ///     letters, digits and `. + - ~ :`; if the revision holds another than letters, digits and
    ///     `. + ~`.
    explicit Version(std::string text);

    std::string const& text() const { return m_text; }
    std::uint32_t epoch() const { return m_epoch; }
    std::string_view upstream() const;
    std::string_view revision() const;  ///< Empty if absent.

    /// True if `this relation bound` holds, such as "1.2 >= 1.0".
    bool satisfies(VersionRelation relation, Version const& bound) const;

    std::weak_ordering operator<=>(Version const& other) const;
    bool operator==(Version const& other) const { return (*this <=> other) == 0; }

private:
    void readEpoch();
    void readRevision();
    void checkCharacters() const;

    std::string m_text;
    std::uint32_t m_epoch = 0;
    std::size_t m_upstreamBegin = 0;
    std::size_t m_upstreamEnd = 0;
    std::size_t m_revisionBegin = 0;  // the end of the text if there is none
};

}  // namespace debian
