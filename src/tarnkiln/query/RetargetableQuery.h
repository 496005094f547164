/// \file
/// A query that can be asked of another model.
#pragma once
#include "tarnkiln/query/ReflectiveQuery.h"

namespace tarn::kiln::query {

/// A query that knows its model and can be copied.
///
/// Threads: as `ReflectiveQuery`.
class TARNKILN_EXPORT RetargetableQuery : public ReflectiveQuery
{
public:
    ~RetargetableQuery() override;

    /// Asks `model` from now on; the query shares it.
    virtual void setModel(Model const& model) = 0;
    /// Makes `target` an equal query, with limit and offset, on `target`'s own model.
    ///
    /// Its rows are the same on an equal model, though their order may differ if more than one pair
    /// of instances is tied together.
    /// \throws tarnkiln::query::InvalidSearchClass  if a class was destroyed meanwhile.
    virtual void retargetTo(RetargetableQuery& target) const = 0;
    /// Empty while none is set.
    virtual Model getModel() const = 0;
};
}  // namespace tarn::kiln::query
