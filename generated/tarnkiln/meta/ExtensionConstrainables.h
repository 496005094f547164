// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `Extension`.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/meta/PropertyConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `Extension`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Extension::Constrainables : public Property::Constrainables
{
public:
    using Handle = Extension;

    /// Adds an instance to a query: `Extension::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The class that it extends.
    query::ConstrainableReference<Class> extendedMetaclass;

    /// The group that it belongs to.
    query::ConstrainableReference<DynamicExtensions> owner;
};
}  // namespace tarn::kiln::meta
