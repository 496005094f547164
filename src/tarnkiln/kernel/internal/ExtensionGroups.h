/// \file
/// The groups in which the registry keeps the extensions of one class and one model.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"

namespace tarn::kiln::internal {

// All under a `LockedModel`, in a transaction of the registry's model.

/// What `extended` has from the model with that counter; made if there is nothing.
meta::DynamicExtensions requireExtensionGroup(meta::Class const& extended,
                                              unsigned long modelCounter);
/// Destroys `group` if there is one and it is empty.
void dropEmptyExtensionGroup(meta::DynamicExtensions const& group);
}  // namespace tarn::kiln::internal
