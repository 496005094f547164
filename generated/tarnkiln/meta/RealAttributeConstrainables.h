// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `RealAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeConstrainables.h"
#include "tarnkiln/meta/RealAttribute.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `RealAttribute`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT RealAttribute::Constrainables : public Attribute::Constrainables
{
public:
    using Handle = RealAttribute;

    /// Adds an instance to a query: `RealAttribute::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The value.
    query::ConstrainableValue<double> value;
};
}  // namespace tarn::kiln::meta
