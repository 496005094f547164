/// \file
/// The relations that a query can ask for between two values.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

namespace tarn::kiln::query {

/// How the value found on an element relates to another one: found, relation, other.
///
/// Which of them exist depends on the type of the property and on whether it is required; see
/// `ValueComparatorRegistry`.
enum class ValueMatchRelation : int
{
    equal = 0,
    equalStringNocase = 1,
    notEqual = 2,
    greater = 3,
    greaterOrEqual = 4,
    less = 5,
    lessOrEqual = 6,
    like = 7,   ///< A pattern in which "%" stands for any text and "_" for one character.
    regexp = 8  ///< A regular expression.
};

/// The name of the enumerator; empty for any other number.
TARNKILN_EXPORT string ValueMatchRelationName(ValueMatchRelation relation);
}  // namespace tarn::kiln::query
