// Which packages describe a model.
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PackageImpl.h"

#include <unordered_set>

namespace tarn::kiln {

namespace {

void visitPackage(meta::Package const& package, std::unordered_set<ustring>& uris)
{
    if (!uris.insert(package->getUri()).second)
        return;
    for (ustring const& imported : package->getImportedPackageURIs())
    {
        if (uris.count(imported) != 0)
            continue;
        if (meta::Package const found = meta::MetaRegistry::getInstance().getRootPackage(imported))
            visitPackage(found, uris);
    }
}

}  // namespace

std::vector<ustring>
Model::Impl::getImportedPackageClosure(std::vector<meta::Package> const& packages)
{
    std::unordered_set<ustring> uris;
    for (meta::Package const& package : packages)
        visitPackage(package, uris);
    return std::vector<ustring>(uris.begin(), uris.end());
}
}  // namespace tarn::kiln
