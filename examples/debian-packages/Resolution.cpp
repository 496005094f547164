#include "Resolution.h"

#include "Dependencies.h"

#include <set>

namespace debian {

using namespace tarn::kiln;

template <ElementForm Form> Resolution resolveTargets(PackageIndex<Form> const& index)
{
    std::set<ProxyId> found;
    std::set<ProxyId> notFound;
    forEachRelease<Form>(index, [&](Release<Form> const& release) {
        forEachGroup<Form>(release, [&](DependencyGroup<Form> const& group) {
            forEachAlternative<Form>(group, [&](Alternative<Form> const& alternative) {
                ModelElement const before(alternative->getTargetImpl());
                if (before && before->isProxy())
                    (alternative->getTarget()->isProxy() ? notFound : found)
                        .insert(*before->getProxyId());
            });
        });
    });
    return {found.size(), notFound.size()};
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template Resolution resolveTargets<Form>(PackageIndex<Form> const&);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
