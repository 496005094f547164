/// \file
/// Leads dependencies to packages of the other model.
#pragma once
#include "Forms.h"

#include <cstddef>

namespace debian {

/// How many missing packages were found.
struct Resolution
{
    std::size_t found = 0;
    std::size_t notFound = 0;
};

/// Resolves the target of each alternative: where it was a proxy for a package that the
/// constellation has, it is that package afterwards. Counts packages, not alternatives.
template <ElementForm Form> Resolution resolveTargets(PackageIndex<Form> const& index);

}  // namespace debian
