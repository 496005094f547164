// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/BooleanAttributeImpl.h"

#include "tarnkiln/meta/BooleanAttributeBuilder.h"
#include "tarnkiln/meta/BooleanAttributeConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const BooleanAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::BooleanAttributeValue>};

BooleanAttribute BooleanAttribute::cast(ModelElement const& element)
{
    return support::cast<BooleanAttribute>(element);
}

meta::Class const& BooleanAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::BooleanAttribute);
}

BooleanAttribute BooleanAttribute::create(Model const& model, UUID const& id)
{
    return support::create<BooleanAttribute>(model, id);
}

BooleanAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

BooleanAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

BooleanAttribute::Impl::~Impl() = default;

void BooleanAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void BooleanAttribute::Impl::setValue(bool value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

BooleanAttribute::Builder::Builder() = default;

BooleanAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

BooleanAttribute::Builder::~Builder() = default;

BooleanAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, BooleanAttribute::metaClass(), source.second)
{}

BooleanAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::BooleanAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::BooleanAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::BooleanAttribute::Builder>;
