/// \file
/// One property of a class that is being defined at run time.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Property.h"

namespace tarn::kiln::meta {

/// Says what a new property is like, word by word; made by `ClassDefinition`.
///
/// Each word changes the property at once and returns the definition, which is also the property.
/// It may change the property until its `PackageDefinition` is finished, on that one's thread.
class TARNKILN_EXPORT PropertyDefinition
{
public:
    explicit PropertyDefinition(Property const& property);

    operator Property const&() const { return m_property; }

    /// \name How many values
    /// Attributes have exactly one value unless one of these says otherwise, references at most
    /// one.
    /// @{
    PropertyDefinition& required();  ///< Exactly one.
    PropertyDefinition& optional();  ///< One or none.
    PropertyDefinition& many();      ///< Any number, in no order.
    PropertyDefinition& sequence();  ///< Any number, in the order given; members may repeat.
    PropertyDefinition& unique();    ///< A sequence holds each member once.
    /// Any number, found by the value that `key`, a property of the members, has: one under each.
    PropertyDefinition& keyedBy(Property const& key);
    PropertyDefinition& manyPerKey();  ///< A keyed property may hold several under one key.
    /// @}

    /// \name What else
    /// @{
    /// The text from which new elements take the value; for an enumeration a literal's name.
    PropertyDefinition& defaultValue(ustring const& text);
    PropertyDefinition& readOnly();
    PropertyDefinition& setOnce();    ///< May be set once, from the empty value.
    PropertyDefinition& transient();  ///< Left out of documents.
    PropertyDefinition& derived();    ///< Computed: elements keep no value.
    /// @}

    /// Makes the other end of the association, a property of the target's class that refers to at
    /// most one element, and returns that end.
    PropertyDefinition opposite(ustring const& name);

private:
    PropertyDefinition& bounds(unsigned lower, unsigned upper, bool ordered);

    Property m_property;
};
}  // namespace tarn::kiln::meta
