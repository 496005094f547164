// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/DateTimeAttributeImpl.h"

#include "tarnkiln/meta/DateTimeAttributeBuilder.h"
#include "tarnkiln/meta/DateTimeAttributeConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const DateTimeAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::DateTimeAttributeValue>};

DateTimeAttribute DateTimeAttribute::cast(ModelElement const& element)
{
    return support::cast<DateTimeAttribute>(element);
}

meta::Class const& DateTimeAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::DateTimeAttribute);
}

DateTimeAttribute DateTimeAttribute::create(Model const& model, UUID const& id)
{
    return support::create<DateTimeAttribute>(model, id);
}

DateTimeAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

DateTimeAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

DateTimeAttribute::Impl::~Impl() = default;

void DateTimeAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void DateTimeAttribute::Impl::setValue(boost::posix_time::ptime const& value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

DateTimeAttribute::Builder::Builder() = default;

DateTimeAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

DateTimeAttribute::Builder::~Builder() = default;

DateTimeAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, DateTimeAttribute::metaClass(), source.second)
{}

DateTimeAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::DateTimeAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::DateTimeAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DateTimeAttribute::Builder>;
