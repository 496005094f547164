// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Plant`.
#pragma once
#include "acme/garden/Bed.h"
#include "acme/garden/Plant.h"
#include "acme/garden/Season.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace acme::garden {

/// A search instance for a `Plant`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class Plant::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Plant;

    /// Adds an instance to a query: `Plant::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// What the bed knows it by.
    query::ConstrainableValue<ustring, true> name;
    query::ConstrainableReference<Bed> bed;
    query::ConstrainableValue<Season> sown;

    /// In centimetres.
    query::ConstrainableValue<int> height;
    query::ConstrainableValue<bool> isHardy;
    query::ConstrainableValue<ustring> notes;
};
}  // namespace acme::garden
