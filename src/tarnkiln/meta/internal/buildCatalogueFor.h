/// \file
/// When the metamodel of metamodels must be there before a model changes.
#pragma once
#include "tarnkiln/kernel/Model.h"

namespace tarn::kiln::internal {

/// Builds the metamodel of metamodels if `model` is the registry's, unless that is being done.
/// While the registry starts it does nothing.
void buildCatalogueFor(Model::Impl const& model);
}  // namespace tarn::kiln::internal
