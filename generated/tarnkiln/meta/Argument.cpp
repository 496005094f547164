// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/ArgumentImpl.h"

#include "tarnkiln/meta/ArgumentBuilder.h"
#include "tarnkiln/meta/ArgumentConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const Argument::Impl::OPERATION{
    .index = 6, .opposite = &Operation::Impl::ARGUMENTS,
    .property = propertyOf<rows::properties::ArgumentOperation>};
constinit Slot const Argument::Impl::IS_INPUT{
    .index = 7, .property = propertyOf<rows::properties::ArgumentIsInput>};

Argument Argument::cast(ModelElement const& element)
{
    return support::cast<Argument>(element);
}

meta::Class const& Argument::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Argument);
}

Argument Argument::create(Model const& model, UUID const& id)
{
    return support::create<Argument>(model, id);
}

Argument::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Argument::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Argument::Impl::~Impl() = default;

void Argument::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

Operation Argument::Impl::getOperation() const
{
    return Operation(getOperationImpl());
}

Operation::Impl* Argument::Impl::getOperationImpl() const
{
    return support::containerOf<Operation::Impl>(*this, OPERATION);
}

bool Argument::Impl::hasOperation() const
{
    return getOperationImpl() && getOperationImpl()->isLive();
}

void Argument::Impl::setOperation(Operation const& value)
{
    support::setContainer(*this, OPERATION, value.getImpl());
}

void Argument::Impl::setIsInput(bool input)
{
    support::setScalar(*this, m_isInput, IS_INPUT, input);
}

Argument::Builder::Builder() = default;

Argument::Builder::Builder(Model const& model) : BuilderBase(model) {}

Argument::Builder::~Builder() = default;

Argument::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Argument::metaClass(), source.second)
{}

Argument::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : TypedElement::Constrainables(query, metaClass, mode),
      operation(*this, propertyOf<rows::properties::ArgumentOperation>()),
      isInput(*this, propertyOf<rows::properties::ArgumentIsInput>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Argument::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Argument::Builder>;
