/// \file
/// How the entries of primitive collections travel in a `Value`.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::support {

/// Entries of the type `T` as values. The enumerations of a client specialise it.
template <class T> struct PrimitiveTraits
{
    /// The type of the entries of a collection. Starts the registry.
    static meta::Type const& type() { return meta::standardTypeOf<T>(); }
    static Value toValue(T const& entry, meta::Type const& type) { return Value(type, entry); }
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `value` is of another type.
    static T fromValue(Value const& value) { return value.getValue<T>(); }
};
}  // namespace tarn::kiln::support
