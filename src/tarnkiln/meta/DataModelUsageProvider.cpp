#include "tarnkiln/meta/DataModelUsageProvider.h"

#include "tarnkiln/meta/PackageImpl.h"

namespace tarn::kiln::meta {

DataModelUsageProvider::~DataModelUsageProvider() = default;

std::vector<ustring> DataModelUsageProvider::getUsedPackageUris() const
{
    std::vector<ustring> uris;
    for (Package const& package : getUsedPackages())
        uris.push_back(package->getUri());
    return uris;
}

void DataModelUsageProvider::elementCreated(ModelElement::Impl*) {}

void DataModelUsageProvider::elementDestroying(ModelElement::Impl*) {}

void DataModelUsageProvider::clear() {}
}  // namespace tarn::kiln::meta
