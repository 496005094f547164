// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/StructuredTypeImpl.h"

#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredTypeBuilder.h"
#include "tarnkiln/meta/StructuredTypeConstrainables.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"

namespace tarn::kiln::meta {

constinit Slot const StructuredType::Impl::VOBJ_NAME{
    .index = 4, .property = propertyOf<rows::properties::StructuredTypeVobjName>};
constinit Slot const StructuredType::Impl::OWNED_ATTRIBUTES{
    .index = 5, .composite = true, .single = false, .keyed = true,
    .opposite = &Property::Impl::OWNING_TYPE,
    .property = propertyOf<rows::properties::StructuredTypeOwnedAttributes>};
constinit Slot const StructuredType::Impl::OWNED_OPERATIONS{
    .index = 6, .composite = true, .single = false, .keyed = true,
    .opposite = &Operation::Impl::OWNING_TYPE,
    .property = propertyOf<rows::properties::StructuredTypeOwnedOperations>};
constinit Slot const StructuredType::Impl::VOBJ_COMPACT_DISPLAY{
    .index = 7, .property = propertyOf<rows::properties::StructuredTypeVobjCompactDisplay>};
constinit Slot const StructuredType::Impl::VOBJ_DISP_CATEGORIES{
    .index = 8, .single = false,
    .property = propertyOf<rows::properties::StructuredTypeVobjDispCategories>};

StructuredType StructuredType::cast(ModelElement const& element)
{
    return support::cast<StructuredType>(element);
}

meta::Class const& StructuredType::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::StructuredType);
}

StructuredType StructuredType::create(Model const& model, UUID const& id)
{
    return support::create<StructuredType>(model, id);
}

StructuredType::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

StructuredType::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

StructuredType::Impl::~Impl() = default;

void StructuredType::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void StructuredType::Impl::setVobjName(string const& vobjName)
{
    support::setScalar(*this, m_vobjName, VOBJ_NAME, vobjName);
}

std::unique_ptr<ElementMap<ustring, Property>>
StructuredType::Impl::makeOwnedAttributes(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Property::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Property>>(owner, keyOf, OWNED_ATTRIBUTES);
}

ElementMap<ustring, Property>& StructuredType::Impl::getOwnedAttributes() const
{
    return support::shownCollection(*this, m_ownedAttributes, &Impl::makeOwnedAttributes);
}

std::unique_ptr<ElementMultimap<ustring, Operation>>
StructuredType::Impl::makeOwnedOperations(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Operation::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMultimap<ustring, Operation>>(owner, keyOf, OWNED_OPERATIONS);
}

ElementMultimap<ustring, Operation>& StructuredType::Impl::getOwnedOperations() const
{
    return support::shownCollection(*this, m_ownedOperations, &Impl::makeOwnedOperations);
}

void StructuredType::Impl::setVobjCompactDisplay(bool vobjCompactDisplay)
{
    support::setScalar(*this, m_vobjCompactDisplay, VOBJ_COMPACT_DISPLAY, vobjCompactDisplay);
}

std::unique_ptr<PrimitiveSequence<string>> StructuredType::Impl::makeVobjDispCategories(Impl* owner)
{
    return std::make_unique<PrimitiveSequence<string>>(
        owner, /*unique=*/false, VOBJ_DISP_CATEGORIES);
}

PrimitiveSequence<string>& StructuredType::Impl::getVobjDispCategories() const
{
    return support::shownCollection(*this, m_vobjDispCategories, &Impl::makeVobjDispCategories);
}

StructuredType::Builder::Builder() = default;

StructuredType::Builder::Builder(Model const& model) : BuilderBase(model) {}

StructuredType::Builder::~Builder() = default;

StructuredType::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, StructuredType::metaClass(), source.second)
{}

StructuredType::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : Type::Constrainables(query, metaClass, mode),
      vobjName(*this, propertyOf<rows::properties::StructuredTypeVobjName>()),
      ownedAttributes(*this, propertyOf<rows::properties::StructuredTypeOwnedAttributes>()),
      ownedOperations(*this, propertyOf<rows::properties::StructuredTypeOwnedOperations>()),
      vobjCompactDisplay(*this, propertyOf<rows::properties::StructuredTypeVobjCompactDisplay>()),
      vobjDispCategories(*this, propertyOf<rows::properties::StructuredTypeVobjDispCategories>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::StructuredType::Impl, tarn::kiln::meta::Type::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::StructuredType::Builder>;
