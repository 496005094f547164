#include "tarnkiln/meta/internal/MetaRegistryUsageProvider.h"

#include "tarnkiln/meta/MetaPackageMeta.h"

namespace tarn::kiln::internal {

std::vector<meta::Package> MetaRegistryUsageProvider::getUsedPackages() const
{
    return {meta::MetaPackageMeta::getInstance().getRootPackage()};
}
}  // namespace tarn::kiln::internal
