// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/PackageImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PackageBuilder.h"
#include "tarnkiln/meta/PackageConstrainables.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Package::Impl::OWNED_TYPES{
    .index = 2, .composite = true, .single = false, .keyed = true,
    .opposite = &Type::Impl::OWNING_PACKAGE,
    .property = propertyOf<rows::properties::PackageOwnedTypes>};
constinit Slot const Package::Impl::NESTED_PACKAGES{
    .index = 3, .composite = true, .single = false, .keyed = true,
    .opposite = &Package::Impl::PARENT_PACKAGE,
    .property = propertyOf<rows::properties::PackageNestedPackages>};
constinit Slot const Package::Impl::URI{
    .index = 4, .property = propertyOf<rows::properties::PackageUri>};
constinit Slot const Package::Impl::PARENT_PACKAGE{
    .index = 5, .opposite = &Package::Impl::NESTED_PACKAGES,
    .property = propertyOf<rows::properties::PackageParentPackage>};
constinit Slot const Package::Impl::IMPORTED_PACKAGE_URIS{
    .index = 6, .single = false,
    .property = propertyOf<rows::properties::PackageImportedPackageURIs>};
constinit Slot const Package::Impl::DEFAULT_VOBJ_CATEGORY{
    .index = 7, .property = propertyOf<rows::properties::PackageDefaultVobjCategory>};
constinit Slot const Package::Impl::QUALIFIED_NAME{
    .index = ModelElement::Impl::NO_INDEX,
    .property = propertyOf<rows::properties::PackageQualifiedName>};
constinit Slot const Package::Impl::ENUMERATIONS{
    .index = ModelElement::Impl::NO_INDEX, .single = false,
    .property = propertyOf<rows::properties::PackageEnumerations>};
constinit Slot const Package::Impl::CLASSES{
    .index = ModelElement::Impl::NO_INDEX, .single = false,
    .property = propertyOf<rows::properties::PackageClasses>};
constinit Slot const Package::Impl::DATA_TYPES{
    .index = ModelElement::Impl::NO_INDEX, .single = false,
    .property = propertyOf<rows::properties::PackageDataTypes>};
constinit Slot const Package::Impl::PRIMITIVE_TYPES{
    .index = ModelElement::Impl::NO_INDEX, .single = false,
    .property = propertyOf<rows::properties::PackagePrimitiveTypes>};

Package Package::cast(ModelElement const& element)
{
    return support::cast<Package>(element);
}

meta::Class const& Package::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Package);
}

Package Package::create(Model const& model, UUID const& id)
{
    return support::create<Package>(model, id);
}

Package::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Package::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Package::Impl::~Impl() = default;

void Package::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementMap<ustring, Type>> Package::Impl::makeOwnedTypes(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Type::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Type>>(owner, keyOf, OWNED_TYPES);
}

ElementMap<ustring, Type>& Package::Impl::getOwnedTypes() const
{
    return support::shownCollection(*this, m_ownedTypes, &Impl::makeOwnedTypes);
}

std::unique_ptr<ElementMap<ustring, Package>> Package::Impl::makeNestedPackages(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Package::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Package>>(owner, keyOf, NESTED_PACKAGES);
}

ElementMap<ustring, Package>& Package::Impl::getNestedPackages() const
{
    return support::shownCollection(*this, m_nestedPackages, &Impl::makeNestedPackages);
}

void Package::Impl::setUri(ustring const& uri)
{
    support::setScalar(*this, m_uri, URI, uri);
}

Package Package::Impl::getParentPackage() const
{
    return Package(getParentPackageImpl());
}

Package::Impl* Package::Impl::getParentPackageImpl() const
{
    return support::containerOf<Package::Impl>(*this, PARENT_PACKAGE);
}

bool Package::Impl::hasParentPackage() const
{
    return getParentPackageImpl() && getParentPackageImpl()->isLive();
}

void Package::Impl::setParentPackage(Package const& parentPackage)
{
    auto const requireFree = [&] {
        support::requireFreeKey(parentPackage->getNestedPackages(), getName());
    };
    support::setContainer(*this, PARENT_PACKAGE, parentPackage.getImpl(), requireFree);
}

std::unique_ptr<PrimitiveSequence<ustring>> Package::Impl::makeImportedPackageURIs(Impl* owner)
{
    return std::make_unique<PrimitiveSequence<ustring>>(
        owner, /*unique=*/false, IMPORTED_PACKAGE_URIS);
}

PrimitiveSequence<ustring>& Package::Impl::getImportedPackageURIs() const
{
    return support::shownCollection(*this, m_importedPackageURIs, &Impl::makeImportedPackageURIs);
}

void Package::Impl::setDefaultVobjCategory(boost::optional<string> const& defaultVobjCategory)
{
    support::setScalar(*this, m_defaultVobjCategory, DEFAULT_VOBJ_CATEGORY, defaultVobjCategory);
}

void Package::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getParentPackage()->getNestedPackages(), name);
    };
    auto const store = [&] { NamedElement::Impl::setName(name); };
    support::changeKey(
        *this, getName(), name, getParentPackage(), PARENT_PACKAGE, requireFree, store);
}

Package::Builder::Builder() = default;

Package::Builder::Builder(Model const& model) : BuilderBase(model) {}

Package::Builder::~Builder() = default;

Package::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Package::metaClass(), source.second)
{}

Package::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : NamedElement::Constrainables(query, metaClass, mode),
      ownedTypes(*this, propertyOf<rows::properties::PackageOwnedTypes>()),
      nestedPackages(*this, propertyOf<rows::properties::PackageNestedPackages>()),
      qualifiedName(*this, propertyOf<rows::properties::PackageQualifiedName>()),
      uri(*this, propertyOf<rows::properties::PackageUri>()),
      parentPackage(*this, propertyOf<rows::properties::PackageParentPackage>()),
      importedPackageURIs(*this, propertyOf<rows::properties::PackageImportedPackageURIs>()),
      defaultVobjCategory(*this, propertyOf<rows::properties::PackageDefaultVobjCategory>()),
      enumerations(*this, propertyOf<rows::properties::PackageEnumerations>()),
      classes(*this, propertyOf<rows::properties::PackageClasses>()),
      dataTypes(*this, propertyOf<rows::properties::PackageDataTypes>()),
      primitiveTypes(*this, propertyOf<rows::properties::PackagePrimitiveTypes>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Package::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Package::Builder>;
