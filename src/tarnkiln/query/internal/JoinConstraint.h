/// \file
/// What must hold between the elements of two search instances.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/query/RetargetableQuery.h"

#include <cstddef>
#include <vector>

namespace tarn::kiln::internal {

using query::RetargetableQuery;
using query::ValueMatchRelation;

/// A constraint that ties two instances, which may be the same.
class TARNKILN_TESTED JoinConstraint
{
public:
    JoinConstraint(JoinConstraint const&) = delete;
    JoinConstraint& operator=(JoinConstraint const&) = delete;
    virtual ~JoinConstraint();

    /// The two instances, in the order in which they were given.
    virtual std::vector<std::size_t> getInstanceIds() const = 0;
    /// \param row  an element for each of `ids`, which are the same two instances in any order.
    virtual bool matches(std::vector<ModelElement> const& row,
                         std::vector<std::size_t> const& ids) const = 0;
    /// Adds the same constraint to `target`, between instances of the same numbers.
    virtual void retarget(RetargetableQuery& target) const = 0;

protected:
    JoinConstraint() = default;

    /// The element of the instance `id`.
    static ModelElement const& elementOf(std::size_t id, std::vector<ModelElement> const& row,
                                         std::vector<std::size_t> const& ids)
    {
        return ids[0] == id ? row[0] : row[1];
    }
};
}  // namespace tarn::kiln::internal
