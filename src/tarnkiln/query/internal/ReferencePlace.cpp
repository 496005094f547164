#include "tarnkiln/query/internal/ReferencePlace.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/PlainPlace.h"

namespace tarn::kiln::internal {

ReferencePlace ReferencePlace::find(ModelElement::Impl const& element,
                                    meta::Property const& property)
{
    ReferencePlace place;
    switch (keptBy(element))
    {
    case KeptBy::Class:
        place.m_target = element.findStoredField(property).target;
        break;
    case KeptBy::Layout: {
        ReflectiveCells const& cells = cellsOf(element);
        ReflectiveSlot const* const slot = cells.layout().find(property);
        if (slot && slot->kind() == SlotKind::Reference &&
            element.getMetaClass()->isATypeOf(property))
            place.m_offset = offsetIn(element, &cells.word(*slot));
        break;
    }
    case KeptBy::Nobody:
        break;
    }
    return place;
}
}  // namespace tarn::kiln::internal
