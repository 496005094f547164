// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What describes a new `Package` and makes it.
#pragma once
#include "tarnkiln/meta/NamedElementBuilder.h"
#include "tarnkiln/meta/PackageImpl.h"

#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::meta {

/// The values of a `Package` to be.
class TARNKILN_EXPORT Package::Impl::BuilderImpl
    : public support::BuilderValues<Package::Impl, NamedElement::Impl::BuilderImpl>
{
public:
    using BuilderValues::BuilderValues;

    void doAddOwnedTypes(std::unique_ptr<ModelElement::Builder> ownedTypes)
    {
        support::addNested(m_ownedTypes, std::move(ownedTypes));
    }
    void doClearOwnedTypes() { m_ownedTypes.clear(); }
    void doAddNestedPackages(std::unique_ptr<ModelElement::Builder> nestedPackages)
    {
        support::addNested(m_nestedPackages, std::move(nestedPackages));
    }
    void doClearNestedPackages() { m_nestedPackages.clear(); }
    void doSetUri(ustring const& uri) { m_uri = uri; }
    void doSetParentPackage(Package const& parentPackage) { m_parentPackage = parentPackage; }
    void doAddImportedPackageURIs(ustring const& importedPackageURIs)
    {
        m_importedPackageURIs.push_back(importedPackageURIs);
    }
    void doClearImportedPackageURIs() { m_importedPackageURIs.clear(); }
    void doSetDefaultVobjCategory(boost::optional<string> const& defaultVobjCategory)
    {
        m_defaultVobjCategory = defaultVobjCategory;
    }

private:
    support::NestedBuilders m_ownedTypes;
    support::NestedBuilders m_nestedPackages;
    ustring m_uri;
    Package m_parentPackage;
    std::vector<ustring> m_importedPackageURIs;
    boost::optional<string> m_defaultVobjCategory;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_ownedTypes, &BuilderImpl::m_nestedPackages, &BuilderImpl::m_uri,
        &BuilderImpl::m_parentPackage, &BuilderImpl::m_importedPackageURIs,
        &BuilderImpl::m_defaultVobjCategory>;
};

/// The setters of what a `Package` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final>
class Package::Impl::BuilderBase : public NamedElement::Impl::BuilderBase<Final>
{
    using Above = NamedElement::Impl::BuilderBase<Final>;

public:
    using Above::Above;

    /// The types, by name.
    Final& addOwnedTypes(std::unique_ptr<ModelElement::Builder> ownedTypes)
    {
        return this->give(OWNED_TYPES, &BuilderImpl::doAddOwnedTypes, std::move(ownedTypes));
    }
    Final& clearOwnedTypes() { return this->give(OWNED_TYPES, &BuilderImpl::doClearOwnedTypes); }

    /// The packages inside, by name.
    Final& addNestedPackages(std::unique_ptr<ModelElement::Builder> nestedPackages)
    {
        return this->give(
            NESTED_PACKAGES, &BuilderImpl::doAddNestedPackages, std::move(nestedPackages));
    }
    Final& clearNestedPackages()
    {
        return this->give(NESTED_PACKAGES, &BuilderImpl::doClearNestedPackages);
    }

    /// What the package is known by among metamodels.
    Final& setUri(ustring const& uri) { return this->give(URI, &BuilderImpl::doSetUri, uri); }

    /// The package around it.
    Final& setParentPackage(Package const& parentPackage)
    {
        return this->give(PARENT_PACKAGE, &BuilderImpl::doSetParentPackage, parentPackage);
    }

    /// The root packages whose types this one uses.
    Final& addImportedPackageURIs(ustring const& importedPackageURIs)
    {
        return this->give(
            IMPORTED_PACKAGE_URIS, &BuilderImpl::doAddImportedPackageURIs, importedPackageURIs);
    }
    Final& addImportedPackageURIs(std::initializer_list<ustring> importedPackageURIs)
    {
        return this->giveEach(
            IMPORTED_PACKAGE_URIS, &BuilderImpl::doAddImportedPackageURIs, importedPackageURIs);
    }
    Final& clearImportedPackageURIs()
    {
        return this->give(IMPORTED_PACKAGE_URIS, &BuilderImpl::doClearImportedPackageURIs);
    }

    /// The display group of properties without one.
    Final& setDefaultVobjCategory(boost::optional<string> const& defaultVobjCategory)
    {
        return this->give(
            DEFAULT_VOBJ_CATEGORY, &BuilderImpl::doSetDefaultVobjCategory, defaultVobjCategory);
    }
    Final& setDefaultVobjCategory(string const& defaultVobjCategory)
    {
        return this->give(
            DEFAULT_VOBJ_CATEGORY, &BuilderImpl::doSetDefaultVobjCategory, defaultVobjCategory);
    }
};

/// Describes a `Package` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class TARNKILN_EXPORT Package::Builder final : public Package::Impl::BuilderBase<Package::Builder>
{
public:
    using Handle = Package;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
extern template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Package::Builder>;
