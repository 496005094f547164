#include "tarnkiln/kernel/internal/TypeKind.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"

#include <typeinfo>

namespace tarn::kiln::internal {

meta::Class::Impl* classImpl(meta::Type const& type)
{
    ElementImpl* const element = type.getElementImpl();
    if (!element)
        return nullptr;
    // Asked for each value that is set. Nearly all types are one of these two, and nothing else.
    std::type_info const& kind = typeid(*element);
    if (kind == typeid(meta::Class::Impl))
        return static_cast<meta::Class::Impl*>(element);
    if (kind == typeid(meta::PrimitiveType::Impl))
        return nullptr;
    return dynamic_cast<meta::Class::Impl*>(element);
}

bool isEnumType(meta::Type const& type)
{
    return dynamic_cast<meta::Enum::Impl*>(type.getElementImpl()) != nullptr;
}
}  // namespace tarn::kiln::internal
