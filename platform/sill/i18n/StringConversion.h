/// \file
/// UTF-16 to UTF-8 and back, for every input.
#pragma once
#include <string>
#include <string_view>

namespace sill::i18n {

/// The UTF-16 text of `bytes`, which should be UTF-8 and may be anything.
///
/// Each byte b that is not part of well-formed UTF-8 becomes the unpaired surrogate U+DC00 + b, so
/// that `to_string` brings back the very same bytes. Overlong forms, encoded surrogates and code
/// points above U+10FFFF are not well formed. Fails for want of memory only.
std::u16string to_ustring(std::string_view bytes);

/// The UTF-8 form of `text`.
///
/// An unpaired surrogate between U+DC80 and U+DCFF gives the byte it stands for; any other unpaired
/// surrogate goes out in the three bytes that its code would take. Fails for want of memory only.
std::string to_string(std::u16string_view text);
}  // namespace sill::i18n
