// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `Enum`.
#pragma once
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/PrimitiveType.h"
#include "tarnkiln/meta/TypeConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `Enum`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Enum::Constrainables : public Type::Constrainables
{
public:
    using Handle = Enum;

    /// Adds an instance to a query: `Enum::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The literals, by name.
    query::ConstrainableReference<EnumLiteral> literals;

    /// The type of the literals' values.
    query::ConstrainableReference<PrimitiveType> underlyingType;
};
}  // namespace tarn::kiln::meta
