// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/UUIDAttributeImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/UUIDAttributeBuilder.h"
#include "tarnkiln/meta/UUIDAttributeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const UUIDAttribute::Impl::VALUE{
    .index = 3, .property = propertyOf<rows::properties::UUIDAttributeValue>};

UUIDAttribute UUIDAttribute::cast(ModelElement const& element)
{
    return support::cast<UUIDAttribute>(element);
}

meta::Class const& UUIDAttribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::UUIDAttribute);
}

UUIDAttribute UUIDAttribute::create(Model const& model, UUID const& id)
{
    return support::create<UUIDAttribute>(model, id);
}

UUIDAttribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

UUIDAttribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

UUIDAttribute::Impl::~Impl() = default;

void UUIDAttribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void UUIDAttribute::Impl::setValue(UUID const& value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

UUIDAttribute::Builder::Builder() = default;

UUIDAttribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

UUIDAttribute::Builder::~Builder() = default;

UUIDAttribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, UUIDAttribute::metaClass(), source.second)
{}

UUIDAttribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Attribute::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::UUIDAttributeValue>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::UUIDAttribute::Impl, tarn::kiln::meta::Attribute::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::UUIDAttribute::Impl, tarn::kiln::meta::Attribute::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::UUIDAttribute::Impl, tarn::kiln::meta::Attribute::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::UUIDAttribute::Builder>;
