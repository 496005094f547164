// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `Argument`.
#pragma once
#include "tarnkiln/meta/Argument.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/TypedElementConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `Argument`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Argument::Constrainables : public TypedElement::Constrainables
{
public:
    using Handle = Argument;

    /// Adds an instance to a query: `Argument::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The operation whose argument this is.
    query::ConstrainableReference<Operation> operation;

    /// Whether the caller supplies it.
    query::ConstrainableValue<bool> isInput;
};
}  // namespace tarn::kiln::meta
