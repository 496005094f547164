/// \file
/// Takes packages out of an index.
#pragma once
#include "model/Package.h"
#include "model/PackageIndex.h"

#include <vector>

namespace debian {

/// Destroys the releases of the packages, and the packages that no release provides then; the
/// others stay as virtual packages. Must be called in an open transaction.
void removePackages(std::vector<model::Package> const& packages);

/// The first package, by the name of who needs it, that is not essential and without which an
/// essential release lacks a strict dependency; empty if there is none.
model::Package neededByEssential(model::PackageIndex const& index);

}  // namespace debian
