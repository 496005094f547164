/// \file
/// Which metamodels the registry model uses.
#pragma once
#include "tarnkiln/meta/DataModelUsageProvider.h"

namespace tarn::kiln::internal {

/// Says that the registry model is described by the metamodel of metamodels, whatever it holds.
class MetaRegistryUsageProvider final : public meta::DataModelUsageProvider
{
public:
    std::vector<meta::Package> getUsedPackages() const override;
};
}  // namespace tarn::kiln::internal
