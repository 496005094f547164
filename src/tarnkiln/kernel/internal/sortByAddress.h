/// \file
/// The order in which elements lie in memory.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

#include <vector>

namespace tarn::kiln::internal {

/// Sorts the pointers, without a look at the elements, in a time that grows with their number only.
void sortByAddress(std::vector<ModelElement::Impl*>& elements);
}  // namespace tarn::kiln::internal
