/// \file
/// What the operations of the metamodel's own classes run when they are called by reflection.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

#include <memory>

namespace tarn::kiln::internal {

/// A new invoker for the operation of a class of the catalogue; null for `Class.instantiate`, which
/// has none, and for what the catalogue does not know.
TARNKILN_TESTED std::unique_ptr<meta::AbstractMethodInvoker>
makeCatalogueInvoker(ustring const& className, ustring const& operationName);
}  // namespace tarn::kiln::internal
