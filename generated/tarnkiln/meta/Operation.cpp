// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/OperationImpl.h"

#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/OperationBuilder.h"
#include "tarnkiln/meta/OperationConstrainables.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Operation::Impl::ARGUMENTS{
    .index = 6, .composite = true, .single = false, .opposite = &Argument::Impl::OPERATION,
    .property = propertyOf<rows::properties::OperationArguments>};
constinit Slot const Operation::Impl::OWNING_TYPE{
    .index = 7, .opposite = &StructuredType::Impl::OWNED_OPERATIONS,
    .property = propertyOf<rows::properties::OperationOwningType>};
constinit Slot const Operation::Impl::IS_ABSTRACT{
    .index = 8, .property = propertyOf<rows::properties::OperationIsAbstract>};
constinit Slot const Operation::Impl::IS_STATIC{
    .index = 9, .property = propertyOf<rows::properties::OperationIsStatic>};
constinit Slot const Operation::Impl::IS_PUBLIC{
    .index = 10, .property = propertyOf<rows::properties::OperationIsPublic>};
constinit Slot const Operation::Impl::IS_EVENT{
    .index = 11, .property = propertyOf<rows::properties::OperationIsEvent>};

Operation Operation::cast(ModelElement const& element)
{
    return support::cast<Operation>(element);
}

meta::Class const& Operation::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Operation);
}

Operation Operation::create(Model const& model, UUID const& id)
{
    return support::create<Operation>(model, id);
}

Operation::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Operation::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Operation::Impl::~Impl() = default;

void Operation::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementSequence<Argument>> Operation::Impl::makeArguments(Impl* owner)
{
    return std::make_unique<ElementSequence<Argument>>(owner, /*unique=*/true, ARGUMENTS);
}

ElementSequence<Argument>& Operation::Impl::getArguments() const
{
    return support::shownCollection(*this, m_arguments, &Impl::makeArguments);
}

StructuredType Operation::Impl::getOwningType() const
{
    return StructuredType(getOwningTypeImpl());
}

StructuredType::Impl* Operation::Impl::getOwningTypeImpl() const
{
    return support::containerOf<StructuredType::Impl>(*this, OWNING_TYPE);
}

bool Operation::Impl::hasOwningType() const
{
    return getOwningTypeImpl() && getOwningTypeImpl()->isLive();
}

void Operation::Impl::setOwningType(StructuredType const& owningType)
{
    support::setContainer(*this, OWNING_TYPE, owningType.getImpl());
}

void Operation::Impl::setIsAbstract(bool abstract)
{
    support::setScalar(*this, m_isAbstract, IS_ABSTRACT, abstract);
}

void Operation::Impl::setIsStatic(bool value)
{
    support::setScalar(*this, m_isStatic, IS_STATIC, value);
}

void Operation::Impl::setIsPublic(bool value)
{
    support::setScalar(*this, m_isPublic, IS_PUBLIC, value);
}

void Operation::Impl::setIsEvent(bool event)
{
    support::setScalar(*this, m_isEvent, IS_EVENT, event);
}

void Operation::Impl::setName(ustring const& name)
{
    auto const requireFree = [] {};
    auto const store = [&] { TypedElement::Impl::setName(name); };
    support::changeKey(*this, getName(), name, getOwningType(), OWNING_TYPE, requireFree, store);
}

Operation::Builder::Builder() = default;

Operation::Builder::Builder(Model const& model) : BuilderBase(model) {}

Operation::Builder::~Builder() = default;

Operation::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Operation::metaClass(), source.second)
{}

Operation::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : TypedElement::Constrainables(query, metaClass, mode),
      arguments(*this, propertyOf<rows::properties::OperationArguments>()),
      owningType(*this, propertyOf<rows::properties::OperationOwningType>()),
      isAbstract(*this, propertyOf<rows::properties::OperationIsAbstract>()),
      isStatic(*this, propertyOf<rows::properties::OperationIsStatic>()),
      isPublic(*this, propertyOf<rows::properties::OperationIsPublic>()),
      isEvent(*this, propertyOf<rows::properties::OperationIsEvent>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Operation::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Operation::Builder>;
