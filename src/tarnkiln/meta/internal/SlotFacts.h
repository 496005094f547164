/// \file
/// What a property says now, as far as the use of its slot depends on it.
#pragma once
#include "tarnkiln/kernel/Feature.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::internal {

class ReflectiveSlot;

/// True of a slot at one moment; a change of the metamodel may make it false.
struct SlotFacts
{
    SlotFacts(meta::Class const& metaClass, ReflectiveSlot const& slot);
    bool operator==(SlotFacts const& other) const = default;

    bool mayRead(ModelElement::Impl::ReflectionPrivateTag const& tag) const
    {
        return isOfClass && (isPublicAccessor || !(tag == ModelElement::Impl::PUBLIC_ACCESS));
    }
    bool maySet(ModelElement::Impl::ReflectionPrivateTag const& tag) const
    {
        return isOfClass && (isPublicMutator || !(tag == ModelElement::Impl::PUBLIC_ACCESS));
    }

    bool isOfClass;  ///< Both are live and the property is one of the class or above it.
    bool isPublicAccessor = false;
    bool isPublicMutator = false;  ///< For a read-only property: that it can be set once.
    bool isSetOnce = false;
    bool isRequired = false;         ///< The lower bound is 1.
    bool isTypeKept = false;         ///< The type is live and still that of the slot.
    bool isTypedByClass = false;     ///< By a live one.
    bool isTypedByElements = false;  ///< By one that is or extends the class of all elements.
    bool isOppositeKeyed;
    bool isComposite;  ///< As a `Feature` of a dead property, this and the next are empty.
    Feature opposite;
};
}  // namespace tarn::kiln::internal
