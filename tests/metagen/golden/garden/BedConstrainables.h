// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Bed`.
#pragma once
#include "acme/garden/Bed.h"
#include "acme/garden/Plant.h"
#include "acme/garden/Size.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace acme::garden {

/// A search instance for a `Bed`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class Bed::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Bed;

    /// Adds an instance to a query: `Bed::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// What grows here, by name.
    query::ConstrainableReference<Plant> plants;
    query::ConstrainableValue<Size> size;
    query::ConstrainableReference<Bed> neighbours;
    query::ConstrainableValue<double> area;
};
}  // namespace acme::garden
