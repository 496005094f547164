/// \file
/// An engine that does what a query says, word by word; the measure of the library's own.
#pragma once
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/NativeResultSet.h"

namespace testkit {

/// Runs `query`, which must have an instance and a live model.
///
/// One scan of the model gives the candidates of each instance; then each group of join constraints
/// tries all combinations of the rows that it ties together, and what is left over is combined in
/// all ways. So a join costs the product of its rows. The rows, their order and the failures are
/// what the library's engine is measured by.
///
/// \param columns  the instances to give, in that order; empty for all.
tarn::kiln::internal::NativeResultSet
runPlainly(tarn::kiln::internal::NativeQueryState const& query,
           std::vector<std::size_t> const& columns);
}  // namespace testkit
