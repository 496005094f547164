// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// What a query may ask of a `Property`.
#pragma once
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/StructuredType.h"
#include "tarnkiln/meta/TypedElementConstrainables.h"
#include "tarnkiln/query/ConstrainableRelationWithAttachment.h"
#include "tarnkiln/query/ConstrainableWithAttachment.h"

#include <utility>

namespace tarn::kiln::meta {

/// A search instance for a `Property`, with a member for each of its properties.
///
/// The query must outlive it, and must not be reset while it is in use.
///
/// Threads: as the query.
class TARNKILN_EXPORT Property::Constrainables : public TypedElement::Constrainables
{
public:
    using Handle = Property;

    /// Adds an instance to a query: `Property::Constrainables sought({query, mode});`
    explicit Constrainables(
        std::pair<query::AbstractQuery&, query::SearchClassMatchMode const> const& source);
    /// Adds an instance for `metaClass`, which is to be this class or one that extends it.
    ///
    /// \throws tarnkiln::query::InvalidSearchClass  if `metaClass` is empty or dead.
    Constrainables(
        query::AbstractQuery& query, meta::Class const& metaClass,
        query::SearchClassMatchMode mode);

    /// Whether the value is computed and has no slot.
    query::ConstrainableValue<bool> isDerived;

    /// Whether the value is contained in the element.
    query::ConstrainableValue<bool> isComposite;

    /// Whether there is no setter.
    query::ConstrainableValue<bool> isReadOnly;

    /// Whether a sequence refuses to hold a member twice.
    query::ConstrainableValue<bool> isUnique;

    /// The property of the members that is the key of this collection.
    query::ConstrainableReference<Property> qualifiedBy;

    /// Whether a client's code keeps the keys current.
    query::ConstrainableValue<bool> customQualification;

    /// Whether a key has one member at most.
    query::ConstrainableValue<bool> isQualificationUnique;

    /// The other end of the association.
    query::ConstrainableReference<Property> opposite;

    /// The slot, counted from 1; 0 if there is none.
    query::ConstrainableValue<int> propertyIndex;

    /// Whether any client may read it.
    query::ConstrainableValue<bool> isPublicAccessor;

    /// Whether any client may change it.
    query::ConstrainableValue<bool> isPublicMutator;

    /// Whether documents leave it out.
    query::ConstrainableValue<bool> isTransient;

    /// Whether most elements have no value.
    query::ConstrainableValue<bool> isSparse;

    /// The type that has it.
    query::ConstrainableReference<StructuredType> owningType;

    /// The display group.
    query::ConstrainableValue<string> vobjDispCategory;

    /// Whether displays leave out an empty value.
    query::ConstrainableValue<bool> vobjDispSkipEmpty;

    /// Whether it may be set once, from the empty value.
    query::ConstrainableValue<bool> isSetOnce;

    /// Whether displays leave it out.
    query::ConstrainableValue<bool> isVobjHidden;

    /// The text of the value that new elements start with.
    query::ConstrainableValue<ustring> defaultValue;

    /// Whether queries ask for it often.
    query::ConstrainableValue<bool> isQueryIndex;
};
}  // namespace tarn::kiln::meta
