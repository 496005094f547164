/// \file
/// An order of values that places every one of them.
#pragma once
#include "tarnkiln/Export.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <cmath>
#include <functional>

namespace tarn::kiln::support {

/// `std::less`, but total where that is not: all NaNs are one value behind all others, and "not a
/// date-time" is one value before all others.
template <class T> struct TARNKILN_EXPORT TotalLess : std::less<T>
{};

template <> struct TARNKILN_EXPORT TotalLess<double>
{
    bool operator()(double left, double right) const
    {
        return std::isnan(right) ? !std::isnan(left) : left < right;
    }
};

template <> struct TARNKILN_EXPORT TotalLess<boost::posix_time::ptime>
{
    bool operator()(boost::posix_time::ptime const& left,
                    boost::posix_time::ptime const& right) const
    {
        if (left.is_not_a_date_time() || right.is_not_a_date_time())
            return left.is_not_a_date_time() && !right.is_not_a_date_time();
        return left < right;
    }
};
}  // namespace tarn::kiln::support
