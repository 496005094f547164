/// \file
/// A regular expression over 8-bit text.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <cstddef>
#include <cstdint>
#include <regex>
#include <vector>

namespace tarn::kiln::internal {

/// An ECMAScript regular expression of the standard library that all of a text must match.
///
/// Patterns and texts may come from strangers: neither exhausts the stack or the patience of the
/// caller, as the standard library alone would let them.
///
/// - A pattern of more than `MOST_ITEMS` items, counted after repetitions such as "{9}" are written
///   out, fails with `error_space`; one nested deeper than `DEEPEST_NESTING` with `error_stack`.
/// - A match that takes more than `MOST_STEPS` steps fails with `error_complexity`. Time grows with
///   the product of text and pattern, except for patterns that refer back to groups, "\1": they are
///   tried in all ways, and refuse longer texts with `error_stack`.
///
/// A pattern of plain characters, "." and ".*" alone, which `like` gives, is matched without the
/// standard library.
class TARNKILN_TESTED ByteRegex
{
public:
    static constexpr std::size_t MOST_ITEMS = 4096;
    static constexpr std::size_t DEEPEST_NESTING = 250;
    static constexpr std::size_t MOST_STEPS = 2'000'000;
    /// Of the product of text and pattern, where groups are referred back to.
    static constexpr std::size_t MOST_BACKTRACKING = 16'384;

    /// \throws std::regex_error  if `pattern` is not a regular expression.
    explicit ByteRegex(string const& pattern);

    /// \throws std::regex_error  if a limit is reached.
    bool matches(string const& text) const;

private:
    /// One byte of a text.
    struct GlobItem
    {
        enum Kind : std::uint8_t
        {
            Byte,
            AnyByte,  ///< Any but a line end.
            AnyBytes  ///< Any number of those.
        };
        Kind kind;
        char byte;
    };

    bool compileGlob(string const& pattern);
    bool matchesGlob(string const& text) const;

    bool m_isGlob = false;
    bool m_refersBack = false;
    std::size_t m_items = 0;
    std::vector<GlobItem> m_glob;
    std::regex m_regex;  ///< Unless `m_isGlob`.
};
}  // namespace tarn::kiln::internal
