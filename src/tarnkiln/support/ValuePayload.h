/// \file
/// What a `Value` does with a payload of its own.
#pragma once
#include "tarnkiln/kernel/Value.h"

namespace tarn::kiln::support {

template <class T> void genericDeleter(void* payload)
{
    delete static_cast<T*>(payload);
}

/// A copy; null of null.
template <class T> void* genericCloner(void* payload)
{
    return payload ? new T(*static_cast<T const*>(payload)) : nullptr;
}

/// Null equals nothing but null.
template <class T> bool genericComparator(void* left, void* right)
{
    if (!left || !right)
        return left == right;
    return *static_cast<T const*>(left) == *static_cast<T const*>(right);
}
}  // namespace tarn::kiln::support

namespace tarn::kiln {

template <class T> void Value::setPayload(T* payload)
{
    m_data = payload;
    m_deleter = support::genericDeleter<T>;
    m_cloner = support::genericCloner<T>;
    m_comparator = support::genericComparator<T>;
}

template <class T> T const* Value::payload() const
{
    // The deleter tells what the payload is: type and shape can be right and the payload be, say,
    // a managed collection that was declared unmanaged.
    if (m_data && m_deleter != support::genericDeleter<T>)
        failCast();
    return static_cast<T const*>(m_data);
}
}  // namespace tarn::kiln
