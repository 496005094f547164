// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/IntegerAttributeImpl.h"

#include "tarnkiln/meta/IntegerAttributeBuilder.h"
#include "tarnkiln/meta/IntegerAttributeConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const IntegerAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::IntegerAttributeValue>};

IntegerAttribute IntegerAttribute::cast(ModelElement const& element)
{
    return support::cast<IntegerAttribute>(element);
}

meta::Class const& IntegerAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::IntegerAttribute);
}

IntegerAttribute IntegerAttribute::create(Model const& model, UUID const& id)
{
    return support::create<IntegerAttribute>(model, id);
}

IntegerAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

IntegerAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

IntegerAttribute::Impl::~Impl() = default;

void IntegerAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void IntegerAttribute::Impl::setValue(int value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

IntegerAttribute::Builder::Builder() = default;

IntegerAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

IntegerAttribute::Builder::~Builder() = default;

IntegerAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, IntegerAttribute::metaClass(), source.second)
{}

IntegerAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::IntegerAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::IntegerAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::IntegerAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::IntegerAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::IntegerAttribute::Builder>;
