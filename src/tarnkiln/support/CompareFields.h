/// \file
/// The order of data type values, field by field.
#pragma once
#include "tarnkiln/collections/TotalLess.h"

#include <boost/optional.hpp>

namespace tarn::kiln::support {

/// Negative, 0 or positive. Every value has its place, NaN behind all numbers.
template <class T> int compareFields(T const& left, T const& right)
{
    TotalLess<T> const less;
    return less(left, right) ? -1 : less(right, left) ? 1 : 0;
}

/// What is absent comes first.
template <class T>
int compareFields(boost::optional<T> const& left, boost::optional<T> const& right)
{
    if (left && right)
        return compareFields(*left, *right);
    return (left ? 1 : 0) - (right ? 1 : 0);
}
}  // namespace tarn::kiln::support
