#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"

namespace tarn::kiln::meta {

ustring EnumLiteral::Impl::identifier() const
{
    Enum const owner = getParentEnum();
    return owner ? owner->getQualifiedName() + u"." + getName() : getName();
}
}  // namespace tarn::kiln::meta
