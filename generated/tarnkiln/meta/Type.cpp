// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/TypeImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/TypeBuilder.h"
#include "tarnkiln/meta/TypeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Type::Impl::IS_VOBJ_HIDDEN{
    .index = 2, .property = propertyOf<rows::properties::TypeIsVobjHidden>};
constinit Slot const Type::Impl::OWNING_PACKAGE{
    .index = 3, .opposite = &Package::Impl::OWNED_TYPES,
    .property = propertyOf<rows::properties::TypeOwningPackage>};
constinit Slot const Type::Impl::QUALIFIED_NAME{
    .index = ModelElement::Impl::NO_INDEX,
    .property = propertyOf<rows::properties::TypeQualifiedName>};

Type Type::cast(ModelElement const& element)
{
    return support::cast<Type>(element);
}

meta::Class const& Type::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Type);
}

Type Type::create(Model const& model, UUID const& id)
{
    return support::create<Type>(model, id);
}

Type::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Type::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Type::Impl::~Impl() = default;

void Type::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Type::Impl::setIsVobjHidden(bool vobjHidden)
{
    support::setScalar(*this, m_isVobjHidden, IS_VOBJ_HIDDEN, vobjHidden);
}

Package Type::Impl::getOwningPackage() const
{
    return Package(getOwningPackageImpl());
}

Package::Impl* Type::Impl::getOwningPackageImpl() const
{
    return support::containerOf<Package::Impl>(*this, OWNING_PACKAGE);
}

bool Type::Impl::hasOwningPackage() const
{
    return getOwningPackageImpl() && getOwningPackageImpl()->isLive();
}

void Type::Impl::setOwningPackage(Package const& owningPackage)
{
    auto const requireFree = [&] {
        support::requireFreeKey(owningPackage->getOwnedTypes(), getName());
    };
    support::setContainer(*this, OWNING_PACKAGE, owningPackage.getImpl(), requireFree);
}

void Type::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getOwningPackage()->getOwnedTypes(), name);
    };
    auto const store = [&] { NamedElement::Impl::setName(name); };
    support::changeKey(
        *this, getName(), name, getOwningPackage(), OWNING_PACKAGE, requireFree, store);
}

Type::Builder::Builder() = default;

Type::Builder::Builder(Model const& model) : BuilderBase(model) {}

Type::Builder::~Builder() = default;

Type::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Type::metaClass(), source.second)
{}

Type::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : NamedElement::Constrainables(query, metaClass, mode),
      qualifiedName(*this, propertyOf<rows::properties::TypeQualifiedName>()),
      isVobjHidden(*this, propertyOf<rows::properties::TypeIsVobjHidden>()),
      owningPackage(*this, propertyOf<rows::properties::TypeOwningPackage>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Type::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Type::Builder>;
