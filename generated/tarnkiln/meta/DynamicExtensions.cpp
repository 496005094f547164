// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/DynamicExtensionsImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsBuilder.h"
#include "tarnkiln/meta/DynamicExtensionsConstrainables.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const DynamicExtensions::Impl::MODEL_ID{
    .index = 1, .property = propertyOf<rows::properties::DynamicExtensionsModelID>};
constinit Slot const DynamicExtensions::Impl::EXTENSIONS{
    .index = 2, .composite = true, .single = false, .keyed = true,
    .opposite = &Extension::Impl::OWNER,
    .property = propertyOf<rows::properties::DynamicExtensionsExtensions>};
constinit Slot const DynamicExtensions::Impl::OWNING_CLASS{
    .index = 3, .opposite = &Class::Impl::EXTENSIONS,
    .property = propertyOf<rows::properties::DynamicExtensionsOwningClass>};

DynamicExtensions DynamicExtensions::cast(ModelElement const& element)
{
    return support::cast<DynamicExtensions>(element);
}

meta::Class const& DynamicExtensions::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::DynamicExtensions);
}

DynamicExtensions DynamicExtensions::create(Model const& model, UUID const& id)
{
    return support::create<DynamicExtensions>(model, id);
}

DynamicExtensions::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

DynamicExtensions::Impl::Impl(BuilderImpl& values, UUID const& id)
    : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

DynamicExtensions::Impl::~Impl() = default;

void DynamicExtensions::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementMap<ustring, Extension>> DynamicExtensions::Impl::makeExtensions(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Extension::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Extension>>(owner, keyOf, EXTENSIONS);
}

ElementMap<ustring, Extension>& DynamicExtensions::Impl::getExtensions() const
{
    return support::shownCollection(*this, m_extensions, &Impl::makeExtensions);
}

Class DynamicExtensions::Impl::getOwningClass() const
{
    return Class(getOwningClassImpl());
}

Class::Impl* DynamicExtensions::Impl::getOwningClassImpl() const
{
    return support::containerOf<Class::Impl>(*this, OWNING_CLASS);
}

bool DynamicExtensions::Impl::hasOwningClass() const
{
    return getOwningClassImpl() && getOwningClassImpl()->isLive();
}

void DynamicExtensions::Impl::setOwningClass(Class const& owningClass)
{
    auto const requireFree = [&] {
        support::requireFreeKey(owningClass->getExtensions(), getModelID());
    };
    support::setContainer(*this, OWNING_CLASS, owningClass.getImpl(), requireFree);
}

DynamicExtensions::Builder::Builder() = default;

DynamicExtensions::Builder::Builder(Model const& model) : BuilderBase(model) {}

DynamicExtensions::Builder::~Builder() = default;

DynamicExtensions::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, DynamicExtensions::metaClass(), source.second)
{}

DynamicExtensions::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      modelID(*this, propertyOf<rows::properties::DynamicExtensionsModelID>()),
      extensions(*this, propertyOf<rows::properties::DynamicExtensionsExtensions>()),
      owningClass(*this, propertyOf<rows::properties::DynamicExtensionsOwningClass>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::DynamicExtensions::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DynamicExtensions::Builder>;
