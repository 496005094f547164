/// \file
/// How the values of one type become text and values again.
///
///     meta::PropertySerializer* const serializer =
///         meta::PropertySerializerRegistry::getInstance().getPropertySerializer(type, "");
///     ustring const text = serializer->serializeValue(value);
///     Value const same = serializer->parseValue(text, type);
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional.hpp>

#include <vector>

namespace tarn::kiln::meta {

/// One text form of the values of a primitive type or an enumeration.
///
/// A text that is none raises `std::bad_cast` or a class derived from it. A value of another type
/// raises `tarnkiln::messages::CannotCastIncompatibleTypes` (qualified name of the value's type).
///
/// Threads: has no state; one object may be used on all threads at once.
class TARNKILN_EXPORT PropertySerializer
{
public:
    PropertySerializer() = default;
    PropertySerializer(PropertySerializer const&) = delete;
    PropertySerializer& operator=(PropertySerializer const&) = delete;
    virtual ~PropertySerializer();

    /// The text of an optional value; none, unless a derived class gives one.
    virtual boost::optional<ustring> serializeOptionalValue(Value const& value) const;
    /// A copy of `value`, unless a derived class gives it another form.
    virtual Value toOptionalValue(Value const& value) const;
    /// \param value  `Single`; without payload it stands for the default of its C++ type.
    virtual ustring serializeValue(Value const& value) const = 0;
    /// A `Single` value of `type`.
    virtual Value parseValue(ustring const& text, Type const& type) const = 0;
    /// The same for an optional property; calls `parseValue`.
    virtual Value parseOptionalValue(ustring const& text, Type const& type) const;
    /// An `OptionalSingle` value without payload.
    virtual Value createEmptyOptionalValue(Type const& type) const = 0;
    /// The `Single` value that a required property of `type` starts with.
    virtual Value createDefaultValue(Type const& type) const = 0;
    /// Takes back a value that `parseValue` made, when it is no longer needed. Does nothing here.
    virtual void releaseValue(Value&& value, Type const& type) const;
    /// An unmanaged `Sequence` with the payloads of `values`, which are `Single` values.
    ///
    /// \throws tarnkiln::messages::InvalidValue  unless a derived class knows how.
    virtual Value combineAsUnmanagedSequenceValue(Type const& type,
                                                  std::vector<Value> const& values) const;
    /// An unmanaged `Set`; fails likewise.
    virtual Value combineAsUnmanagedSetValue(Type const& type,
                                             std::vector<Value> const& values) const;
};
}  // namespace tarn::kiln::meta
