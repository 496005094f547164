/// \file
/// Which releases satisfy a dependency.
#pragma once
#include "model/Alternative.h"
#include "model/DependencyGroup.h"
#include "model/Package.h"
#include "model/PackageIndex.h"
#include "model/Release.h"

#include <functional>
#include <vector>

namespace debian {

/// Whether a release does not work without it: a dependency of kind Pre-Depends or Depends.
bool isStrict(model::DependencyGroup const& group);
/// Whether it is of kind Suggests, which nobody is obliged to follow.
bool isSuggestion(model::DependencyGroup const& group);

/// The live target of `alternative` in its own model; empty if that is a proxy, destroyed, or in
/// another model. Resolves nothing.
model::Package installedTarget(model::Alternative const& alternative);

/// The releases in the model of `group` that satisfy it: those of a target with a fitting version,
/// and those that provide a target, whatever version is asked for. May name a release twice.
std::vector<model::Release> satisfiersOf(model::DependencyGroup const& group);

/// \name Iteration that makes no collections
/// @{
void forEachRelease(model::Package const& package,
                    std::function<void(model::Release const&)> const& visit);
void forEachRelease(model::PackageIndex const& index,
                    std::function<void(model::Release const&)> const& visit);
void forEachGroup(model::Release const& release,
                  std::function<void(model::DependencyGroup const&)> const& visit);
void forEachAlternative(model::DependencyGroup const& group,
                        std::function<void(model::Alternative const&)> const& visit);
/// @}

bool isEssential(model::Package const& package);  ///< Whether one of its releases is.

}  // namespace debian
