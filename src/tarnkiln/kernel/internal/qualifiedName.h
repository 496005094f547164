/// \file
/// Type names for messages.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::internal {

/// The qualified name of `type`; empty for an empty or dead one.
ustring qualifiedName(meta::Type const& type);
}  // namespace tarn::kiln::internal
