/// \file
/// What the essential releases of an index lack.
#pragma once
#include "Forms.h"

#include <vector>

namespace debian {

/// The strict dependencies that are to blame if an essential release does not work: its own, and,
/// if nothing that satisfies one works itself, those of the releases that would satisfy it. Those
/// that nothing satisfies come first.
///
/// A release works if each of its strict dependencies is satisfied by a release that works, and
/// releases that need one another in a circle work together. What could satisfy a dependency
/// beside something that works is blamed for nothing.
template <ElementForm Form>
std::vector<DependencyGroup<Form>> lackingDependencies(PackageIndex<Form> const& index);

}  // namespace debian
