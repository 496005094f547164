/// \file
/// Which metamodels a model uses.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

#include <vector>

namespace tarn::kiln::meta {

/// Tells which packages the elements of a model come from. Each model owns one.
class TARNKILN_EXPORT DataModelUsageProvider
{
public:
    virtual ~DataModelUsageProvider();
    /// The URIs of the packages that `getUsedPackages` yields.
    virtual std::vector<ustring> getUsedPackageUris() const;
    virtual std::vector<Package> getUsedPackages() const = 0;
    virtual void elementCreated(ModelElement::Impl* element);
    virtual void elementDestroying(ModelElement::Impl* element);
    virtual void clear();
};
}  // namespace tarn::kiln::meta
