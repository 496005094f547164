// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of an `EnumLiteral`.
#pragma once
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/NamedElementConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for an `EnumLiteral`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT EnumLiteral::Constrainables : public NamedElement::Constrainables
{
public:
    using Handle = EnumLiteral;

    /// Adds an instance to a query: `EnumLiteral::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The number; a sibling may have the same.
    query::ConstrainableValue<int> value;

    /// The owner.
    query::ConstrainableReference<Enum> parentEnum;

    /// What documents may write in place of the name.
    query::ConstrainableValue<ustring> publicIdentifier;
};
}  // namespace tarn::kiln::meta
