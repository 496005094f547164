/// \file
/// One field of a C++ class that stands for a data type, as a value.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/support/CarriedValue.h"

#include <boost/optional.hpp>

#include <type_traits>
#include <utility>

namespace tarn::kiln::support {

/// A value in the C++ class of its data type, if it comes without one and there is one.
inline Value toCxxForm(Value const& value)
{
    if (!value.isReflective() || value.isAbsent())
        return value;
    boost::optional<Value> const converted =
        value.toReflectiveDataType().toNonReflectiveDataTypeValue();
    return converted ? *converted : value;
}

/// How a field of the type `T` travels.
template <class T> struct DatatypeFieldValue
{
    static Value make(meta::Property const& property, T const& field)
    {
        return CarriedValue<T>::make(property->getType(), field);
    }
    static T read(meta::Property const& property, Value const& value)
    {
        return CarriedValue<T>::read(toCxxForm(value), property->getType());
    }
};

/// An enumeration travels as the number of a literal.
template <class T> struct DatatypeFieldValue<boost::optional<T>>
{
    static constexpr bool IS_LITERAL = std::is_enum_v<T>;

    static Value make(meta::Property const& property, boost::optional<T> const& field)
    {
        if constexpr (IS_LITERAL)
            return Value::createOptionalEnumValue(
                property, field ? boost::optional<long>(static_cast<long>(*field)) : boost::none);
        else
            return Value::createPrimitiveValue(property, field);
    }
    static boost::optional<T> read(meta::Property const&, Value const& value)
    {
        if constexpr (IS_LITERAL)
        {
            boost::optional<long> const number = value.getEnumNumber();
            return number ? boost::optional<T>(static_cast<T>(*number)) : boost::none;
        }
        else
            return toCxxForm(value).template getValue<boost::optional<T>>();
    }
};

/// The field of an `Object` that has the two functions.
template <class Object, auto GETTER, auto SETTER> struct DatatypeField
{
    using Type = std::remove_cvref_t<decltype((std::declval<Object const&>().*GETTER)())>;

    static Value read(Object const& object, meta::Property const& property)
    {
        return DatatypeFieldValue<Type>::make(property, (object.*GETTER)());
    }
    static void write(Object& object, meta::Property const& property, Value const& field)
    {
        (object.*SETTER)(DatatypeFieldValue<Type>::read(property, field));
    }
};
}  // namespace tarn::kiln::support
