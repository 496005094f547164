// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `Operation`.
#pragma once
#include "tarnkiln/meta/Argument.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypedElementConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `Operation`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Operation::Constrainables : public TypedElement::Constrainables
{
public:
    using Handle = Operation;

    /// Adds an instance to a query: `Operation::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The arguments, in the order of the call.
    query::ConstrainableReference<Argument> arguments;

    /// The type that offers it.
    query::ConstrainableReference<StructuredType> owningType;

    /// Whether only subclasses supply a body.
    query::ConstrainableValue<bool> isAbstract;

    /// Whether it needs no element.
    query::ConstrainableValue<bool> isStatic;

    /// Whether any client may call it.
    query::ConstrainableValue<bool> isPublic;

    /// Whether a call is deferred to the end of the transaction.
    query::ConstrainableValue<bool> isEvent;
};
}  // namespace tarn::kiln::meta
