/// \file
/// The shapes of values.
#pragma once
#include "tarnkiln/Export.h"

#include <iosfwd>

namespace tarn::kiln {

/// How many entries a value has and how they are reached. The numbers 4 and 6 are not used.
///
/// | Property | Shape |
/// |---|---|
/// | upper bound below 2, lower bound not 0 | `Single` |
/// | upper bound below 2, lower bound 0, typed by a class | `Single` |
/// | upper bound below 2, lower bound 0, typed otherwise | `OptionalSingle` |
/// | upper bound 2 or more, ordered, not qualified | `Sequence` |
/// | upper bound 2 or more, not ordered, not qualified | `Set` |
/// | upper bound 2 or more, qualified, unique keys | `Map` |
/// | upper bound 2 or more, qualified, other keys | `Multimap` |
enum class ValueFlags : unsigned int
{
    OptionalSingle = 0,  ///< One value or none.
    Single = 1,          ///< One value; no element is an empty handle.
    Sequence = 2,
    Set = 3,
    Map = 5,      ///< One entry under a key.
    Multimap = 7  ///< Any number of entries under a key.
};

/// Shows the name of a shape; the number of one that has none.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ValueFlags flags);
}  // namespace tarn::kiln
