/// \file
/// The rows that a group of join constraints leaves over.
#pragma once
#include "tarnkiln/query/internal/JoinConstraint.h"
#include "tarnkiln/query/internal/PairTest.h"
#include "tarnkiln/query/internal/PartialRows.h"

#include <memory>
#include <vector>

namespace tarn::kiln::internal {

using JoinConstraints = std::vector<std::unique_ptr<JoinConstraint>>;

/// The combinations of a row of `first`, which counts fastest, and one of `second` that hold the
/// constraints between two instances; their elements are in `first` and in `second`, in this order.
///
/// The first constraint finds the pairs if it can, the others are asked for these only.
PartialRows joinRows(PartialRows const& first, PartialRows const& second,
                     std::vector<std::size_t> const& ids, JoinConstraints const& constraints,
                     JoinContext const& context);

/// The rows that hold constraints between two of their own columns.
PartialRows filterRows(PartialRows const& rows, std::vector<std::size_t> const& ids,
                       JoinConstraints const& constraints, JoinContext const& context);
}  // namespace tarn::kiln::internal
