/// \file
/// What depends on what in an index.
#pragma once
#include "Forms.h"

#include <vector>

namespace debian {

/// Whether a release does not work without it: a dependency of kind Pre-Depends or Depends.
template <ElementForm Form> bool isStrict(DependencyGroup<Form> const& group)
{
    return group->getKind() == u"Depends" || group->getKind() == u"Pre-Depends";
}
/// Whether it is of kind Suggests, which nobody is obliged to follow.
template <ElementForm Form> bool isSuggestion(DependencyGroup<Form> const& group)
{
    return group->getKind() == u"Suggests";
}

/// Whether the version of `release` is one that `alternative` asks for.
template <ElementForm Form>
bool fits(Release<Form> const& release, Alternative<Form> const& alternative);

/// The live target of `alternative` in its own model; empty if that is a proxy, destroyed, or in
/// another model. Resolves nothing.
template <ElementForm Form> Package<Form> installedTarget(Alternative<Form> const& alternative)
{
    Package<Form> const target(alternative->getTargetImpl());
    bool const isHere =
        target && !target->isProxy() && target->getModelImpl() == alternative->getModelImpl();
    return isHere ? target : Package<Form>();
}

/// The dependencies without which `release` does not work, in their order.
template <ElementForm Form>
std::vector<DependencyGroup<Form>> strictGroupsOf(Release<Form> const& release);

/// The releases in the model of `group` that satisfy it: those of a target with a fitting version,
/// and those that provide a target, whatever version is asked for. May name a release twice.
template <ElementForm Form>
std::vector<Release<Form>> satisfiersOf(DependencyGroup<Form> const& group);

/// \name Iteration that makes no collections
/// Each calls `visit` for one after the other.
/// @{
template <ElementForm Form> void forEachRelease(Package<Form> const& package, auto const& visit)
{
    if (!package->hasReleases())
        return;
    for (Release<Form> const& release : members(package->getReleases()))
        visit(release);
}
template <ElementForm Form> void forEachRelease(PackageIndex<Form> const& index, auto const& visit)
{
    for (Package<Form> const& package : members(index->getPackages()))
        forEachRelease<Form>(package, visit);
}
template <ElementForm Form> void forEachProvider(Package<Form> const& package, auto const& visit)
{
    if (!package->hasProviders())
        return;
    for (Release<Form> const& provider : members(package->getProviders()))
        visit(provider);
}
template <ElementForm Form> void forEachGroup(Release<Form> const& release, auto const& visit)
{
    if (!release->hasGroups())
        return;
    for (DependencyGroup<Form> const& group : members(release->getGroups()))
        visit(group);
}
template <ElementForm Form>
void forEachAlternative(DependencyGroup<Form> const& group, auto const& visit)
{
    if (!group->hasAlternatives())
        return;
    for (Alternative<Form> const& alternative : members(group->getAlternatives()))
        visit(alternative);
}
/// @}

/// Whether one of its releases is.
template <ElementForm Form> bool isEssential(Package<Form> const& package)
{
    bool essential = false;
    forEachRelease<Form>(
        package, [&](Release<Form> const& release) { essential |= release->isEssential(); });
    return essential;
}

}  // namespace debian
