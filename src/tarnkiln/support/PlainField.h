/// \file
/// Plain fields of elements as values, and back.
#pragma once
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/TypeImpl.h"

#include <boost/optional.hpp>

namespace tarn::kiln::support {

/// The values of a property whose field is a `T`.
template <class T> struct PlainField
{
    static Value toValue(meta::Property const& property, T const& field)
    {
        return Value::createPrimitiveValue(property, field);
    }
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type) if it is of another type.
    static T fromValue(Value const& value) { return value.getValue<T>(); }
};

/// Fails with `CannotCastIncompatibleTypes` unless `value` is of the enumeration `T`.
template <Literals T> void requireLiteralOf(Value const& value)
{
    meta::Type const& given = value.getType();
    if (given != meta::standardTypeOf<T>())
        reportException(tarnkiln::messages::CannotCastIncompatibleTypes(
            given ? given->getQualifiedName() : ustring()));
}

template <Literals T> struct PlainField<T>
{
    static Value toValue(meta::Property const& property, T const& field)
    {
        return Value::createPrimitiveValue(property, static_cast<long>(field));
    }
    static T fromValue(Value const& value)
    {
        requireLiteralOf<T>(value);
        return static_cast<T>(value.getValue<long>());
    }
};

/// A value that holds nothing may be of any type: empty values of enumerations are `Integer`s.
template <Literals T> struct PlainField<boost::optional<T>>
{
    static Value toValue(meta::Property const& property, boost::optional<T> const& field)
    {
        boost::optional<long> number;
        if (field)
            number = static_cast<long>(*field);
        return Value::createOptionalEnumValue(property, number);
    }
    static boost::optional<T> fromValue(Value const& value)
    {
        if (value.isAbsent())
            return boost::none;
        requireLiteralOf<T>(value);
        return static_cast<T>(*value.getEnumNumber());
    }
};
}  // namespace tarn::kiln::support
