/// \file
/// How the values of a data type are taken apart and put together.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional.hpp>

#include <vector>

namespace tarn::kiln::meta {

/// Gives access to the fields of the values of one data type.
///
/// A value of another type raises `tarnkiln::messages::CannotCastIncompatibleTypes` (qualified name
/// of the value's type), a property of another type `tarnkiln::messages::NoSuchProperty` (name,
/// qualified name of the data type).
///
/// Threads: has no state; one object may be used on all threads at once.
class TARNKILN_EXPORT DatatypeSerializer
{
public:
    DatatypeSerializer() = default;
    DatatypeSerializer(DatatypeSerializer const&) = delete;
    DatatypeSerializer& operator=(DatatypeSerializer const&) = delete;
    virtual ~DatatypeSerializer();

    /// The required form of an optional value; none, unless a derived class gives one.
    virtual boost::optional<Value> fromOptionalValue(Value const& value) const;
    /// A copy of `value`, unless a derived class gives it another form.
    virtual Value toOptionalValue(Value const& value) const;
    virtual Value getPropertyValue(Value const& value, Property const& property) const = 0;
    /// A copy of `value` with another `field`: the values of data types are immutable.
    virtual Value setPropertyValue(Value const& value, Property const& property,
                                   Value const& field) const = 0;
    /// An `OptionalSingle` value without payload.
    virtual Value createEmptyOptionalValue() const = 0;
    virtual Value createDefaultValue() const = 0;
    /// An unmanaged `Sequence` with the payloads of `values`, which are `Single` values.
    virtual Value combineAsUnmanagedSequenceValue(Type const& type,
                                                  std::vector<Value> const& values) const = 0;
    virtual Value combineAsUnmanagedSetValue(Type const& type,
                                             std::vector<Value> const& values) const = 0;
};
}  // namespace tarn::kiln::meta
