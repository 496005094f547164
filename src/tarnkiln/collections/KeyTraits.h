/// \file
/// How the keys of keyed collections travel in a `Value`.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/KeyTypes.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::support {

/// Keys of the type `K` as values. Defined for the types of `KeyTypes.h`; a further one needs
/// a specialisation.
template <class K> struct TARNKILN_EXPORT KeyTraits
{
    /// An enumeration value is a key of type `unsigned long`.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `value` is of another type.
    static K fromValue(Value const& value);
    /// \param keyType  the type of the qualifying property. The values of an enumeration are its
    ///     literals; those of a class are UUIDs; without a type the value has the type of `K`.
    static Value toValue(K const& key, meta::Type const& keyType);
    /// The type of the keys where the qualifying property is not known: `String` for a `ustring`,
    /// empty for the others.
    static meta::Type fallbackType();
};

/// The type of the property that qualifies `collectionProperty`; empty if that is not known.
TARNKILN_EXPORT meta::Type qualifierTypeOf(meta::Property const& collectionProperty);

#define TARNKILN_DECLARE(K) extern template struct TARNKILN_EXPORT KeyTraits<K>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln::support
