// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/EnumLiteralImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralBuilder.h"
#include "tarnkiln/meta/EnumLiteralConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const EnumLiteral::Impl::VALUE{
    .index = 2, .property = propertyOf<rows::properties::EnumLiteralValue>};
constinit Slot const EnumLiteral::Impl::PARENT_ENUM{
    .index = 3, .opposite = &Enum::Impl::LITERALS,
    .property = propertyOf<rows::properties::EnumLiteralParentEnum>};
constinit Slot const EnumLiteral::Impl::PUBLIC_IDENTIFIER{
    .index = 4, .property = propertyOf<rows::properties::EnumLiteralPublicIdentifier>};

EnumLiteral EnumLiteral::cast(ModelElement const& element)
{
    return support::cast<EnumLiteral>(element);
}

meta::Class const& EnumLiteral::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::EnumLiteral);
}

EnumLiteral EnumLiteral::create(Model const& model, UUID const& id)
{
    return support::create<EnumLiteral>(model, id);
}

EnumLiteral::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

EnumLiteral::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

EnumLiteral::Impl::~Impl() = default;

void EnumLiteral::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void EnumLiteral::Impl::setValue(int value)
{
    support::setScalar(*this, m_value, VALUE, value);
}

Enum EnumLiteral::Impl::getParentEnum() const
{
    return Enum(getParentEnumImpl());
}

Enum::Impl* EnumLiteral::Impl::getParentEnumImpl() const
{
    return support::containerOf<Enum::Impl>(*this, PARENT_ENUM);
}

bool EnumLiteral::Impl::hasParentEnum() const
{
    return getParentEnumImpl() && getParentEnumImpl()->isLive();
}

void EnumLiteral::Impl::setParentEnum(Enum const& parentEnum)
{
    auto const requireFree = [&] {
        support::requireFreeKey(parentEnum->getLiterals(), getName());
    };
    support::setContainer(*this, PARENT_ENUM, parentEnum.getImpl(), requireFree);
}

void EnumLiteral::Impl::setPublicIdentifier(boost::optional<ustring> const& publicIdentifier)
{
    support::setScalar(*this, m_publicIdentifier, PUBLIC_IDENTIFIER, publicIdentifier);
}

void EnumLiteral::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getParentEnum()->getLiterals(), name);
    };
    auto const store = [&] { NamedElement::Impl::setName(name); };
    support::changeKey(*this, getName(), name, getParentEnum(), PARENT_ENUM, requireFree, store);
}

EnumLiteral::Builder::Builder() = default;

EnumLiteral::Builder::Builder(Model const& model) : BuilderBase(model) {}

EnumLiteral::Builder::~Builder() = default;

EnumLiteral::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, EnumLiteral::metaClass(), source.second)
{}

EnumLiteral::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : NamedElement::Constrainables(query, metaClass, mode),
      value(*this, propertyOf<rows::properties::EnumLiteralValue>()),
      parentEnum(*this, propertyOf<rows::properties::EnumLiteralParentEnum>()),
      publicIdentifier(*this, propertyOf<rows::properties::EnumLiteralPublicIdentifier>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::EnumLiteral::Impl, tarn::kiln::meta::NamedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::EnumLiteral::Builder>;
