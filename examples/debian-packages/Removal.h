/// \file
/// Takes packages out of an index.
#pragma once
#include "Forms.h"

#include <vector>

namespace debian {

/// Destroys the releases of the packages, and the packages that no release provides then; the
/// others stay as virtual packages. Must be called in an open transaction.
template <ElementForm Form> void removePackages(std::vector<Package<Form>> const& packages);

/// The first package, by the name of who needs it, that is not essential and without which an
/// essential release lacks a strict dependency; empty if there is none.
template <ElementForm Form> Package<Form> neededByEssential(PackageIndex<Form> const& index);

}  // namespace debian
