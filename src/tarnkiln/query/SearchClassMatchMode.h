/// \file
/// Which elements are of the class that a query searches.
#pragma once

namespace tarn::kiln::query {

/// Any number but 0 counts as `MatchSubclasses`.
enum class SearchClassMatchMode : int
{
    MatchExactClass = 0,  ///< Those whose metaclass is the class.
    MatchSubclasses = 1   ///< Also those of classes that extend it.
};
}  // namespace tarn::kiln::query
