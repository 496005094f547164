/// \file
/// UTF-8 and the UTF-16 of models, one made of the other.
///
///     book->setTitle(toUstring(line));
///     std::cout << toUtf8(book->getTitle());
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <string_view>

namespace tarn::kiln {

/// The text that is UTF-8 in `bytes`. A byte that is not well-formed UTF-8 becomes an unpaired
/// surrogate from which `toUtf8` brings it back, so that nothing is lost.
TARNKILN_EXPORT ustring toUstring(std::string_view bytes);

/// The UTF-8 form of `text`. An unpaired surrogate that stands for a byte becomes that byte, any
/// other goes out in the three bytes that its code would take.
TARNKILN_EXPORT string toUtf8(std::u16string_view text);
}  // namespace tarn::kiln
