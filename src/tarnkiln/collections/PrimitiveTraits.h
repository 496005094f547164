/// \file
/// How the entries of primitive collections travel in a `Value`.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/PlainField.h"

namespace tarn::kiln::support {

/// Entries of the type `T` as values.
template <class T> struct PrimitiveTraits
{
    /// The type of the entries of a collection. Starts the registry.
    static meta::Type const& type() { return meta::standardTypeOf<T>(); }
    static Value toValue(T const& entry, meta::Type const& type) { return Value(type, entry); }
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `value` is of another type.
    static T fromValue(Value const& value) { return value.getValue<T>(); }
};

/// The literals of a metamodel's enumeration travel by their numbers.
template <Literals T> struct PrimitiveTraits<T>
{
    static meta::Type const& type() { return meta::standardTypeOf<T>(); }
    static Value toValue(T entry, meta::Type const& type)
    {
        return Value(type, static_cast<long>(entry));
    }
    static T fromValue(Value const& value) { return PlainField<T>::fromValue(value); }
};
}  // namespace tarn::kiln::support
