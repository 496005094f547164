// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `Attribute`.
#pragma once
#include "tarnkiln/meta/Attribute.h"
#include "tarnkiln/meta/AttributeMap.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `Attribute`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Attribute::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = Attribute;

    /// Adds an instance to a query: `Attribute::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// What the map knows the attribute by.
    query::ConstrainableValue<ustring, true> key;

    /// The map that holds it.
    query::ConstrainableReference<AttributeMap> owner;
};
}  // namespace tarn::kiln::meta
