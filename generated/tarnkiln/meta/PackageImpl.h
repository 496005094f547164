// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What stands behind a `Package`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/SubsettedElementSet.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/Dispatch.h"

#include <boost/optional.hpp>

#include <memory>

namespace tarn::kiln::meta {

/// The properties of a `Package`.
///
/// Setters work in the open transaction of the model, or in one of their own. They fail with
/// `CannotModifyProxy` if this element stands in for another one, and with `ModelFrozen`,
/// `NoOpenTransaction` or `ChangesProhibited` if the model may not be changed now. An equal value
/// changes nothing.
///
/// Threads: as the handle.
class TARNKILN_EXPORT Package::Impl : public support::Dispatched<Package::Impl, NamedElement::Impl>
{
public:
    class BuilderImpl;                         // PackageBuilder.h
    template <class Final> class BuilderBase;  // PackageBuilder.h

    using Handle = Package;
    using Storage = support::Record<Impl, NamedElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 8;
    static Slot const OWNED_TYPES;
    static Slot const NESTED_PACKAGES;
    static Slot const URI;
    static Slot const PARENT_PACKAGE;
    static Slot const IMPORTED_PACKAGE_URIS;
    static Slot const DEFAULT_VOBJ_CATEGORY;
    static Slot const QUALIFIED_NAME;
    static Slot const ENUMERATIONS;
    static Slot const CLASSES;
    static Slot const DATA_TYPES;
    static Slot const PRIMITIVE_TYPES;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The types, by name.
    ElementMap<ustring, Type>& getOwnedTypes() const;
    /// Whether the collection was made, as its getter does.
    bool hasOwnedTypes() const { return m_ownedTypes.get(); }

    /// The packages inside, by name.
    ElementMap<ustring, Package>& getNestedPackages() const;
    /// Whether the collection was made, as its getter does.
    bool hasNestedPackages() const { return m_nestedPackages.get(); }

    /// The names from the root package on, separated by dots.
    ustring getQualifiedName() const;

    /// What the package is known by among metamodels.
    ustring const& getUri() const { return m_uri; }
    void setUri(ustring const& uri);

    /// The package around it.
    Package getParentPackage() const;
    Package::Impl* getParentPackageImpl() const;
    /// Whether there is one and it is live.
    bool hasParentPackage() const;
    void setParentPackage(Package const& parentPackage);

    /// The root packages whose types this one uses.
    PrimitiveSequence<ustring>& getImportedPackageURIs() const;
    /// Whether the collection was made, as its getter does.
    bool hasImportedPackageURIs() const { return m_importedPackageURIs.get(); }

    /// The display group of properties without one.
    boost::optional<string> const& getDefaultVobjCategory() const { return m_defaultVobjCategory; }
    void setDefaultVobjCategory(boost::optional<string> const& defaultVobjCategory);

    /// The enumerations among the types, by name; a view, which can only be read.
    SubsettedElementSet<Enum>& getEnumerations() const;

    /// The classes among the types, by name; a view, which can only be read.
    SubsettedElementSet<Class>& getClasses() const;

    /// The data types among the types, by name; a view, which can only be read.
    SubsettedElementSet<DataType>& getDataTypes() const;

    /// The primitive types among the types, by name; a view, which can only be read.
    SubsettedElementSet<PrimitiveType>& getPrimitiveTypes() const;

    /// Gives it another name, under which the owner then keeps it.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if the owner has another such name.
    void setName(ustring const& name) override;

    /// The qualified name.
    ustring identifier() const override;

private:
    static std::unique_ptr<ElementMap<ustring, Type>> makeOwnedTypes(Impl* owner);
    static std::unique_ptr<ElementMap<ustring, Package>> makeNestedPackages(Impl* owner);
    static std::unique_ptr<PrimitiveSequence<ustring>> makeImportedPackageURIs(Impl* owner);

    mutable support::LazyCollection<ElementMap<ustring, Type>> m_ownedTypes;
    mutable support::LazyCollection<ElementMap<ustring, Package>> m_nestedPackages;
    ustring m_uri;
    mutable support::LazyCollection<PrimitiveSequence<ustring>> m_importedPackageURIs;
    boost::optional<string> m_defaultVobjCategory;
    mutable support::LazyCollection<SubsettedElementSet<Enum>> m_enumerations;
    mutable support::LazyCollection<SubsettedElementSet<Class>> m_classes;
    mutable support::LazyCollection<SubsettedElementSet<DataType>> m_dataTypes;
    mutable support::LazyCollection<SubsettedElementSet<PrimitiveType>> m_primitiveTypes;

public:
    using Rows = support::RowList<
        support::References<
            &Impl::m_ownedTypes, OWNED_TYPES, &Impl::makeOwnedTypes, &Impl::getOwnedTypes>,
        support::References<
            &Impl::m_nestedPackages, NESTED_PACKAGES, &Impl::makeNestedPackages,
            &Impl::getNestedPackages>,
        support::Scalar<&Impl::m_uri, URI, &Impl::setUri>,
        support::Container<Package, PARENT_PACKAGE, &Impl::setParentPackage>,
        support::Values<
            &Impl::m_importedPackageURIs, IMPORTED_PACKAGE_URIS, &Impl::makeImportedPackageURIs,
            &Impl::getImportedPackageURIs>,
        support::Optional<
            &Impl::m_defaultVobjCategory, DEFAULT_VOBJ_CATEGORY, &Impl::setDefaultVobjCategory>>;
    using ComputedRows = support::RowList<
        support::Computed<&Impl::getQualifiedName, QUALIFIED_NAME>,
        support::Computed<&Impl::getEnumerations, ENUMERATIONS>,
        support::Computed<&Impl::getClasses, CLASSES>,
        support::Computed<&Impl::getDataTypes, DATA_TYPES>,
        support::Computed<&Impl::getPrimitiveTypes, PRIMITIVE_TYPES>>;
};

inline Package::Package(Impl* impl) : NamedElement(impl) {}
inline Package::Impl* Package::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Package::Impl* Package::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace tarn::kiln::meta

extern template class tarn::kiln::support::Record<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl>;
