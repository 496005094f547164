// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/AttributeMapImpl.h"

#include "tarnkiln/meta/AttributeImpl.h"
#include "tarnkiln/meta/AttributeMapBuilder.h"
#include "tarnkiln/meta/AttributeMapConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const AttributeMap::Impl::ATTRIBUTES{
    .index = 1, .composite = true, .single = false, .keyed = true,
    .opposite = &Attribute::Impl::OWNER,
    .property = propertyOf<rows::properties::AttributeMapAttributes>};
constinit Slot const AttributeMap::Impl::OWNER{
    .index = ModelElement::Impl::NO_INDEX,
    .property = propertyOf<rows::properties::AttributeMapOwner>};

AttributeMap AttributeMap::cast(ModelElement const& element)
{
    return support::cast<AttributeMap>(element);
}

meta::Class const& AttributeMap::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::AttributeMap);
}

AttributeMap AttributeMap::create(Model const& model, UUID const& id)
{
    return support::create<AttributeMap>(model, id);
}

AttributeMap::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

AttributeMap::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

AttributeMap::Impl::~Impl() = default;

void AttributeMap::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementMap<ustring, Attribute>> AttributeMap::Impl::makeAttributes(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Attribute::Impl*>(member)->getKey();
    };
    return std::make_unique<ElementMap<ustring, Attribute>>(owner, keyOf, ATTRIBUTES);
}

ElementMap<ustring, Attribute>& AttributeMap::Impl::getAttributes() const
{
    return support::shownCollection(*this, m_attributes, &Impl::makeAttributes);
}

AttributeMap::Builder::Builder() = default;

AttributeMap::Builder::Builder(Model const& model) : BuilderBase(model) {}

AttributeMap::Builder::~Builder() = default;

AttributeMap::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, AttributeMap::metaClass(), source.second)
{}

AttributeMap::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      owner(*this, propertyOf<rows::properties::AttributeMapOwner>()),
      attributes(*this, propertyOf<rows::properties::AttributeMapAttributes>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::AttributeMap::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::AttributeMap::Builder>;
