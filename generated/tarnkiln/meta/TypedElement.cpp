// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/TypedElementImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/TypedElementBuilder.h"
#include "tarnkiln/meta/TypedElementConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const TypedElement::Impl::TYPE{
    .index = 2, .property = propertyOf<rows::properties::TypedElementType>};
constinit Slot const TypedElement::Impl::LOWER{
    .index = 3, .property = propertyOf<rows::properties::TypedElementLower>};
constinit Slot const TypedElement::Impl::UPPER{
    .index = 4, .property = propertyOf<rows::properties::TypedElementUpper>};
constinit Slot const TypedElement::Impl::IS_ORDERED{
    .index = 5, .property = propertyOf<rows::properties::TypedElementIsOrdered>};

TypedElement TypedElement::cast(ModelElement const& element)
{
    return support::cast<TypedElement>(element);
}

meta::Class const& TypedElement::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::TypedElement);
}

TypedElement TypedElement::create(Model const& model, UUID const& id)
{
    return support::create<TypedElement>(model, id);
}

TypedElement::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

TypedElement::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

TypedElement::Impl::~Impl() = default;

void TypedElement::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

Type TypedElement::Impl::getType() const
{
    return Type(support::resolve(*this, m_type, TYPE));
}

bool TypedElement::Impl::hasType() const
{
    return m_type && m_type.get()->isLive();
}

void TypedElement::Impl::setType(Type const& type)
{
    support::setReference(*this, m_type, TYPE, type.getImpl());
}

void TypedElement::Impl::setLower(std::uint32_t lower)
{
    support::setScalar(*this, m_lower, LOWER, lower);
}

void TypedElement::Impl::setUpper(std::uint32_t upper)
{
    support::setScalar(*this, m_upper, UPPER, upper);
}

void TypedElement::Impl::setIsOrdered(bool ordered)
{
    support::setScalar(*this, m_isOrdered, IS_ORDERED, ordered);
}

TypedElement::Builder::Builder() = default;

TypedElement::Builder::Builder(Model const& model) : BuilderBase(model) {}

TypedElement::Builder::~Builder() = default;

TypedElement::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, TypedElement::metaClass(), source.second)
{}

TypedElement::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : NamedElement::Constrainables(query, metaClass, mode),
      type(*this, propertyOf<rows::properties::TypedElementType>()),
      lower(*this, propertyOf<rows::properties::TypedElementLower>()),
      upper(*this, propertyOf<rows::properties::TypedElementUpper>()),
      isOrdered(*this, propertyOf<rows::properties::TypedElementIsOrdered>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::TypedElement::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::TypedElement::Builder>;
