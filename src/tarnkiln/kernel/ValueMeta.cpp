#include "tarnkiln/kernel/ValueMeta.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {

ValueMeta::ValueMeta(meta::Property const& property)
    : m_type(property->getType()),
      m_flags(doGetFlags(property))
{
    if (property->hasQualifiedBy())
        m_keyType = property->getQualifiedBy()->getType();
}

void ValueMeta::setReflective()
{
    m_reflective = true;
    if (internal::classImpl(m_type))
        m_type = ModelElement::metaClass();
}

ValueFlags ValueMeta::doGetFlags(meta::Property const& property)
{
    TARNKILN_ASSERT(property.getElementImpl(), "only a property has a shape");

    if (property->getUpper() < 2)
    {
        // An empty handle expresses that there is no element.
        bool const canBeAbsent =
            property->getLower() == 0 && !internal::classImpl(property->getType());
        return canBeAbsent ? ValueFlags::OptionalSingle : ValueFlags::Single;
    }
    if (property->hasQualifiedBy())
        return property->isQualificationUnique() ? ValueFlags::Map : ValueFlags::Multimap;
    return property->isOrdered() ? ValueFlags::Sequence : ValueFlags::Set;
}
}  // namespace tarn::kiln
