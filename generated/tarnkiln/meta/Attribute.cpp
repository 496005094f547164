// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/AttributeImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/AttributeConstrainables.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Attribute::Impl::KEY{
    .index = 1, .property = propertyOf<rows::properties::AttributeKey>};
constinit Slot const Attribute::Impl::OWNER{
    .index = 2, .opposite = &AttributeMap::Impl::ATTRIBUTES,
    .property = propertyOf<rows::properties::AttributeOwner>};

Attribute Attribute::cast(ModelElement const& element)
{
    return support::cast<Attribute>(element);
}

meta::Class const& Attribute::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Attribute);
}

Attribute::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Attribute::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
}

Attribute::Impl::~Impl() = default;

void Attribute::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Attribute::Impl::setKey(ustring const& key)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getOwner()->getAttributes(), key);
    };
    auto const store = [&] { support::setScalar(*this, m_key, KEY, key); };
    support::changeKey(*this, getKey(), key, getOwner(), OWNER, requireFree, store);
}

AttributeMap Attribute::Impl::getOwner() const
{
    return AttributeMap(getOwnerImpl());
}

AttributeMap::Impl* Attribute::Impl::getOwnerImpl() const
{
    return support::containerOf<AttributeMap::Impl>(*this, OWNER);
}

bool Attribute::Impl::hasOwner() const
{
    return getOwnerImpl() && getOwnerImpl()->isLive();
}

void Attribute::Impl::setOwner(AttributeMap const& owner)
{
    auto const requireFree = [&] {
        support::requireFreeKey(owner->getAttributes(), getKey());
    };
    support::setContainer(*this, OWNER, owner.getImpl(), requireFree);
}

Attribute::Builder::Builder() = default;

Attribute::Builder::Builder(Model const& model) : BuilderBase(model) {}

Attribute::Builder::~Builder() = default;

Attribute::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Attribute::metaClass(), source.second)
{}

Attribute::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : ModelElement::Constrainables(query, metaClass, mode),
      key(*this, propertyOf<rows::properties::AttributeKey>()),
      owner(*this, propertyOf<rows::properties::AttributeOwner>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Attribute::Impl, tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Attribute::Builder>;
