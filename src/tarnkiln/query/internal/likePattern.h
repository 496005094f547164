/// \file
/// Patterns with "%" and "_" as regular expressions.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"

namespace tarn::kiln::internal {

/// The regular expression of a pattern: characters with a meaning there are escaped, "_" becomes
/// "." and "%" becomes ".*". No anchors are added.
TARNKILN_TESTED string likeToRegex(string pattern);

/// The same for the value that `property` is compared with; of the property's type.
///
/// \throws tarnkiln::query::LikePatternNotSingle  if `pattern` has another shape.
/// \throws tarnkiln::query::LikePatternNotString  if the property is neither `String` nor
///     `StdString`.
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the pattern's type)
///     if the pattern is of another type than the property.
Value likePattern(meta::Property const& property, Value const& pattern);
}  // namespace tarn::kiln::internal
