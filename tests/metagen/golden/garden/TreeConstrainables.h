// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Tree`.
#pragma once
#include "acme/garden/PlantConstrainables.h"
#include "acme/garden/Tree.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <boost/date_time/posix_time/ptime.hpp>

#include <utility>

namespace acme::garden {

/// A search instance for a `Tree`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class Tree::Constrainables : public Plant::Constrainables
{
public:
    using Handle = Tree;

    /// Adds an instance to a query: `Tree::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    query::ConstrainableValue<boost::posix_time::ptime> planted;
    query::ConstrainableReference<Tree> graft;
    query::ConstrainableReference<Tree> stock;
};
}  // namespace acme::garden
