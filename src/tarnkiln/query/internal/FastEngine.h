/// \file
/// How the rows of a query are found.
#pragma once
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/NativeResultSet.h"

#include <cstddef>

namespace tarn::kiln::internal {

/// Runs `query`, which must have an instance and a live model.
///
/// Gives the rows that a scan of all elements and then a trial of all combinations would give, in
/// that order, and fails with what that would fail with; the tests have such an engine. Values are
/// compared where they lie, references are followed, and equal values are found by their hash, so
/// that a join costs its rows. What has to be read through virtual functions is read once for each
/// element.
///
/// \param most  how many rows will do; 0 for all.
NativeResultSet runFast(NativeQueryState const& query, std::vector<std::size_t> const& columns,
                        std::size_t most);

/// How many rows `runFast` would give.
std::size_t countFast(NativeQueryState const& query);
}  // namespace tarn::kiln::internal
