/// \file
/// The search instances of the classes of an index, in either form.
#pragma once
#include "Forms.h"
#include "model/AlternativeConstrainables.h"
#include "model/DependencyGroupConstrainables.h"
#include "model/PackageConstrainables.h"
#include "model/ReleaseConstrainables.h"
#include "reflective/Constrainables.h"
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/Results.h"

namespace debian {

/// All that the program searches: no class of an index extends another.
inline constexpr auto EXACT = tarn::kiln::query::SearchClassMatchMode::MatchExactClass;

/// The query that a search instance is added to, and which elements suit.
using reflective::SearchSource;

template <ElementForm Form> using Packages = typename Package<Form>::Constrainables;
template <ElementForm Form> using Releases = typename Release<Form>::Constrainables;
template <ElementForm Form> using Groups = typename DependencyGroup<Form>::Constrainables;
template <ElementForm Form> using Alternatives = typename Alternative<Form>::Constrainables;

}  // namespace debian
