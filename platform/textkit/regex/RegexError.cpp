#include "textkit/regex/RegexError.h"

#include "sill/i18n/StringConversion.h"

namespace textkit::regex {
namespace {

constexpr std::size_t LONGEST_SHOWN = 60;  // code units

std::string describe(std::string const& reason, std::u16string_view pattern,
                     std::optional<std::size_t> place)
{
    std::string text = reason;
    text += place ? " at " + std::to_string(*place) + " of the pattern \"" : " in the pattern \"";
    text += sill::i18n::to_string(pattern.substr(0, LONGEST_SHOWN));
    if (pattern.size() > LONGEST_SHOWN)
        text += "...";
    return text + "\"";
}
}  // namespace

RegexError::RegexError(std::string const& reason, std::u16string_view pattern,
                       std::optional<std::size_t> place)
    : std::runtime_error(describe(reason, pattern, place)),
      m_place(place)
{}

RegexError::~RegexError() = default;
}  // namespace textkit::regex
