/// \file
/// An order of values whose type is known at run time only.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

namespace tarn::kiln::internal {

/// Negative, 0 or positive; 0 for equal values, and for two NaNs.
///
/// Absent payloads come first. Payloads of one kind are ordered as `ReflectiveDataType` says. What
/// that leaves open, as for different shapes of one payload, is decided by shape and type. Managed
/// collections are ordered by address.
TARNKILN_TESTED int compareValues(Value const& left, Value const& right);
}  // namespace tarn::kiln::internal
