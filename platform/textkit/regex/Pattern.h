/// \file
/// A regular expression over UTF-16 text, compiled once and searched often.
///
///     Pattern const pattern(u"^lib.*-dev$");
///     bool const found = pattern.isFoundIn(u"libboost-dev");
#pragma once
#include <memory>
#include <string>
#include <string_view>

namespace textkit::regex {

/// A compiled regular expression, and the memory that its searches use.
///
/// The syntax is that of Perl, with `\uXXXX` for a UTF-16 code unit. A search is not anchored.
/// "." stands for one code point that ends no line; "^" is the beginning of the text and "$" its
/// very end. `\d`, `\s` and `\w` are ASCII; `\p{L}` and its kin know all of Unicode. An unpaired
/// surrogate in a subject is matched by nothing, the text around it is searched as usual; in a
/// pattern it is an error.
///
/// Patterns may come from strangers: one pattern is at most 65536 code units long, and a search is
/// given up after ten million steps or 64 MiB, a step being an item of the pattern tried or a code
/// unit passed. What a `Glob` can find is found without that.
///
/// Movable, not copyable. Threads: used by one at a time, since searches share their memory.
class Pattern
{
public:
    /// \throws RegexError  if `pattern` is not a regular expression; says what is wrong, and where.
    explicit Pattern(std::u16string_view pattern, bool caseSensitive = true);

    Pattern(Pattern&& other) noexcept;
    Pattern& operator=(Pattern&& other) noexcept;
    ~Pattern();

    /// Whether the pattern is found anywhere in `subject`.
    ///
    /// \throws RegexError  if the search reaches a limit; the next search starts afresh.
    bool isFoundIn(std::u16string_view subject) const;

private:
    struct Compiled;

    std::unique_ptr<Compiled> m_compiled;  // null after a move only
};
}  // namespace textkit::regex
