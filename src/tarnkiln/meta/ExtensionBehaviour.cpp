#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"

namespace tarn::kiln::meta {

Class Extension::Impl::getExtendedMetaclass() const
{
    DynamicExtensions const owner = getOwner();
    return owner ? owner->getOwningClass() : Class();
}

ExtensionPrototype Extension::Impl::createPrototype() const
{
    constexpr std::uint32_t UNBOUNDED = 0xFFFFFFFF;
    Type const type = getType();
    ExtensionPrototype prototype;
    prototype.setIsOrdered(isOrdered());
    prototype.setIsUnique(isUnique());
    prototype.setName(getName());
    prototype.setTypeName(type ? type->getQualifiedName() : ustring());
    prototype.setLower(getLower());
    prototype.setUpper(getUpper() < 2 ? getUpper() : UNBOUNDED);
    return prototype;
}
}  // namespace tarn::kiln::meta
