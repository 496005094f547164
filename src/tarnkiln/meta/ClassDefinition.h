/// \file
/// One class that is being defined at run time.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/PropertyDefinition.h"

namespace tarn::kiln::meta {

/// Gives a new class its properties; made by `PackageDefinition`.
///
/// The definition is also the class. It may change the class until its `PackageDefinition`
/// is finished, on that one's thread.
class TARNKILN_EXPORT ClassDefinition
{
public:
    explicit ClassDefinition(Class const& defined);

    operator Class const&() const { return m_class; }

    /// Every element of this class is one of `superclass` too. Without that word the superclass is
    /// `ModelElement`.
    ClassDefinition& extends(Class const& superclass);
    ClassDefinition& makeAbstract();  ///< No element has just this class.

    /// \name Properties
    /// Each fails with `UniquenessConstraint` if the class has a property of that name.
    /// @{
    /// A property with exactly one value, of a primitive type, an enumeration or a data type.
    PropertyDefinition attribute(ustring const& name, Type const& type);
    /// A property that refers to at most one element of `target`.
    PropertyDefinition reference(ustring const& name, Class const& target);
    /// A property whose value, at most one element of `target`, is part of the element.
    PropertyDefinition contents(ustring const& name, Class const& target);
    /// @}

private:
    Class m_class;
};
}  // namespace tarn::kiln::meta
