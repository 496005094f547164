/// \file
/// What stands for the class of an element while its metamodel is not built.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::support {

/// An empty handle that lives as long as the process.
TARNKILN_EXPORT meta::Class const& unbuiltClass();
}  // namespace tarn::kiln::support
