#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"

namespace tarn::kiln::meta {

ustring Property::Impl::identifier() const
{
    StructuredType const owner = getOwningType();
    return owner ? owner->getQualifiedName() + u"." + getName() : getName();
}
}  // namespace tarn::kiln::meta
