/// \file
/// Which reference collection the elements of a class known at run time have for a property.
#pragma once
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"

#include <memory>

namespace tarn::kiln::internal {

/// What a many-valued property with a class as type says about its collections.
///
/// | Property | Collection |
/// |---|---|
/// | qualified, one element a key | `ReflectiveElementMap` |
/// | qualified | `ReflectiveElementMultimap` |
/// | ordered | `ReflectiveElementSequence` |
/// | any other | `ReflectiveUnorderedElementSet` |
///
/// Keeps what it was told: collections made later are of the same kind, so that a snapshot fits the
/// collection that it is taken of.
///
/// Threads: may be used on several at once.
class ReferenceCollectionRecipe
{
public:
    /// \throws tarnkiln::messages::UnsupportedQualification  (qualified name of the type) if keys
    ///     can not be of the type of the qualifying property.
    explicit ReferenceCollectionRecipe(meta::Property const& property);

    /// A new collection; null as owner makes a snapshot.
    std::unique_ptr<ReferenceCollection> make(ModelElement::Impl* owner) const
    {
        return m_maker(*this, owner);
    }

private:
    using Maker = std::unique_ptr<ReferenceCollection> (*)(ReferenceCollectionRecipe const& recipe,
                                                           ModelElement::Impl* owner);
    struct Makers;

    static Maker chooseKeyed(meta::Property const& qualifier, bool oneAKey);

    meta::Property m_property;
    meta::Class m_elementClass;
    meta::Property m_opposite;
    meta::Property m_qualifier;  ///< Empty unless the collection is keyed.
    bool m_unique;
    Maker m_maker;
};
}  // namespace tarn::kiln::internal
