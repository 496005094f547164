/// \file
/// How payloads of a type are made and read.
#pragma once
#include "tarnkiln/kernel/Value.h"

#include <new>
#include <type_traits>
#include <utility>

namespace tarn::kiln::support {

/// What a `ValuePayload` does with a `T`.
template <class T> struct PayloadOf
{
    static constexpr bool IN_PLACE = sizeof(T) <= ValuePayload::ROOM &&
                                     alignof(T) <= alignof(void*) &&
                                     std::is_nothrow_move_constructible_v<T>;

    static void destroy(void* payload)
    {
        if constexpr (IN_PLACE)
            static_cast<T*>(payload)->~T();
        else
            delete static_cast<T*>(payload);
    }
    static void* copy(void const* payload, void* place)
    {
        return make(*static_cast<T const*>(payload), place);
    }
    /// In `place`, or on the heap; returns where.
    static T* make(T const& object, void* place)
    {
        if constexpr (IN_PLACE)
            return new (place) T(object);
        else
            return new T(object);
    }
    static void relocate(void* from, void* to) noexcept
    {
        if constexpr (IN_PLACE)
        {
            new (to) T(std::move(*static_cast<T*>(from)));
            static_cast<T*>(from)->~T();
        }
    }
    static bool equals(void const* left, void const* right)
    {
        return *static_cast<T const*>(left) == *static_cast<T const*>(right);
    }

    static constexpr ValuePayload::Functions FUNCTIONS{
        IN_PLACE && std::is_trivially_copyable_v<T> && std::is_trivially_destructible_v<T>, destroy,
        copy, relocate, equals};
};
}  // namespace tarn::kiln::support

namespace tarn::kiln {

template <class T> bool ValuePayload::isOf() const
{
    return m_functions == &support::PayloadOf<T>::FUNCTIONS;
}

template <class T> void ValuePayload::setType()
{
    m_functions = &support::PayloadOf<T>::FUNCTIONS;
}

template <class T> void ValuePayload::store(T const& object)
{
    m_data = support::PayloadOf<T>::make(object, m_place);
    setType<T>();
}

template <class T> T const* Value::payload() const
{
    // Type and shape can be right and the payload be, say, a managed collection that was declared
    // unmanaged.
    if (m_payload.address() && !m_payload.isOf<T>())
        failCast();
    return static_cast<T const*>(m_payload.address());
}
}  // namespace tarn::kiln
