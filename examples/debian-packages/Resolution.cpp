#include "Resolution.h"

#include "Dependencies.h"
#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/ReleaseImpl.h"

#include <set>

namespace debian {

using tarn::kiln::ProxyId;

Resolution resolveTargets(model::PackageIndex const& index)
{
    std::set<ProxyId> found;
    std::set<ProxyId> notFound;
    forEachRelease(index, [&](model::Release const& release) {
        forEachGroup(release, [&](model::DependencyGroup const& group) {
            forEachAlternative(group, [&](model::Alternative const& alternative) {
                model::Package const before(alternative->getTargetImpl());
                if (before.getImpl() && before->isProxy())
                    (alternative->getTarget()->isProxy() ? notFound : found)
                        .insert(*before->getProxyId());
            });
        });
    });
    return {found.size(), notFound.size()};
}

}  // namespace debian
