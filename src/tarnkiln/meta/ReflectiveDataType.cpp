#include "tarnkiln/meta/ReflectiveDataType.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/internal/compareValues.h"

#include <exception>

namespace tarn::kiln {

using internal::qualifiedName;
using tarnkiln::messages::CannotCastIncompatibleTypes;

namespace {

/// An unmanaged collection without entries, made by the serializer of the entries' type.
template <class Serializer>
Value combineNothing(Serializer const* serializer, meta::Property const& property)
{
    meta::Type const type = property->getType();
    ValueFlags const shape = ValueMeta::doGetFlags(property);
    try
    {
        if (serializer && shape == ValueFlags::Sequence)
            return serializer->combineAsUnmanagedSequenceValue(type, {});
        if (serializer && shape == ValueFlags::Set)
            return serializer->combineAsUnmanagedSetValue(type, {});
    }
    catch (tarnkiln::messages::InvalidValue const&)
    {
        // The serializer makes no collections.
    }
    reportException(CannotCastIncompatibleTypes(qualifiedName(type)));
}

Value createEmptyCollection(meta::Property const& property)
{
    auto const& registry = meta::PropertySerializerRegistry::getInstance();
    meta::Type const type = property->getType();
    if (meta::DataType const dataType = meta::DataType::cast(type))
        return combineNothing(registry.getDatatypeSerializer(dataType), property);
    return combineNothing(registry.getPropertySerializer(type, ""), property);
}
}  // namespace

ReflectiveDataType::ReflectiveDataType(meta::DataType const& type) : m_type(type)
{
    if (!type)
        reportException(tarnkiln::messages::NoSuchType(qualifiedName(type)));
}

Value ReflectiveDataType::getPropertyValue(meta::Property const& property) const
{
    checkOwned(property);
    if (!property->getType())
        reportException(tarnkiln::messages::CannotUsePropertyWithoutType(property->getName()));
    auto const place = m_fields.find(property);
    if (place != m_fields.end())
    {
        if (place->second.isCompatibleWithProperty(property))
            return place->second;
        m_fields.erase(place);
    }
    return m_fields.emplace(property, getDefaultValue(property)).first->second;
}

void ReflectiveDataType::setPropertyValue(meta::Property const& property, Value const& value)
{
    checkOwned(property);
    meta::Type const type = property->getType();
    bool const isClearedEnum = internal::isEnumType(type) && property->getLower() == 0 &&
                               value.getFlags() == ValueFlags::OptionalSingle && value.isAbsent();
    if (value.getType() != type && !isClearedEnum)
        reportException(CannotCastIncompatibleTypes(qualifiedName(type)));
    // Not by assignment, which leaves behind what reads the entries of the former collection.
    Value copy = value;
    m_fields.erase(property);
    m_fields.emplace(property, std::move(copy));
}

Value ReflectiveDataType::getDefaultValue(meta::Property const& property) const
{
    if (property->getUpper() >= 2)
        return createEmptyCollection(property);
    if (meta::DataType const dataType = meta::DataType::cast(property->getType()))
        return Value::createReflectiveDataTypeValue(dataType, property->getLower() != 0);
    boost::optional<Value> const declared = property->defaultValue();
    return declared ? *declared : Value::createEmptyValue(property);
}

boost::optional<Value> ReflectiveDataType::toNonReflectiveDataTypeValue() const
{
    meta::DatatypeSerializer const* const serializer =
        meta::PropertySerializerRegistry::getInstance().getDatatypeSerializer(m_type);
    if (!serializer)
        return boost::none;
    Value result = serializer->createDefaultValue();
    for (auto const& [property, value] : m_fields)
        result = serializer->setPropertyValue(result, property, value);
    return result;
}

int ReflectiveDataType::compareWith(ReflectiveDataType const& other) const
{
    if (m_type != other.m_type)
        reportException(CannotCastIncompatibleTypes(qualifiedName(other.m_type)));
    for (auto const& [name, property] : m_type->getOwnedAttributes())
    {
        if (!property || !property->getType())
            continue;
        int const difference =
            internal::compareValues(getPropertyValue(property), other.getPropertyValue(property));
        if (difference != 0)
            return difference;
    }
    return 0;
}

bool ReflectiveDataType::operator==(ReflectiveDataType const& other) const
{
    return m_type == other.m_type && compareWith(other) == 0;
}

void ReflectiveDataType::checkOwned(meta::Property const& property) const
{
    if (property && property->getOwningType() == m_type)
        return;
    ustring const name = property.getImpl() ? property->getName() : ustring();
    reportException(tarnkiln::messages::NoSuchProperty(name, qualifiedName(m_type)));
}
}  // namespace tarn::kiln
