// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/PrimitiveTypeImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PrimitiveTypeBuilder.h"
#include "tarnkiln/meta/PrimitiveTypeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

PrimitiveType PrimitiveType::cast(ModelElement const& element)
{
    return support::cast<PrimitiveType>(element);
}

meta::Class const& PrimitiveType::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::PrimitiveType);
}

PrimitiveType PrimitiveType::create(Model const& model, UUID const& id)
{
    return support::create<PrimitiveType>(model, id);
}

PrimitiveType::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

PrimitiveType::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

PrimitiveType::Impl::~Impl() = default;

void PrimitiveType::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

PrimitiveType::Builder::Builder() = default;

PrimitiveType::Builder::Builder(Model const& model) : BuilderBase(model) {}

PrimitiveType::Builder::~Builder() = default;

PrimitiveType::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, PrimitiveType::metaClass(), source.second)
{}

PrimitiveType::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Type::Constrainables(query, metaClass, mode)
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::PrimitiveType::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::PrimitiveType::Builder>;
