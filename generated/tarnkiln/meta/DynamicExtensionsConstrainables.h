// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `DynamicExtensions`.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/DynamicExtensions.h"
#include "tarnkiln/meta/Extension.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `DynamicExtensions`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT DynamicExtensions::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = DynamicExtensions;

    /// Adds an instance to a query: `DynamicExtensions::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The id of the model that declares them.
    query::ConstrainableValue<unsigned long> modelID;

    /// The extensions, by name.
    query::ConstrainableReference<Extension> extensions;

    /// The class that they extend.
    query::ConstrainableReference<Class> owningClass;
};
}  // namespace tarn::kiln::meta
