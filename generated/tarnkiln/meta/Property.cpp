// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
#include "tarnkiln/meta/PropertyImpl.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/PropertyBuilder.h"
#include "tarnkiln/meta/PropertyConstrainables.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

constinit Slot const Property::Impl::IS_DERIVED{
    .index = 6, .property = propertyOf<rows::properties::PropertyIsDerived>};
constinit Slot const Property::Impl::IS_COMPOSITE{
    .index = 7, .property = propertyOf<rows::properties::PropertyIsComposite>};
constinit Slot const Property::Impl::IS_READ_ONLY{
    .index = 8, .property = propertyOf<rows::properties::PropertyIsReadOnly>};
constinit Slot const Property::Impl::IS_UNIQUE{
    .index = 9, .property = propertyOf<rows::properties::PropertyIsUnique>};
constinit Slot const Property::Impl::QUALIFIED_BY{
    .index = 10, .property = propertyOf<rows::properties::PropertyQualifiedBy>};
constinit Slot const Property::Impl::CUSTOM_QUALIFICATION{
    .index = 11, .property = propertyOf<rows::properties::PropertyCustomQualification>};
constinit Slot const Property::Impl::IS_QUALIFICATION_UNIQUE{
    .index = 12, .property = propertyOf<rows::properties::PropertyIsQualificationUnique>};
constinit Slot const Property::Impl::OPPOSITE{
    .index = 13, .property = propertyOf<rows::properties::PropertyOpposite>};
constinit Slot const Property::Impl::PROPERTY_INDEX{
    .index = 14, .property = propertyOf<rows::properties::PropertyPropertyIndex>};
constinit Slot const Property::Impl::IS_PUBLIC_ACCESSOR{
    .index = 15, .property = propertyOf<rows::properties::PropertyIsPublicAccessor>};
constinit Slot const Property::Impl::IS_PUBLIC_MUTATOR{
    .index = 16, .property = propertyOf<rows::properties::PropertyIsPublicMutator>};
constinit Slot const Property::Impl::IS_TRANSIENT{
    .index = 17, .property = propertyOf<rows::properties::PropertyIsTransient>};
constinit Slot const Property::Impl::IS_SPARSE{
    .index = 18, .property = propertyOf<rows::properties::PropertyIsSparse>};
constinit Slot const Property::Impl::OWNING_TYPE{
    .index = 19, .opposite = &StructuredType::Impl::OWNED_ATTRIBUTES,
    .property = propertyOf<rows::properties::PropertyOwningType>};
constinit Slot const Property::Impl::VOBJ_DISP_CATEGORY{
    .index = 20, .property = propertyOf<rows::properties::PropertyVobjDispCategory>};
constinit Slot const Property::Impl::VOBJ_DISP_SKIP_EMPTY{
    .index = 21, .property = propertyOf<rows::properties::PropertyVobjDispSkipEmpty>};
constinit Slot const Property::Impl::IS_SET_ONCE{
    .index = 22, .property = propertyOf<rows::properties::PropertyIsSetOnce>};
constinit Slot const Property::Impl::IS_VOBJ_HIDDEN{
    .index = 23, .property = propertyOf<rows::properties::PropertyIsVobjHidden>};
constinit Slot const Property::Impl::DEFAULT_VALUE{
    .index = 24, .property = propertyOf<rows::properties::PropertyDefaultValue>};
constinit Slot const Property::Impl::IS_QUERY_INDEX{
    .index = 25, .property = propertyOf<rows::properties::PropertyIsQueryIndex>};

Property Property::cast(ModelElement const& element)
{
    return support::cast<Property>(element);
}

meta::Class const& Property::metaClass()
{
    return MetaPackageMeta::getInstance().getClass(rows::classes::Property);
}

Property Property::create(Model const& model, UUID const& id)
{
    return support::create<Property>(model, id);
}

Property::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id) {}

Property::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values, id)
{
    values.construct(*this);
}

Property::Impl::~Impl() = default;

void Property::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Property::Impl::setIsDerived(bool derived)
{
    support::setScalar(*this, m_isDerived, IS_DERIVED, derived);
}

void Property::Impl::setIsComposite(bool composite)
{
    support::setScalar(*this, m_isComposite, IS_COMPOSITE, composite);
}

void Property::Impl::setIsReadOnly(bool readOnly)
{
    support::setScalar(*this, m_isReadOnly, IS_READ_ONLY, readOnly);
}

void Property::Impl::setIsUnique(bool unique)
{
    support::setScalar(*this, m_isUnique, IS_UNIQUE, unique);
}

Property Property::Impl::getQualifiedBy() const
{
    return Property(support::resolve(*this, m_qualifiedBy, QUALIFIED_BY));
}

bool Property::Impl::hasQualifiedBy() const
{
    return m_qualifiedBy && m_qualifiedBy.get()->isLive();
}

void Property::Impl::setQualifiedBy(Property const& qualifiedBy)
{
    support::setReference(*this, m_qualifiedBy, QUALIFIED_BY, qualifiedBy.getImpl());
}

void Property::Impl::setCustomQualification(bool customQualification)
{
    support::setScalar(*this, m_customQualification, CUSTOM_QUALIFICATION, customQualification);
}

void Property::Impl::setIsQualificationUnique(bool qualificationUnique)
{
    support::setScalar(
        *this, m_isQualificationUnique, IS_QUALIFICATION_UNIQUE, qualificationUnique);
}

Property Property::Impl::getOpposite() const
{
    return Property(support::resolve(*this, m_opposite, OPPOSITE));
}

bool Property::Impl::hasOpposite() const
{
    return m_opposite && m_opposite.get()->isLive();
}

void Property::Impl::setOpposite(Property const& opposite)
{
    support::setReference(*this, m_opposite, OPPOSITE, opposite.getImpl());
}

void Property::Impl::setPropertyIndex(int propertyIndex)
{
    support::setScalar(*this, m_propertyIndex, PROPERTY_INDEX, propertyIndex);
}

void Property::Impl::setIsPublicAccessor(bool publicAccessor)
{
    support::setScalar(*this, m_isPublicAccessor, IS_PUBLIC_ACCESSOR, publicAccessor);
}

void Property::Impl::setIsPublicMutator(bool publicMutator)
{
    support::setScalar(*this, m_isPublicMutator, IS_PUBLIC_MUTATOR, publicMutator);
}

void Property::Impl::setIsTransient(bool transient)
{
    support::setScalar(*this, m_isTransient, IS_TRANSIENT, transient);
}

void Property::Impl::setIsSparse(bool sparse)
{
    support::setScalar(*this, m_isSparse, IS_SPARSE, sparse);
}

StructuredType Property::Impl::getOwningType() const
{
    return StructuredType(getOwningTypeImpl());
}

StructuredType::Impl* Property::Impl::getOwningTypeImpl() const
{
    return support::containerOf<StructuredType::Impl>(*this, OWNING_TYPE);
}

bool Property::Impl::hasOwningType() const
{
    return getOwningTypeImpl() && getOwningTypeImpl()->isLive();
}

void Property::Impl::setOwningType(StructuredType const& owningType)
{
    auto const requireFree = [&] {
        support::requireFreeKey(owningType->getOwnedAttributes(), getName());
    };
    support::setContainer(*this, OWNING_TYPE, owningType.getImpl(), requireFree);
}

void Property::Impl::setVobjDispCategory(boost::optional<string> const& vobjDispCategory)
{
    support::setScalar(*this, m_vobjDispCategory, VOBJ_DISP_CATEGORY, vobjDispCategory);
}

void Property::Impl::setVobjDispSkipEmpty(bool vobjDispSkipEmpty)
{
    support::setScalar(*this, m_vobjDispSkipEmpty, VOBJ_DISP_SKIP_EMPTY, vobjDispSkipEmpty);
}

void Property::Impl::setIsSetOnce(bool setOnce)
{
    support::setScalar(*this, m_isSetOnce, IS_SET_ONCE, setOnce);
}

void Property::Impl::setIsVobjHidden(bool vobjHidden)
{
    support::setScalar(*this, m_isVobjHidden, IS_VOBJ_HIDDEN, vobjHidden);
}

void Property::Impl::setDefaultValue(boost::optional<ustring> const& defaultValue)
{
    support::setScalar(*this, m_defaultValue, DEFAULT_VALUE, defaultValue);
}

void Property::Impl::setIsQueryIndex(bool queryIndex)
{
    support::setScalar(*this, m_isQueryIndex, IS_QUERY_INDEX, queryIndex);
}

void Property::Impl::setName(ustring const& name)
{
    auto const requireFree = [&] {
        support::requireFreeKey(getOwningType()->getOwnedAttributes(), name);
    };
    auto const store = [&] { TypedElement::Impl::setName(name); };
    support::changeKey(*this, getName(), name, getOwningType(), OWNING_TYPE, requireFree, store);
}

Property::Builder::Builder() = default;

Property::Builder::Builder(Model const& model) : BuilderBase(model) {}

Property::Builder::~Builder() = default;

Property::Constrainables::Constrainables(
    std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source)
    : Constrainables(source.first, Property::metaClass(), source.second)
{}

Property::Constrainables::Constrainables(
    query::AbstractQuery& query, meta::Class const& metaClass, query::SearchClassMatchMode mode)
    : TypedElement::Constrainables(query, metaClass, mode),
      isDerived(*this, propertyOf<rows::properties::PropertyIsDerived>()),
      isComposite(*this, propertyOf<rows::properties::PropertyIsComposite>()),
      isReadOnly(*this, propertyOf<rows::properties::PropertyIsReadOnly>()),
      isUnique(*this, propertyOf<rows::properties::PropertyIsUnique>()),
      qualifiedBy(*this, propertyOf<rows::properties::PropertyQualifiedBy>()),
      customQualification(*this, propertyOf<rows::properties::PropertyCustomQualification>()),
      isQualificationUnique(*this, propertyOf<rows::properties::PropertyIsQualificationUnique>()),
      opposite(*this, propertyOf<rows::properties::PropertyOpposite>()),
      propertyIndex(*this, propertyOf<rows::properties::PropertyPropertyIndex>()),
      isPublicAccessor(*this, propertyOf<rows::properties::PropertyIsPublicAccessor>()),
      isPublicMutator(*this, propertyOf<rows::properties::PropertyIsPublicMutator>()),
      isTransient(*this, propertyOf<rows::properties::PropertyIsTransient>()),
      isSparse(*this, propertyOf<rows::properties::PropertyIsSparse>()),
      owningType(*this, propertyOf<rows::properties::PropertyOwningType>()),
      vobjDispCategory(*this, propertyOf<rows::properties::PropertyVobjDispCategory>()),
      vobjDispSkipEmpty(*this, propertyOf<rows::properties::PropertyVobjDispSkipEmpty>()),
      isSetOnce(*this, propertyOf<rows::properties::PropertyIsSetOnce>()),
      isVobjHidden(*this, propertyOf<rows::properties::PropertyIsVobjHidden>()),
      defaultValue(*this, propertyOf<rows::properties::PropertyDefaultValue>()),
      isQueryIndex(*this, propertyOf<rows::properties::PropertyIsQueryIndex>())
{}
}  // namespace tarn::kiln::meta

template class tarn::kiln::support::Record<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl>;
template class tarn::kiln::support::BuilderValues<
    tarn::kiln::meta::Property::Impl, tarn::kiln::meta::TypedElement::Impl::BuilderImpl>;
template class tarn::kiln::support::BuilderTop<tarn::kiln::meta::Property::Builder>;
