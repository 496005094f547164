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
        return value.m_deleter == genericDeleter<T> ? static_cast<T const*>(value.m_data) : nullptr;
    }
    static void const* address(Value const& value) { return value.m_data; }
};
}  // namespace tarn::kiln::support
