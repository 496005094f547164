// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The rows of the metamodel, and their numbers by the names of what they stand for.
#pragma once
#include "tarnkiln/support/PackageRows.h"

#include <cstddef>

namespace tarn::kiln::meta {

/// The number of each row in its table.
namespace rows {

/// The tables that the metamodel is built from.
support::PackageRows const& all();

namespace packages {
enum Row : std::size_t
{
    Root,
    Tarn1,
    Kiln2,
    Meta3
};
}  // namespace packages

namespace primitiveTypes {
enum Row : std::size_t
{
    TarnModel
};
}  // namespace primitiveTypes

namespace classes {
enum Row : std::size_t
{
    Argument,
    Attribute,
    AttributeMap,
    AttributeMapAttribute,
    BooleanAttribute,
    Class,
    DataType,
    DateTimeAttribute,
    DynamicExtensions,
    Enum,
    EnumLiteral,
    Extension,
    IntegerAttribute,
    NamedElement,
    Operation,
    Package,
    PrimitiveType,
    Property,
    RealAttribute,
    StringAttribute,
    StructuredType,
    Type,
    TypedElement,
    UUIDAttribute
};
}  // namespace classes

namespace dataTypes {
enum Row : std::size_t
{
    ExtensionPrototype,
    TransactionOrigin
};
}  // namespace dataTypes

namespace properties {
enum Row : std::size_t
{
    ArgumentOperation,
    ArgumentIsInput,
    AttributeKey,
    AttributeOwner,
    AttributeMapOwner,
    AttributeMapAttributes,
    AttributeMapAttributeValue,
    BooleanAttributeValue,
    ClassSuperclass,
    ClassExtensions,
    ClassIsAbstract,
    DateTimeAttributeValue,
    DynamicExtensionsModelID,
    DynamicExtensionsExtensions,
    DynamicExtensionsOwningClass,
    EnumLiterals,
    EnumUnderlyingType,
    EnumLiteralValue,
    EnumLiteralParentEnum,
    EnumLiteralPublicIdentifier,
    ExtensionExtendedMetaclass,
    ExtensionOwner,
    IntegerAttributeValue,
    NamedElementName,
    OperationArguments,
    OperationOwningType,
    OperationIsAbstract,
    OperationIsStatic,
    OperationIsPublic,
    OperationIsEvent,
    PackageOwnedTypes,
    PackageNestedPackages,
    PackageQualifiedName,
    PackageUri,
    PackageParentPackage,
    PackageImportedPackageURIs,
    PackageDefaultVobjCategory,
    PackageEnumerations,
    PackageClasses,
    PackageDataTypes,
    PackagePrimitiveTypes,
    PropertyIsDerived,
    PropertyIsComposite,
    PropertyIsReadOnly,
    PropertyIsUnique,
    PropertyQualifiedBy,
    PropertyCustomQualification,
    PropertyIsQualificationUnique,
    PropertyOpposite,
    PropertyPropertyIndex,
    PropertyIsPublicAccessor,
    PropertyIsPublicMutator,
    PropertyIsTransient,
    PropertyIsSparse,
    PropertyOwningType,
    PropertyVobjDispCategory,
    PropertyVobjDispSkipEmpty,
    PropertyIsSetOnce,
    PropertyIsVobjHidden,
    PropertyDefaultValue,
    PropertyIsQueryIndex,
    RealAttributeValue,
    StringAttributeValue,
    StructuredTypeVobjName,
    StructuredTypeOwnedAttributes,
    StructuredTypeOwnedOperations,
    StructuredTypeVobjCompactDisplay,
    StructuredTypeVobjDispCategories,
    TypeQualifiedName,
    TypeIsVobjHidden,
    TypeOwningPackage,
    TypedElementType,
    TypedElementLower,
    TypedElementUpper,
    TypedElementIsOrdered,
    UUIDAttributeValue,
    ExtensionPrototypeLower,
    ExtensionPrototypeUpper,
    ExtensionPrototypeIsOrdered,
    ExtensionPrototypeIsUnique,
    ExtensionPrototypeName,
    ExtensionPrototypeTypeName,
    TransactionOriginModel,
    TransactionOriginLanguage,
    TransactionOriginTransactionId,
    TransactionOriginSynchronizer
};
}  // namespace properties

namespace operations {
enum Row : std::size_t
{
    AttributeGetType,
    AttributeMapInsert,
    AttributeMapInsertOrReplace,
    AttributeMapEmplace,
    AttributeMapAt,
    AttributeMapRecursiveAt,
    AttributeMapEraseValue,
    AttributeMapErase,
    AttributeMapRemoveValue,
    AttributeMapRemove,
    AttributeMapDoRecurse,
    ClassInstantiate,
    EnumFindLiteralByValue,
    EnumFindLiteralByPublicIdentifier,
    ExtensionCreatePrototype,
    PropertyIsDynamicDefault,
    StructuredTypeGetPropertyByName,
    StructuredTypeGetOperationsByName,
    StructuredTypeIsATypeOf,
    TypeIsA
};
}  // namespace operations

namespace arguments {
enum Row : std::size_t
{
    AttributeMapInsertAttr,
    AttributeMapInsertOrReplaceAttr,
    AttributeMapEmplaceFqn,
    AttributeMapEmplaceKey,
    AttributeMapAtKey,
    AttributeMapRecursiveAtKeys,
    AttributeMapEraseValueVal,
    AttributeMapEraseKey,
    AttributeMapRemoveValueVal,
    AttributeMapRemoveKey,
    AttributeMapDoRecurseKeys,
    AttributeMapDoRecurseIndex,
    AttributeMapDoRecurseSize,
    ClassInstantiateModel,
    ClassInstantiateUuid,
    EnumFindLiteralByValueValue,
    EnumFindLiteralByPublicIdentifierIdentifier,
    StructuredTypeGetPropertyByNameName,
    StructuredTypeGetOperationsByNameName,
    StructuredTypeIsATypeOfProperty,
    TypeIsAAnotherType
};
}  // namespace arguments

namespace enumerations {
enum Row : std::size_t
{
    Language
};
}  // namespace enumerations

namespace literals {
enum Row : std::size_t
{
    LanguageUnknown,
    LanguageCPlusPlus,
    LanguageJavaScript
};
}  // namespace literals
}  // namespace rows
}  // namespace tarn::kiln::meta
