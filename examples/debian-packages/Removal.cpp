#include "Removal.h"

#include "Dependencies.h"

#include <algorithm>

namespace debian {
namespace {

/// The package that alone satisfies `group`; empty if there is none, or more than one.
template <ElementForm Form> Package<Form> onlySatisfier(DependencyGroup<Form> const& group)
{
    Package<Form> only;
    for (Release<Form> const& release : satisfiersOf<Form>(group))
    {
        Package<Form> const package = release->getPackage();
        if (only && !(only == package))
            return {};
        only = package;
    }
    return only;
}

}  // namespace

template <ElementForm Form> void removePackages(std::vector<Package<Form>> const& packages)
{
    for (Package<Form> const& package : packages)
    {
        std::vector<Release<Form>> releases;
        forEachRelease<Form>(package,
                             [&](Release<Form> const& release) { releases.push_back(release); });
        for (Release<Form> const& release : releases)
            release->destroy();
    }
    for (Package<Form> const& package : packages)
    {
        if (!package->hasProviders() || package->getProviders().empty())
            package->destroy();
    }
}

template <ElementForm Form> Package<Form> neededByEssential(PackageIndex<Form> const& index)
{
    Package<Form> found;
    forEachRelease<Form>(index, [&](Release<Form> const& release) {
        if (found || !release->isEssential())
            return;
        for (DependencyGroup<Form> const& group : strictGroupsOf<Form>(release))
        {
            Package<Form> const package = onlySatisfier<Form>(group);
            if (!found && package && !isEssential<Form>(package))
                found = package;
        }
    });
    return found;
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template void removePackages<Form>(std::vector<Package<Form>> const&);                         \
    template Package<Form> neededByEssential<Form>(PackageIndex<Form> const&);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
