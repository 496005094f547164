/// \file
/// Patterns that need no regular expressions.
#pragma once
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace textkit::regex {

/// A pattern of plain characters, "." and ".*" alone, as people write them to find a part of a
/// text.
///
/// Finds what `Pattern` says that such a pattern finds, many times faster.
///
/// Threads: may be used by many at once.
class Glob
{
public:
    /// Nothing if `pattern`, which must be a regular expression, is of another kind, or has line
    /// ends or surrogates in it.
    static std::optional<Glob> parse(std::u16string_view pattern);

    /// Whether it is found anywhere in `subject`; nothing if that would take more than `mostSteps`
    /// comparisons of characters.
    std::optional<bool> isFoundIn(std::u16string_view subject, std::int64_t mostSteps) const;

private:
    /// What stands between two ".*"; not empty.
    class Part
    {
    public:
        // No character that a pattern may have here.
        static constexpr char16_t ANY_CHARACTER = 0xD800;

        explicit Part(std::u16string_view units) : m_units(units) {}

        char16_t first() const { return m_units.front(); }

        /// The place behind the part if it stands at `at`, else `npos`. Adds to `compared` how many
        /// of its characters were looked at.
        std::size_t matchAt(std::u16string_view subject, std::size_t at,
                            std::size_t& compared) const;

    private:
        std::u16string m_units;
    };

    std::vector<Part> m_parts;
};
}  // namespace textkit::regex
