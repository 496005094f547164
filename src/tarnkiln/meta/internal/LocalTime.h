/// \file
/// Calendar times on the clock of this place.
#pragma once
#include "tarnkiln/Export.h"

#include <boost/date_time/posix_time/ptime.hpp>

#include <ctime>

namespace tarn::kiln::internal {

/// \throws std::runtime_error  if the year does not fit.
TARNKILN_TESTED boost::posix_time::ptime toLocalTime(std::time_t time);
}  // namespace tarn::kiln::internal
