#include "Removal.h"

#include "Dependencies.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/ReleaseImpl.h"

#include <algorithm>

namespace debian {
namespace {

/// The package that alone satisfies `group`; empty if there is none, or more than one.
model::Package onlySatisfier(model::DependencyGroup const& group)
{
    model::Package only;
    for (model::Release const& release : satisfiersOf(group))
    {
        model::Package const package = release->getPackage();
        if (only && !(only == package))
            return model::Package();
        only = package;
    }
    return only;
}

}  // namespace

void removePackages(std::vector<model::Package> const& packages)
{
    for (model::Package const& package : packages)
    {
        std::vector<model::Release> releases;
        forEachRelease(package,
                       [&](model::Release const& release) { releases.push_back(release); });
        for (model::Release const& release : releases)
            release->destroy();
    }
    for (model::Package const& package : packages)
    {
        if (!package->hasProviders() || package->getProviders().empty())
            package->destroy();
    }
}

model::Package neededByEssential(model::PackageIndex const& index)
{
    model::Package found;
    forEachRelease(index, [&](model::Release const& release) {
        if (found || !release->isEssential())
            return;
        forEachGroup(release, [&](model::DependencyGroup const& group) {
            if (found || !isStrict(group))
                return;
            model::Package const package = onlySatisfier(group);
            if (package && !isEssential(package))
                found = package;
        });
    });
    return found;
}

}  // namespace debian
