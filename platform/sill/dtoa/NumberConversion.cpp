#include "sill/dtoa/NumberConversion.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <iterator>
#include <limits>
#include <system_error>
#include <typeinfo>

namespace sill::dtoa {
namespace {

constexpr std::u16string_view NOT_A_NUMBER = u"NaN";
constexpr std::u16string_view POSITIVE_INFINITY = u"Infinity";
constexpr std::u16string_view NEGATIVE_INFINITY = u"-Infinity";

/// `std::from_chars` would also read other spellings of the special values.
bool isPartOfNumber(char16_t unit)
{
    return (unit >= u'0' && unit <= u'9') || unit == u'.' || unit == u'e' || unit == u'E' ||
           unit == u'+' || unit == u'-';
}

double parseFinite(std::u16string_view text)
{
    // `std::from_chars` knows no plus sign, and must not see the minus sign of "+-1".
    if (text.starts_with(u'+'))
    {
        text.remove_prefix(1);
        if (text.starts_with(u'-'))
            throw std::bad_cast();
    }
    if (!std::all_of(text.begin(), text.end(), isPartOfNumber))
        throw std::bad_cast();

    std::string digits;
    digits.reserve(text.size());
    for (char16_t const unit : text)
        digits += static_cast<char>(unit);

    char const* const end = digits.data() + digits.size();
    double value = 0;
    auto const [stop, error] = std::from_chars(digits.data(), end, value);
    if (error != std::errc() || stop != end)
        throw std::bad_cast();
    return value;
}
}  // namespace

std::u16string to_ustring(double value)
{
    if (std::isnan(value))
        return std::u16string(NOT_A_NUMBER);
    if (std::isinf(value))
        return std::u16string(value < 0 ? NEGATIVE_INFINITY : POSITIVE_INFINITY);

    char digits[32];  // the longest text has 24 characters
    char* const end = std::to_chars(std::begin(digits), std::end(digits), value).ptr;
    return std::u16string(std::begin(digits), end);
}

template <> double detail::strtod<char16_t>(std::u16string_view text)
{
    constexpr double INFINITE = std::numeric_limits<double>::infinity();
    if (text == NOT_A_NUMBER)
        return std::numeric_limits<double>::quiet_NaN();
    if (text == POSITIVE_INFINITY)
        return INFINITE;
    if (text == NEGATIVE_INFINITY)
        return -INFINITE;
    return parseFinite(text);
}
}  // namespace sill::dtoa
