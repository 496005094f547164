/// \file
/// Names of types for the arguments of failures.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::internal {

/// The qualified name of `type`; empty while there is no live type.
ustring qualifiedNameOf(meta::Type const& type);
}  // namespace tarn::kiln::internal
