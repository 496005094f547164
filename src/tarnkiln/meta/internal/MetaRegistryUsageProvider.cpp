#include "tarnkiln/meta/internal/MetaRegistryUsageProvider.h"

#include "tarnkiln/meta/Package.h"

namespace tarn::kiln::internal {

std::vector<meta::Package> MetaRegistryUsageProvider::getUsedPackages() const
{
    return {};
}
}  // namespace tarn::kiln::internal
