/// \file
/// Numbers to UTF-16 text and back, in any locale alike.
#pragma once
#include <string>
#include <string_view>

namespace sill::dtoa {

/// The shortest text that `strtod` reads back as the same number, with a point as the decimal
/// separator and the sign of zero kept: "0.1", "-0", "1e+22".
///
/// Special values are "NaN", whatever its sign and payload, "Infinity" and "-Infinity".
std::u16string to_ustring(double value);

namespace detail {

/// The number that all of `text` spells, rounded to nearest; `Char` is `char16_t`.
///
/// Digits with an optional point, then an optional exponent, with an optional sign before each; or
/// one of the three special texts of `to_ustring`, in that very spelling.
///
/// \throws std::bad_cast  if `text` is empty, holds anything else, be it a blank, or is a number
///                        too large or too close to zero for a double.
template <class Char> double strtod(std::basic_string_view<Char> text);

template <> double strtod<char16_t>(std::u16string_view text);
}  // namespace detail
}  // namespace sill::dtoa
