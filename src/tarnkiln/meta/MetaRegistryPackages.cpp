/// \file
/// The registry's root packages and families.
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/internal/MetaUri.h"
#include "tarnkiln/meta/internal/RegistryReading.h"
#include "tarnkiln/services/internal/LoadMetamodelFamily.h"

namespace tarn::kiln::meta {
namespace {

/// What `find` gives; empty if it gives nothing. The library's own metamodel, of the family "meta",
/// is built when it is looked for.
template <class Find> Package findOrBuild(ustring const& family, Find const& find)
{
    std::optional<Package> found = find();
    if (!found && family == u"meta")
    {
        MetaPackageMeta::getInstance();
        found = find();
    }
    return found.value_or(Package());
}

using Packages = std::unordered_map<ustring, Package>;

Package const* findIn(Packages const& packages, ustring const& key)
{
    auto const position = packages.find(key);
    return position != packages.end() ? &position->second : nullptr;
}

/// Moves the entries of `made` to `packages`, which has room for them, in place of those there.
void enter(Packages& made, Packages& packages) noexcept
{
    while (!made.empty())
    {
        auto const result = packages.insert(made.extract(made.begin()));
        if (!result.inserted)
            result.position->second = result.node.mapped();
    }
}
}  // namespace

void MetaRegistry::registerRootPackage(Package const& package)
{
    RootPackageEntries entries = prepareRootPackage(package);
    enterRootPackage(entries);
}

MetaRegistry::RootPackageEntries MetaRegistry::prepareRootPackage(Package const& package)
{
    RootPackageEntries made;
    ustring const uri = package->getUri();
    made.ofUri.emplace(uri, package);
    if (std::optional<ustring> const family = internal::familyOfUri(uri))
        made.ofFamily.emplace(*family, package);
    m_directory.rootPackages.reserve(m_directory.rootPackages.size() + 1);
    m_directory.families.reserve(m_directory.families.size() + 1);
    return made;
}

void MetaRegistry::enterRootPackage(RootPackageEntries& made) noexcept
{
    enter(made.ofUri, m_directory.rootPackages);
    enter(made.ofFamily, m_directory.families);
    directoryChanged();
}

void MetaRegistry::unregisterRootPackage(ustring const& uri)
{
    m_directory.rootPackages.erase(uri);
    if (std::optional<ustring> const family = internal::familyOfUri(uri))
        m_directory.families.erase(*family);
    directoryChanged();
}

Package MetaRegistry::getRootPackage(ustring const& uri) const
{
    return findOrBuild(internal::familyOfUri(uri).value_or(ustring()), [&] {
        return Reading::find(
            *this, [&](Directory const& directory) { return findIn(directory.rootPackages, uri); });
    });
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
        return findOrBuild(family, [&] {
            return Reading::find(*this, [&](Directory const& directory) {
                return findIn(directory.families, family);
            });
        });
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
