/// \file
/// What a native query consists of.
#pragma once
#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/query/internal/JoinConstraint.h"
#include "tarnkiln/query/internal/SingleObjectConstraint.h"

#include <boost/container_hash/hash.hpp>

#include <algorithm>
#include <cstddef>
#include <memory>
#include <unordered_map>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {

/// A class to search, and what must hold for each of its elements.
struct SearchInstance
{
    SearchInstance(meta::Class const& metaClass, SearchClassMatchMode match)
        : searchClass(metaClass),
          mode(match)
    {
        constraints.push_back(std::make_unique<IsAConstraint>(searchClass, mode));
    }
    SearchInstance(SearchInstance const&) = delete;
    SearchInstance& operator=(SearchInstance const&) = delete;

    meta::Class const searchClass;
    SearchClassMatchMode const mode;
    /// The first is the `IsAConstraint`, the others stand in the order in which they were added.
    std::vector<std::unique_ptr<SingleObjectConstraint>> constraints;
};

struct InstanceIdsHash
{
    std::size_t operator()(std::vector<std::size_t> const& ids) const
    {
        std::size_t hash = 0;
        for (std::size_t const id : ids)
            boost::hash_combine(hash, id);
        return hash;
    }
};

/// The join constraints by the sorted numbers of their instances.
///
/// The order of rows follows the order in which this table is walked, so neither the container nor
/// its hash may be changed.
using JoinMap = std::unordered_map<std::vector<std::size_t>,
                                   std::vector<std::unique_ptr<JoinConstraint>>, InstanceIdsHash>;

struct NativeQueryState
{
    /// The caller's own numbers are trusted.
    void checkInstance([[maybe_unused]] std::size_t id) const
    {
        TARNKILN_ASSERT(id < instances.size(), "there is such a search instance", id);
    }
    void fileJoin(std::unique_ptr<JoinConstraint> constraint)
    {
        std::vector<std::size_t> ids = constraint->getInstanceIds();
        std::sort(ids.begin(), ids.end());
        joins[std::move(ids)].push_back(std::move(constraint));
    }

    Model model;
    std::vector<std::unique_ptr<SearchInstance>> instances;
    JoinMap joins;
    std::size_t limit = 0;  ///< 0 for none.
    std::size_t offset = 0;
};
}  // namespace tarn::kiln::internal
