/// \file
/// The parts of a package URI, each by itself.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

#include <optional>

namespace tarn::kiln::internal {

/// The text between `SchemaBase` and the next "/"; none if the URI begins otherwise or has no such
/// "/". May be empty.
TARNKILN_TESTED std::optional<ustring> familyOfUri(ustring const& uri);

/// The text that follows the family, up to the next "/" or the end; none where there is no family.
/// May be empty.
TARNKILN_TESTED std::optional<ustring> versionOfUri(ustring const& uri);
}  // namespace tarn::kiln::internal
