/// \file
/// UUIDs as they stand in element ids.
#pragma once
#include "tarnkiln/kernel/Types.h"

#include <string_view>

namespace tarn::kiln::internal {

/// Lower-case hexadecimal digits with hyphens, in groups of 8, 4, 4, 4 and 12.
ustring uuidText(UUID const& uuid);

/// Reads the same form, in which digits may also be upper-case. False for any other text.
bool parseUuidText(std::u16string_view text, UUID& uuid);
}  // namespace tarn::kiln::internal
