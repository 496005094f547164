// What the search instances of the catalogue's classes offer.
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/ArgumentConstrainables.h"
#include "tarnkiln/meta/AttributeConstrainables.h"
#include "tarnkiln/meta/AttributeMapAttributeConstrainables.h"
#include "tarnkiln/meta/AttributeMapConstrainables.h"
#include "tarnkiln/meta/BooleanAttributeConstrainables.h"
#include "tarnkiln/meta/ClassConstrainables.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeConstrainables.h"
#include "tarnkiln/meta/DateTimeAttributeConstrainables.h"
#include "tarnkiln/meta/DynamicExtensionsConstrainables.h"
#include "tarnkiln/meta/EnumConstrainables.h"
#include "tarnkiln/meta/EnumLiteralConstrainables.h"
#include "tarnkiln/meta/ExtensionConstrainables.h"
#include "tarnkiln/meta/IntegerAttributeConstrainables.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/meta/OperationConstrainables.h"
#include "tarnkiln/meta/PackageConstrainables.h"
#include "tarnkiln/meta/PrimitiveTypeConstrainables.h"
#include "tarnkiln/meta/PropertyConstrainables.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/RealAttributeConstrainables.h"
#include "tarnkiln/meta/StringAttributeConstrainables.h"
#include "tarnkiln/meta/StructuredTypeConstrainables.h"
#include "tarnkiln/meta/TypeConstrainables.h"
#include "tarnkiln/meta/TypedElementConstrainables.h"
#include "tarnkiln/meta/UUIDAttributeConstrainables.h"
#include "tarnkiln/query/AbstractQuery.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <utility>

namespace tarn::kiln::meta {
namespace {

using query::AbstractQuery;
using query::ConstrainableRelationWithAttachment;
using query::ConstrainableWithAttachment;
using query::InstanceAttachment;
using query::SearchClassMatchMode;

/// Compares the members of a search instance of `C` with the properties that `C` declares, one
/// after the other; there must be no other ones.
template <class C> class Members
{
    using Instance = typename C::Constrainables;

public:
    ~Members() { EXPECT_EQ(m_count, C::metaClass()->getOwnedAttributes().size()); }

    template <class T, bool FLAG = false>
    Members& value(ConstrainableWithAttachment<T, InstanceAttachment, FLAG, void> Instance::*member,
                   ustring const& name)
    {
        return check(m_instance.*member, name);
    }
    template <class T>
    Members& reference(ConstrainableRelationWithAttachment<T, InstanceAttachment> Instance::*member,
                       ustring const& name)
    {
        return check(m_instance.*member, name);
    }

private:
    template <class Member> Members& check(Member const& member, ustring const& name)
    {
        Property const published = C::metaClass()->getPropertyByName(name);
        EXPECT_TRUE(published);
        EXPECT_EQ(member.getProperty(), published);
        EXPECT_EQ(published->getOwningType(), C::metaClass());
        EXPECT_EQ(&member.getAttachment().getInstance(), &m_instance);

        void const* const place = &member;
        EXPECT_LT(m_last, place) << "declared in another order";
        m_last = place;
        ++m_count;
        return *this;
    }

    AbstractQuery m_query;
    Instance m_instance{{m_query, SearchClassMatchMode::MatchExactClass}};
    void const* m_last = nullptr;
    std::size_t m_count = 0;
};

template <class C, class Base> void extends()
{
    using Instance = typename C::Constrainables;
    static_assert(std::is_base_of_v<typename Base::Constrainables, Instance>);
    static_assert(std::is_same_v<typename Instance::Handle, C>);
    static_assert(
        std::is_constructible_v<Instance,
                                std::pair<AbstractQuery&, SearchClassMatchMode const> const&>);
    static_assert(
        std::is_constructible_v<Instance, AbstractQuery&, Class const&, SearchClassMatchMode>);
    static_assert(!std::is_constructible_v<Instance, AbstractQuery&>);
    static_assert(!std::is_copy_constructible_v<Instance>);
    static_assert(!std::is_copy_assignable_v<Instance>);
    EXPECT_EQ(C::metaClass()->getSuperclass(), Base::metaClass());
}

TEST(CatalogueConstrainables, HasTheMembersOfArgument)
{
    extends<Argument, TypedElement>();
    Members<Argument>()
        .reference<Operation>(&Argument::Constrainables::operation, u"operation")
        .value<bool>(&Argument::Constrainables::isInput, u"isInput");
}

TEST(CatalogueConstrainables, HasTheMembersOfAttribute)
{
    extends<Attribute, ModelElement>();
    Members<Attribute>()
        .value<ustring, true>(&Attribute::Constrainables::key, u"key")
        .reference<AttributeMap>(&Attribute::Constrainables::owner, u"owner");
}

TEST(CatalogueConstrainables, HasTheMembersOfAttributeMap)
{
    extends<AttributeMap, ModelElement>();
    Members<AttributeMap>()
        .reference<ModelElement>(&AttributeMap::Constrainables::owner, u"owner")
        .reference<Attribute>(&AttributeMap::Constrainables::attributes, u"attributes");
}

TEST(CatalogueConstrainables, HasTheMembersOfAttributeMapAttribute)
{
    extends<AttributeMapAttribute, Attribute>();
    Members<AttributeMapAttribute>().reference<AttributeMap>(
        &AttributeMapAttribute::Constrainables::value, u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfBooleanAttribute)
{
    extends<BooleanAttribute, Attribute>();
    Members<BooleanAttribute>().value<bool>(&BooleanAttribute::Constrainables::value, u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfClass)
{
    extends<Class, StructuredType>();
    Members<Class>()
        .reference<Class>(&Class::Constrainables::superclass, u"superclass")
        .reference<DynamicExtensions>(&Class::Constrainables::extensions, u"extensions")
        .value<bool>(&Class::Constrainables::isAbstract, u"isAbstract");
}

TEST(CatalogueConstrainables, HasTheMembersOfDataType)
{
    extends<DataType, StructuredType>();
    Members<DataType>();
}

TEST(CatalogueConstrainables, HasTheMembersOfDateTimeAttribute)
{
    extends<DateTimeAttribute, Attribute>();
    Members<DateTimeAttribute>().value<boost::posix_time::ptime>(
        &DateTimeAttribute::Constrainables::value, u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfDynamicExtensions)
{
    extends<DynamicExtensions, ModelElement>();
    Members<DynamicExtensions>()
        .value<unsigned long>(&DynamicExtensions::Constrainables::modelID, u"modelID")
        .reference<Extension>(&DynamicExtensions::Constrainables::extensions, u"extensions")
        .reference<Class>(&DynamicExtensions::Constrainables::owningClass, u"owningClass");
}

TEST(CatalogueConstrainables, HasTheMembersOfEnum)
{
    extends<Enum, Type>();
    Members<Enum>()
        .reference<EnumLiteral>(&Enum::Constrainables::literals, u"literals")
        .reference<PrimitiveType>(&Enum::Constrainables::underlyingType, u"underlyingType");
}

TEST(CatalogueConstrainables, HasTheMembersOfEnumLiteral)
{
    extends<EnumLiteral, NamedElement>();
    Members<EnumLiteral>()
        .value<int>(&EnumLiteral::Constrainables::value, u"value")
        .reference<Enum>(&EnumLiteral::Constrainables::parentEnum, u"parentEnum")
        .value<ustring>(&EnumLiteral::Constrainables::publicIdentifier, u"publicIdentifier");
}

TEST(CatalogueConstrainables, HasTheMembersOfExtension)
{
    extends<Extension, Property>();
    Members<Extension>()
        .reference<Class>(&Extension::Constrainables::extendedMetaclass, u"extendedMetaclass")
        .reference<DynamicExtensions>(&Extension::Constrainables::owner, u"owner");
}

TEST(CatalogueConstrainables, HasTheMembersOfIntegerAttribute)
{
    extends<IntegerAttribute, Attribute>();
    Members<IntegerAttribute>().value<int>(&IntegerAttribute::Constrainables::value, u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfNamedElement)
{
    extends<NamedElement, ModelElement>();
    Members<NamedElement>().value<ustring, true>(&NamedElement::Constrainables::name, u"name");
}

TEST(CatalogueConstrainables, HasTheMembersOfOperation)
{
    extends<Operation, TypedElement>();
    Members<Operation>()
        .reference<Argument>(&Operation::Constrainables::arguments, u"arguments")
        .reference<StructuredType>(&Operation::Constrainables::owningType, u"owningType")
        .value<bool>(&Operation::Constrainables::isAbstract, u"isAbstract")
        .value<bool>(&Operation::Constrainables::isStatic, u"isStatic")
        .value<bool>(&Operation::Constrainables::isPublic, u"isPublic")
        .value<bool>(&Operation::Constrainables::isEvent, u"isEvent");
}

TEST(CatalogueConstrainables, HasTheMembersOfPackage)
{
    extends<Package, NamedElement>();
    Members<Package>()
        .reference<Type>(&Package::Constrainables::ownedTypes, u"ownedTypes")
        .reference<Package>(&Package::Constrainables::nestedPackages, u"nestedPackages")
        .value<ustring, true>(&Package::Constrainables::qualifiedName, u"qualifiedName")
        .value<ustring, true>(&Package::Constrainables::uri, u"uri")
        .reference<Package>(&Package::Constrainables::parentPackage, u"parentPackage")
        .value<ustring>(&Package::Constrainables::importedPackageURIs, u"importedPackageURIs")
        .value<string>(&Package::Constrainables::defaultVobjCategory, u"defaultVobjCategory")
        .reference<Enum>(&Package::Constrainables::enumerations, u"enumerations")
        .reference<Class>(&Package::Constrainables::classes, u"classes")
        .reference<DataType>(&Package::Constrainables::dataTypes, u"dataTypes")
        .reference<PrimitiveType>(&Package::Constrainables::primitiveTypes, u"primitiveTypes");
}

TEST(CatalogueConstrainables, HasTheMembersOfPrimitiveType)
{
    extends<PrimitiveType, Type>();
    Members<PrimitiveType>();
}

TEST(CatalogueConstrainables, HasTheMembersOfProperty)
{
    extends<Property, TypedElement>();
    Members<Property>()
        .value<bool>(&Property::Constrainables::isDerived, u"isDerived")
        .value<bool>(&Property::Constrainables::isComposite, u"isComposite")
        .value<bool>(&Property::Constrainables::isReadOnly, u"isReadOnly")
        .value<bool>(&Property::Constrainables::isUnique, u"isUnique")
        .reference<Property>(&Property::Constrainables::qualifiedBy, u"qualifiedBy")
        .value<bool>(&Property::Constrainables::customQualification, u"customQualification")
        .value<bool>(&Property::Constrainables::isQualificationUnique, u"isQualificationUnique")
        .reference<Property>(&Property::Constrainables::opposite, u"opposite")
        .value<int>(&Property::Constrainables::propertyIndex, u"propertyIndex")
        .value<bool>(&Property::Constrainables::isPublicAccessor, u"isPublicAccessor")
        .value<bool>(&Property::Constrainables::isPublicMutator, u"isPublicMutator")
        .value<bool>(&Property::Constrainables::isTransient, u"isTransient")
        .value<bool>(&Property::Constrainables::isSparse, u"isSparse")
        .reference<StructuredType>(&Property::Constrainables::owningType, u"owningType")
        .value<string>(&Property::Constrainables::vobjDispCategory, u"vobjDispCategory")
        .value<bool>(&Property::Constrainables::vobjDispSkipEmpty, u"vobjDispSkipEmpty")
        .value<bool>(&Property::Constrainables::isSetOnce, u"isSetOnce")
        .value<bool>(&Property::Constrainables::isVobjHidden, u"isVobjHidden")
        .value<ustring>(&Property::Constrainables::defaultValue, u"defaultValue")
        .value<bool>(&Property::Constrainables::isQueryIndex, u"isQueryIndex");
}

TEST(CatalogueConstrainables, HasTheMembersOfRealAttribute)
{
    extends<RealAttribute, Attribute>();
    Members<RealAttribute>().value<double>(&RealAttribute::Constrainables::value, u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfStringAttribute)
{
    extends<StringAttribute, Attribute>();
    Members<StringAttribute>().value<ustring, true>(&StringAttribute::Constrainables::value,
                                                    u"value");
}

TEST(CatalogueConstrainables, HasTheMembersOfStructuredType)
{
    extends<StructuredType, Type>();
    Members<StructuredType>()
        .value<string, true>(&StructuredType::Constrainables::vobjName, u"vobjName")
        .reference<Property>(&StructuredType::Constrainables::ownedAttributes, u"ownedAttributes")
        .reference<Operation>(&StructuredType::Constrainables::ownedOperations, u"ownedOperations")
        .value<bool>(&StructuredType::Constrainables::vobjCompactDisplay, u"vobjCompactDisplay")
        .value<string>(&StructuredType::Constrainables::vobjDispCategories, u"vobjDispCategories");
}

TEST(CatalogueConstrainables, HasTheMembersOfType)
{
    extends<Type, NamedElement>();
    Members<Type>()
        .value<ustring, true>(&Type::Constrainables::qualifiedName, u"qualifiedName")
        .value<bool>(&Type::Constrainables::isVobjHidden, u"isVobjHidden")
        .reference<Package>(&Type::Constrainables::owningPackage, u"owningPackage");
}

TEST(CatalogueConstrainables, HasTheMembersOfTypedElement)
{
    extends<TypedElement, NamedElement>();
    Members<TypedElement>()
        .reference<Type>(&TypedElement::Constrainables::type, u"type")
        .value<unsigned int>(&TypedElement::Constrainables::lower, u"lower")
        .value<unsigned int>(&TypedElement::Constrainables::upper, u"upper")
        .value<bool>(&TypedElement::Constrainables::isOrdered, u"isOrdered");
}

TEST(CatalogueConstrainables, HasTheMembersOfUUIDAttribute)
{
    extends<UUIDAttribute, Attribute>();
    Members<UUIDAttribute>().value<UUID>(&UUIDAttribute::Constrainables::value, u"value");
}

}  // namespace
}  // namespace tarn::kiln::meta
