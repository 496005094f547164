/// \file
/// Type names for messages.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::internal {

/// The qualified name of `type`; empty for an empty or dead one.
TARNKILN_EXPORT ustring qualifiedName(meta::Type const& type);
} // namespace tarn::kiln::internal
