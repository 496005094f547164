/// \file
/// The query that typed search instances are added to.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/query/Fwd.h"

#include <memory>

namespace tarn::kiln::query {

/// Owns a query that the library's engine runs.
///
/// A `Constrainables` that is made on it adds a search instance; classes of clients derive from it
/// and offer their rows.
///
/// Threads: used by one at a time.
class TARNKILN_EXPORT AbstractQuery
{
public:
    /// A query without a model.
    AbstractQuery();
    explicit AbstractQuery(Model const& model);
    AbstractQuery(AbstractQuery const&) = delete;
    AbstractQuery& operator=(AbstractQuery const&) = delete;
    virtual ~AbstractQuery();

    /// The query behind it, by which it is built, given a model and run.
    RetargetableQuery& getReflectiveQuery() const { return *m_query; }

    /// The number of rows at most; 0 for all.
    void setResultLimit(unsigned long limit);
    /// The number of rows to leave out first.
    void setResultOffset(unsigned long offset);

    /// The rows as tuples of handles, one for each search instance given:
    /// `for (auto const& [book, reader] : query.results(books, readers))`; needs `Results.h`.
    template <class... Instance>
    Results<typename Instance::Handle...> results(Instance const&... columns);

private:
    std::unique_ptr<RetargetableQuery> const m_query;
};
}  // namespace tarn::kiln::query
