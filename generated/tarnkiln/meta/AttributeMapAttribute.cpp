// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"

#include "tarnkiln/meta/AttributeMapAttributeBuilder.h"
#include "tarnkiln/meta/AttributeMapAttributeConstrainables.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const AttributeMapAttribute::Impl::VALUE{
    .index = 3, .composite = true,
    .property = propertyOf<rows::properties::AttributeMapAttributeValue>};

AttributeMapAttribute AttributeMapAttribute::cast(ModelElement const& element)
{
    return support::cast<AttributeMapAttribute>(element);
}

meta::Class const& AttributeMapAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::AttributeMapAttribute);
}

AttributeMapAttribute AttributeMapAttribute::create(Model const& model, UUID const& id)
{
    return support::create<AttributeMapAttribute>(model, id);
}

AttributeMapAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

AttributeMapAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

AttributeMapAttribute::Impl::~Impl() = default;

void AttributeMapAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

AttributeMap AttributeMapAttribute::Impl::getValue() const
{
    return AttributeMap(support::resolve(*this, m_value, VALUE));
}

bool AttributeMapAttribute::Impl::hasValue() const
{
    return m_value && m_value.get()->isLive();
}

void AttributeMapAttribute::Impl::setValue(AttributeMap const& value)
{
    support::setReference(*this, m_value, VALUE, value.getImpl());
}

AttributeMapAttribute::Builder::Builder() = default;

AttributeMapAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

AttributeMapAttribute::Builder::~Builder() = default;

AttributeMapAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, AttributeMapAttribute::metaClass(), source.second)
{}

AttributeMapAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::AttributeMapAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::AttributeMapAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::AttributeMapAttribute::Builder>;
