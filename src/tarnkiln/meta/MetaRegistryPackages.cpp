/// \file
/// The registry's root packages and families.
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/internal/MetaUri.h"
#include "tarnkiln/services/internal/LoadMetamodelFamily.h"

namespace tarn::kiln::meta {
namespace {

/// The entry under `key`, which belongs to `family`. The library's own metamodel is built when it
/// is looked for.
Package findPackage(std::map<ustring, Package> const& packages, ustring const& key,
                    ustring const& family)
{
    auto position = packages.find(key);
    if (position == packages.end() && family == u"meta")
    {
        MetaPackageMeta::getInstance();
        position = packages.find(key);
    }
    return position != packages.end() ? position->second : Package();
}
}  // namespace

void MetaRegistry::registerRootPackage(Package const& package)
{
    ustring const uri = package->getUri();
    m_rootPackages[uri] = package;
    if (std::optional<ustring> const family = internal::familyOfUri(uri))
        m_families[*family] = package;
}

void MetaRegistry::unregisterRootPackage(ustring const& uri)
{
    m_rootPackages.erase(uri);
    if (std::optional<ustring> const family = internal::familyOfUri(uri))
        m_families.erase(*family);
}

Package MetaRegistry::getRootPackage(ustring const& uri) const
{
    LockedConstModel const locked(*this);
    return findPackage(m_rootPackages, uri, internal::familyOfUri(uri).value_or(ustring()));
}

Package MetaRegistry::getRootPackage(ustring const& uri, bool load)
{
    Package const found = getRootPackage(uri);
    if (found || !load)
        return found;
    std::optional<ustring> const family = internal::familyOfUri(uri);
    if (!family)
        return found;
    internal::loadMetamodelFamily(*family);
    return getRootPackage(uri);
}

Package MetaRegistry::getPackageForFamily(ustring const& family)
{
    auto const find = [&] {
        LockedConstModel const locked(*this);
        return findPackage(m_families, family, family);
    };
    // A dead package counts as found: only one that was never registered is loaded.
    if (Package const found = find(); found.getImpl())
        return found;
    internal::loadMetamodelFamily(family);
    return find();
}

bool MetaRegistry::isVersionCurrentForFamily(ustring const& uri)
{
    std::optional<ustring> const family = internal::familyOfUri(uri);
    if (!family)
        return false;
    Package const current = getPackageForFamily(*family);
    return current && internal::versionOfUri(uri) == internal::versionOfUri(current->getUri());
}
}  // namespace tarn::kiln::meta
