/// \file
/// Forward declarations of the metamodel's handles and helpers.
#pragma once

namespace tarn::kiln::meta {
class AbstractDeferredInvocation;
class AbstractEvent;
class AbstractMethodInvoker;
class Argument;
class Attribute;
class AttributeMap;
class AttributeMapAttribute;
class BooleanAttribute;
class Class;
class DataModelUsageProvider;
class DataType;
class DatatypeSerializer;
class DateTimeAttribute;
class DynamicExtensions;
class Enum;
class EnumLiteral;
class Extension;
class ExtensionPrototype;
class IntegerAttribute;
class MetaRegistry;
class NamedElement;
class Operation;
class Package;
class PrimitiveType;
class Property;
class PropertySerializer;
class PropertySerializerRegistry;
class RealAttribute;
class StringAttribute;
class StructuredType;
class TransactionOrigin;
class Type;
class TypedElement;
class UUIDAttribute;
enum class Language : int;
}  // namespace tarn::kiln::meta
