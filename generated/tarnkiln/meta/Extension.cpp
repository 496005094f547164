// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/ExtensionImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionBuilder.h"
#include "tarnkiln/meta/ExtensionConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Extension::Impl::OWNER{
    .index = 26, .opposite = &DynamicExtensions::Impl::EXTENSIONS,
    .property = propertyOf<rows::properties::ExtensionOwner>};
constinit Slot const Extension::Impl::EXTENDED_METACLASS{
    .index = ModelElement::Impl::NO_INDEX,
    .property = propertyOf<rows::properties::ExtensionExtendedMetaclass>};

Extension Extension::cast(ModelElement const& element)
{
    return support::cast<Extension>(element);
}

meta::Class const& Extension::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Extension);
}

Extension Extension::create(Model const& model, UUID const& id)
{
    return support::create<Extension>(model, id);
}

Extension::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Extension::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Extension::Impl::~Impl() = default;

void Extension::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

DynamicExtensions Extension::Impl::getOwner() const
{
    return DynamicExtensions(getOwnerImpl());
}

DynamicExtensions::Impl* Extension::Impl::getOwnerImpl() const
{
    return support::containerOf<DynamicExtensions::Impl>(*this, OWNER);
}

bool Extension::Impl::hasOwner() const
{
    return getOwnerImpl() && getOwnerImpl()->isLive();
}

void Extension::Impl::setOwner(DynamicExtensions const& owner)
{
    auto const requireFree = [&] {
        support::requireFreeKey(owner->getExtensions(), getName());
    };
    support::setContainer(*this, OWNER, owner.getImpl(), requireFree);
}

void Extension::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getOwner()->getExtensions(), name);
    };
    auto const store = [&] { Property::Impl::setName(name); };
    support::changeKey(*this, getName(), name, getOwner(), OWNER, requireFree, store);
}

Extension::Builder::Builder() = default;

Extension::Builder::Builder(Model const& model) : BuilderBase(model) {}

Extension::Builder::~Builder() = default;

Extension::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Extension::metaClass(), source.second)
{}

Extension::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Property::Constrainables(query, metaClass, mode),
      extendedMetaclass(*this, propertyOf<rows::properties::ExtensionExtendedMetaclass>()),
      owner(*this, propertyOf<rows::properties::ExtensionOwner>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Extension::Impl, tarn::kiln::meta::Property::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Extension::Builder>;
