// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `StructuredType`.
#pragma once
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypeConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `StructuredType`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT StructuredType::Constrainables : public Type::Constrainables
{
public:
    using Handle = StructuredType;

    /// Adds an instance to a query: `StructuredType::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The name of the C++ class.
    query::ConstrainableValue<string, true> vobjName;

    /// The properties declared here, by name.
    query::ConstrainableReference<Property> ownedAttributes;

    /// The operations declared here, by name, which several may share.
    query::ConstrainableReference<Operation> ownedOperations;

    /// Whether displays show it in one line.
    query::ConstrainableValue<bool> vobjCompactDisplay;

    /// The display groups, in the order of display.
    query::ConstrainableValue<string> vobjDispCategories;
};
}  // namespace tarn::kiln::meta
