// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `PrimitiveType`.
#pragma once
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/TypeConstrainables.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `PrimitiveType`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT PrimitiveType::Constrainables : public Type::Constrainables
{
public:
    using Handle = PrimitiveType;

    /// Adds an instance to a query: `PrimitiveType::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);
};
}  // namespace tarn::kiln::meta
