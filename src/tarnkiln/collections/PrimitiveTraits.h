/// \file
/// How the entries of primitive collections travel in a `Value`.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::internal {

/// Entries of the type `T` as values. Defined for the types of `PrimitiveInstantiations.h`; the
/// enumerations of a client specialise it.
template <class T> struct TARNKILN_EXPORT PrimitiveTraits
{
    /// The standard type; empty while the registry is not there.
    static meta::Type type();
    static Value toValue(T const& entry, meta::Type const& type);
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `value` is of another type.
    static T fromValue(Value const& value);
};

/// The type of `property`; empty if there is none.
TARNKILN_EXPORT meta::Type entryTypeOf(meta::Property const& property);
}  // namespace tarn::kiln::internal
