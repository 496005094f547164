// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `DateTimeAttribute`.
#pragma once
#include "tarnkiln/meta/AttributeConstrainables.h"
#include "tarnkiln/meta/DateTimeAttribute.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <boost/date_time/posix_time/ptime.hpp>

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `DateTimeAttribute`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT DateTimeAttribute::Constrainables : public Attribute::Constrainables
{
public:
    using Handle = DateTimeAttribute;

    /// Adds an instance to a query: `DateTimeAttribute::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// The value.
    query::ConstrainableValue<boost::posix_time::ptime> value;
};
}  // namespace tarn::kiln::meta
