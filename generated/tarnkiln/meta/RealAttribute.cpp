// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/RealAttributeImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/RealAttributeBuilder.h"
#include "tarnkiln/meta/RealAttributeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const RealAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::RealAttributeValue>};

RealAttribute RealAttribute::cast(ModelElement const& element)
{
    return support::cast<RealAttribute>(element);
}

meta::Class const& RealAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::RealAttribute);
}

RealAttribute RealAttribute::create(Model const& model, UUID const& id)
{
    return support::create<RealAttribute>(model, id);
}

RealAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

RealAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

RealAttribute::Impl::~Impl() = default;

void RealAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void RealAttribute::Impl::setValue(double value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

RealAttribute::Builder::Builder() = default;

RealAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

RealAttribute::Builder::~Builder() = default;

RealAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, RealAttribute::metaClass(), source.second)
{}

RealAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::RealAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::RealAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::RealAttribute::Builder>;
