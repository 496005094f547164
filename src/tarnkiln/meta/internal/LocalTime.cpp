#include "tarnkiln/meta/internal/LocalTime.h"

#include <boost/date_time/posix_time/conversion.hpp>
#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <stdexcept>

namespace tarn::kiln::internal {

boost::posix_time::ptime toLocalTime(std::time_t time)
{
    std::tm fields = {};
    if (!localtime_r(&time, &fields))
        throw std::runtime_error("could not convert calendar time to local time");
    return boost::posix_time::ptime_from_tm(fields);
}
}  // namespace tarn::kiln::internal
