// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `NamedElement`.
#pragma once
#include "tarnkiln/meta/NamedElement.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"
#include "tarnkiln/query/ModelElementConstrainables.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `NamedElement`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT NamedElement::Constrainables : public ModelElement::Constrainables
{
public:
    using Handle = NamedElement;

    /// Adds an instance to a query: `NamedElement::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The name.
    query::ConstrainableValue<ustring, true> name;
};
}  // namespace tarn::kiln::meta
