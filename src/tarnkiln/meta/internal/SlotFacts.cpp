#include "tarnkiln/meta/internal/SlotFacts.h"

#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/ReflectiveSlot.h"

namespace tarn::kiln::internal {

SlotFacts::SlotFacts(meta::Class const& metaClass, ReflectiveSlot const& slot)
    : isOfClass(slot.property() && metaClass && metaClass->isATypeOf(slot.property())),
      isComposite(Feature(slot.property()).isComposite()),
      opposite(Feature(slot.property()).opposite())
{
    isOppositeKeyed = opposite.isKeyed();
    meta::Property const& property = slot.property();
    if (!isOfClass)
        return;
    isPublicAccessor = property->isPublicAccessor();
    isPublicMutator =
        property->isPublicMutator() && (!property->isReadOnly() || property->isSetOnce());
    isSetOnce = property->isSetOnce();
    isRequired = property->getLower() == 1;
    meta::Type const type = property->getType();
    isTypeKept = type && type == slot.type();
    auto const* const metaType = type ? classImpl(type) : nullptr;
    isTypedByClass = metaType != nullptr;
    isTypedByElements = metaType && metaType->isA(ModelElement::metaClass());
}
}  // namespace tarn::kiln::internal
