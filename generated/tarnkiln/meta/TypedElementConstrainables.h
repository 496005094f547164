// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `TypedElement`.
#pragma once
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/meta/TypedElement.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <cstdint>
#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `TypedElement`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT TypedElement::Constrainables : public NamedElement::Constrainables
{
public:
    using Handle = TypedElement;

    /// Adds an instance to a query: `TypedElement::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The type of the value.
    query::ConstrainableReference<Type> type;

    /// The least number of values.
    query::ConstrainableValue<std::uint32_t> lower;

    /// The greatest number of values; 0xFFFFFFFF means unbounded.
    query::ConstrainableValue<std::uint32_t> upper;

    /// Whether the values have positions.
    query::ConstrainableValue<bool> isOrdered;
};
}  // namespace tarn::kiln::meta
