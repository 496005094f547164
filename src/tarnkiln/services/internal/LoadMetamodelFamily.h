/// \file
/// How a metamodel that is not registered gets its chance.
#pragma once
#include "tarnkiln/kernel/Types.h"

namespace tarn::kiln::internal {

/// Lets the bundles that bring a family of metamodels register it. Must not be called under a lock
/// of the registry.
///
/// No service framework is attached, so that no bundle does.
void loadMetamodelFamily(ustring const& family);
}  // namespace tarn::kiln::internal
