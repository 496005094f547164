// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/EnumImpl.h"

#include "tarnkiln/meta/EnumBuilder.h"
#include "tarnkiln/meta/EnumConstrainables.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const Enum::Impl::LITERALS{
    .index = 4, .composite = true, .single = false, .keyed = true,
    .opposite = &EnumLiteral::Impl::PARENT_ENUM,
    .property = propertyOf<rows::properties::EnumLiterals>};
constinit Slot const Enum::Impl::UNDERLYING_TYPE{
    .index = 5, .property = propertyOf<rows::properties::EnumUnderlyingType>};

Enum Enum::cast(ModelElement const& element)
{
    return support::cast<Enum>(element);
}

meta::Class const& Enum::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Enum);
}

Enum Enum::create(Model const& model, UUID const& id)
{
    return support::create<Enum>(model, id);
}

Enum::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Enum::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Enum::Impl::~Impl() = default;

void Enum::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

std::unique_ptr<ElementMap<ustring, EnumLiteral>> Enum::Impl::makeLiterals(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<EnumLiteral::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, EnumLiteral>>(owner, keyOf, LITERALS);
}

ElementMap<ustring, EnumLiteral>& Enum::Impl::getLiterals() const
{
    return support::shownCollection(*this, m_literals, &Impl::makeLiterals);
}

PrimitiveType Enum::Impl::getUnderlyingType() const
{
    return PrimitiveType(support::resolve(*this, m_underlyingType, UNDERLYING_TYPE));
}

bool Enum::Impl::hasUnderlyingType() const
{
    return m_underlyingType && m_underlyingType.get()->isLive();
}

void Enum::Impl::setUnderlyingType(PrimitiveType const& underlyingType)
{
    support::setReference(*this, m_underlyingType, UNDERLYING_TYPE, underlyingType.getImpl());
}

Enum::Builder::Builder() = default;

Enum::Builder::Builder(Model const& model) : BuilderBase(model) {}

Enum::Builder::~Builder() = default;

Enum::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Enum::metaClass(), source.second)
{}

Enum::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Type::Constrainables(query, metaClass, mode),
      literals(*this, propertyOf<rows::properties::EnumLiterals>()),
      underlyingType(*this, propertyOf<rows::properties::EnumUnderlyingType>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Enum::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Enum::Builder>;
