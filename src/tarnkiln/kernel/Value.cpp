#include "tarnkiln/kernel/Value.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/support/ValuePayload.h"

#include <exception>
#include <memory>
#include <utility>

namespace tarn::kiln {

using internal::qualifiedName;
using tarnkiln::messages::CannotCastIncompatibleTypes;
using tarnkiln::messages::InvalidValue;

namespace {

bool isInRegistry(meta::Type const& type)
{
    return type->getModelImpl() == meta::MetaRegistry::getInstance().getModel().getImpl();
}
}  // namespace

Value Value::createEnumValue(meta::EnumLiteral const& literal)
{
    TARNKILN_ASSERT(literal.getElementImpl(), "only a literal has a value");
    return Value(literal->getParentEnum(), static_cast<long>(literal->getValue()));
}

Value Value::createOptionalEnumValue(meta::Property const& property,
                                     boost::optional<long> const& number)
{
    Value result(ValueMeta(typeOf(property), ValueFlags::OptionalSingle), nullptr);
    if (!internal::isEnumType(result.m_type))
        result.failCast();
    result.m_payload.setType<unsigned long>();
    if (number)
        result.m_payload.store(static_cast<unsigned long>(*number));
    return result;
}

Value Value::createCollectionValue(meta::Property const& property,
                                   AbstractOwnedCollection* collection)
{
    Value result(ValueMeta(property), nullptr);
    // Where a property has one value, the collection as a whole is that value.
    if (result.m_flags == ValueFlags::OptionalSingle)
        result.m_flags = ValueFlags::Single;
    result.m_payload.share(collection);
    return result;
}

Value Value::createReflectiveDataTypeValue(ReflectiveDataType const& value)
{
    Value result(ValueMeta(value.getDataType()), nullptr);
    result.m_payload.store(value);
    result.setReflective();
    return result;
}

Value Value::createReflectiveDataTypeValue(meta::DataType const& type, bool required)
{
    if (required)
        return createReflectiveDataTypeValue(ReflectiveDataType(type));
    Value result(ValueMeta(type, ValueFlags::OptionalSingle), nullptr);
    result.setReflective();
    return result;
}

Value Value::createEmptyValue(meta::Type const& type, bool required)
{
    if (internal::classImpl(type))
    {
        Value result(ValueMeta(type), nullptr);
        result.m_payload.store(ModelElement());
        return result;
    }
    auto const& registry = meta::PropertySerializerRegistry::getInstance();
    if (meta::DataType const dataType = meta::DataType::cast(type); dataType.getImpl())
    {
        if (auto const* const serializer = registry.getDatatypeSerializer(dataType))
            return required ? serializer->createDefaultValue()
                            : serializer->createEmptyOptionalValue();
        if (!dataType || isInRegistry(type))
            reportException(InvalidValue());
        return createReflectiveDataTypeValue(dataType, required);
    }
    auto const* const serializer = registry.getPropertySerializer(type, "");
    if (!serializer)
        reportException(InvalidValue());
    return required ? serializer->createDefaultValue(type)
                    : serializer->createEmptyOptionalValue(type);
}

Value Value::createEmptyValue(meta::Property const& property)
{
    if (!property.getElementImpl())
        reportException(InvalidValue());
    if (property->getUpper() > 1)
        reportException(CannotCastIncompatibleTypes(qualifiedName(property->getType())));
    return createEmptyValue(property->getType(), property->getLower() == 1);
}

Value& Value::operator=(Value const& other)
{
    if (this != &other)
        *this = Value(other);
    return *this;
}

// Leaves the extractor alone, so that the copy assignment does too.
Value& Value::operator=(Value&& other) noexcept
{
    if (this != &other)
    {
        ValueMeta::operator=(other);
        m_payload.swap(other.m_payload);
    }
    return *this;
}

bool Value::operator==(Value const& other) const
{
    return m_type == other.m_type && m_flags == other.m_flags && m_payload == other.m_payload;
}

boost::optional<long> Value::getEnumNumber() const
{
    if (m_flags != ValueFlags::Single && m_flags != ValueFlags::OptionalSingle)
        failCast();

    if (internal::isEnumType(m_type))
    {
        auto const* const number = payload<unsigned long>();
        return number ? boost::optional<long>(static_cast<long>(*number)) : boost::none;
    }
    meta::StandardTypes::ensureInitialized();
    if (m_type != meta::StandardTypes::integerMeta)
        failCast();
    auto const* const number = payload<int>();
    return number ? boost::optional<long>(*number) : boost::none;
}

ReflectiveDataType Value::toReflectiveDataType() const
{
    auto const fail = [] [[noreturn]] {
        reportException(CannotCastIncompatibleTypes(qualifiedName(meta::DataType::metaClass())));
    };
    meta::DataType const type = meta::DataType::cast(m_type);
    if (!type.getImpl())
        fail();
    if (m_reflective)
    {
        if (m_flags == ValueFlags::OptionalSingle)
            reportException(InvalidValue());
        auto const* const held = payload<ReflectiveDataType>();
        return held ? *held : ReflectiveDataType(type);
    }

    auto const* const serializer =
        meta::PropertySerializerRegistry::getInstance().getDatatypeSerializer(type);
    if (!serializer)
        fail();
    ReflectiveDataType result(type);
    for (auto const& [name, property] : type->getOwnedAttributes())
    {
        if (property)
            result.setPropertyValue(property, serializer->getPropertyValue(*this, property));
    }
    return result;
}

void Value::checkCompatibleWithProperty(meta::Property const& property) const
{
    if (!property)
        reportException(InvalidValue());
    meta::Type const type = property->getType();
    if (!type)
        reportException(InvalidValue());

    ValueFlags const flags = doGetFlags(property);
    bool const isClearedEnum = internal::isEnumType(type) && isAbsent() &&
                               flags == ValueFlags::OptionalSingle &&
                               m_flags == ValueFlags::OptionalSingle;
    auto const* const own = internal::classImpl(m_type);
    bool const isTypeSuitable =
        own && internal::classImpl(type) ? own->isA(type) : m_type == type || isClearedEnum;
    if (!isTypeSuitable)
        reportException(CannotCastIncompatibleTypes(qualifiedName(type)));

    bool const isGivenForOptional =
        flags == ValueFlags::OptionalSingle && m_flags == ValueFlags::Single;
    if (flags != m_flags && !isGivenForOptional)
        reportException(InvalidValue());
}

bool Value::isCompatibleWithProperty(meta::Property const& property) const
{
    try
    {
        checkCompatibleWithProperty(property);
    }
    catch (std::exception const&)
    {
        return false;
    }
    return true;
}

meta::Type const& Value::started(meta::Type const& type)
{
    meta::StandardTypes::ensureInitialized();
    return type;
}

meta::Type Value::typeOf(meta::Property const& property)
{
    TARNKILN_ASSERT(property.getElementImpl(), "only a property has values");
    meta::Type::Impl* const known = property->getTypeImpl();
    return known && !known->isProxy() ? meta::Type(known) : property->getType();
}

/// Apart from its template, so that it need not be compiled for each class of elements.
Value Value::createReference(meta::Property const& property, ModelElement const& element,
                             meta::Class const& required)
{
    meta::StandardTypes::ensureInitialized();
    Value result(typeOf(property), ValueFlags::Single, nullptr);
    result.storeElement(element, required);
    return result;
}

void Value::failCast() const
{
    reportException(CannotCastIncompatibleTypes(qualifiedName(m_type)));
}

void Value::storeElement(ModelElement const& element, meta::Class const& required)
{
    m_payload.store(element);
    checkElement(required);
}

void Value::checkElement(meta::Class const& required) const
{
    auto const* const own = internal::classImpl(m_type);
    if (m_flags > ValueFlags::Single || !own || !own->isLive())
        failCast();
    // Most classes of references that are asked about lie just below that of all elements.
    if (own->getSuperclassImpl() != required.getImpl() && !own->isA(required))
        failCast();
}

ModelElement const* Value::element() const
{
    return payload<ModelElement>();
}
}  // namespace tarn::kiln
