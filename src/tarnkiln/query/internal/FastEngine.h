/// \file
/// The engine that users get: the rows of the plain one, without its cost.
#pragma once
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/NativeResultSet.h"

#include <cstddef>

namespace tarn::kiln::internal {

/// Runs `query`, which must have an instance and a live model.
///
/// Gives the rows of `runPlainly`, in its order, and fails with what that fails with. Values are
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
