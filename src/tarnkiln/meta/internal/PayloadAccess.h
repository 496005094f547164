/// \file
/// A look at the payload of a value, whatever its type.
#pragma once
#include "tarnkiln/support/ValuePayload.h"

namespace tarn::kiln::support {

/// What the holder of a value of unknown type can tell of it.
struct PayloadAccess
{
    /// Null if there is no payload, or one of another C++ type.
    template <class T> static T const* get(Value const& value)
    {
        return value.m_payload.isOf<T>() ? static_cast<T const*>(value.m_payload.address())
                                         : nullptr;
    }
    static void const* address(Value const& value) { return value.m_payload.address(); }
    /// The collection of an element that the value shares; null if it holds something of its own.
    static AbstractOwnedCollection const* managed(Value const& value)
    {
        return value.m_payload.isOwned()
                   ? nullptr
                   : static_cast<AbstractOwnedCollection*>(value.m_payload.address());
    }
    /// The same payload, as a required value.
    static Value asSingle(Value const& value)
    {
        Value result(value);
        result.m_flags = ValueFlags::Single;
        return result;
    }
};
}  // namespace tarn::kiln::support
