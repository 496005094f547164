/// \file
/// The check that a text is well-formed UTF-8.
#pragma once
#include <cstddef>
#include <string_view>

namespace debian {

/// The index of the first byte that does not belong to a well-formed UTF-8 sequence, or
/// `std::string_view::npos` if there is none. Overlong forms, surrogates and code points above
/// U+10FFFF are malformed; of a malformed sequence the first byte is reported.
std::size_t findInvalidUtf8(std::string_view text);

}  // namespace debian
