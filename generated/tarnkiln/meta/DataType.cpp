// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/DataTypeImpl.h"

#include "tarnkiln/meta/DataTypeBuilder.h"
#include "tarnkiln/meta/DataTypeConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

DataType DataType::cast(ModelElement const& element)
{
    return support::cast<DataType>(element);
}

meta::Class const& DataType::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::DataType);
}

DataType DataType::create(Model const& model, UUID const& id)
{
    return support::create<DataType>(model, id);
}

DataType::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

DataType::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

DataType::Impl::~Impl() = default;

void DataType::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

DataType::Builder::Builder() = default;

DataType::Builder::Builder(Model const& model) : BuilderBase(model) {}

DataType::Builder::~Builder() = default;

DataType::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, DataType::metaClass(), source.second)
{}

DataType::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : StructuredType::Constrainables(query, metaClass, mode)
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::DataType::Impl, tarn::kiln::meta::StructuredType::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::DataType::Builder>;
