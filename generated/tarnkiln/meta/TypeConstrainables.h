// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Type`.
#pragma once
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `Type`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Type::Constrainables : public NamedElement::Constrainables
{
public:
    using Handle = Type;

    /// Adds an instance to a query: `Type::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The names from the root package on, separated by dots.
    query::ConstrainableValue<ustring, true> qualifiedName;

    /// Whether displays leave it out.
    query::ConstrainableValue<bool> isVobjHidden;

    /// The package that has it.
    query::ConstrainableReference<Package> owningPackage;
};
}  // namespace tarn::kiln::meta
