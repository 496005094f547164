// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/StringAttributeImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/StringAttributeBuilder.h"
#include "tarnkiln/meta/StringAttributeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const StringAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::StringAttributeValue>};

StringAttribute StringAttribute::cast(ModelElement const& element)
{
    return support::cast<StringAttribute>(element);
}

meta::Class const& StringAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::StringAttribute);
}

StringAttribute StringAttribute::create(Model const& model, UUID const& id)
{
    return support::create<StringAttribute>(model, id);
}

StringAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

StringAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

StringAttribute::Impl::~Impl() = default;

void StringAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void StringAttribute::Impl::setValue(ustring const& value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

StringAttribute::Builder::Builder() = default;

StringAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

StringAttribute::Builder::~Builder() = default;

StringAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, StringAttribute::metaClass(), source.second)
{}

StringAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::StringAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::StringAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::StringAttribute::Builder>;
