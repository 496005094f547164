/// \file
/// A look at the payload of a value, whatever its type.
#pragma once
#include "tarnkiln/support/ValuePayload.h"

#include <cstdint>

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
    /// The payload as the first bytes of a word, if `payload` are its functions and the value has
    /// one; lies in the value.
    static void const* ofKind(Value const& value, ValuePayload::Functions const& payload)
    {
        return value.m_payload.isOf(payload) ? value.m_payload.address() : nullptr;
    }
    /// A value whose payload is what the first bytes of `word` are. Not checked.
    static Value makeOfWord(meta::Type const& type, ValueFlags flags,
                            ValuePayload::Functions const& payload, std::uint64_t word)
    {
        Value value(type, flags, nullptr);
        value.m_payload.storeBytes(payload, &word, sizeof word);
        return value;
    }
    /// A reference to an element. Not checked.
    static Value makeOfElement(meta::Type const& type, ModelElement const& element)
    {
        Value value(type, ValueFlags::Single, nullptr);
        value.m_payload.store(element);
        return value;
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
