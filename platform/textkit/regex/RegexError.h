/// \file
/// What is raised where a regular expression is not one, or asks for more than a search may cost.
#pragma once
#include <cstddef>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>

namespace textkit::regex {

/// A regular expression that can't be compiled, or whose search was given up at a limit.
///
/// The text says in UTF-8 what is wrong, shows the pattern, and names the place where there is one:
/// `missing closing parenthesis at 3 of the pattern "(ab"`.
class RegexError : public std::runtime_error
{
public:
    /// \param reason   begins in lower case, without a full stop.
    /// \param pattern  what was to be searched; of a long one the text shows the beginning only.
    /// \param place    in UTF-16 code units of the pattern, from 0.
    RegexError(std::string const& reason, std::u16string_view pattern,
               std::optional<std::size_t> place = std::nullopt);
    ~RegexError() override;

    /// Where the pattern is wrong, in UTF-16 code units from 0; nothing if no place is to blame.
    std::optional<std::size_t> getPlace() const { return m_place; }

private:
    std::optional<std::size_t> m_place;
};
}  // namespace textkit::regex
