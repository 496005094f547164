/// \file
/// Values of data types as keys of keyed collections.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/KeyTraits.h"
#include "tarnkiln/meta/ReflectiveDataType.h"

namespace tarn::kiln {

/// The value of `qualifier`, a property with a data type, on `element`.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the type) if there
///     is none.
TARNKILN_EXPORT ReflectiveDataType dataTypeKeyOf(ModelElement::Impl* element,
                                                 meta::Property const& qualifier);

namespace support {

/// The keys are ordered by `ReflectiveDataType::compareWith`.
template <> struct TARNKILN_EXPORT KeyTraits<ReflectiveDataType>
{
    static ReflectiveDataType fromValue(Value const& value);
    static Value toValue(ReflectiveDataType const& key, meta::Type const& keyType);
    static meta::Type fallbackType();
};
}  // namespace support
}  // namespace tarn::kiln
