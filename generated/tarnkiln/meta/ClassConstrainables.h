// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Class`.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/StructuredTypeConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `Class`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Class::Constrainables : public StructuredType::Constrainables
{
public:
    using Handle = Class;

    /// Adds an instance to a query: `Class::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The class that this one extends.
    query::ConstrainableReference<Class> superclass;

    /// What models add to the class, by the models' ids.
    query::ConstrainableReference<DynamicExtensions> extensions;

    /// Whether no element can be made of exactly this class.
    query::ConstrainableValue<bool> isAbstract;
};
}  // namespace tarn::kiln::meta
