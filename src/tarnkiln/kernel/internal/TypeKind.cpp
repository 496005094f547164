#include "tarnkiln/kernel/internal/TypeKind.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"

#include <typeinfo>

namespace tarn::kiln::internal {

// Asked for each value that is set or read. To say no, a `dynamic_cast` compares the names of all
// bases, so what nearly all types are is told by the type itself, the most frequent one first.
TypeKind kindOf(meta::Type const& type)
{
    ElementImpl* const element = type.getElementImpl();
    if (!element)
        return TypeKind::Nothing;
    std::type_info const& kind = typeid(*element);
    if (&kind == &typeid(meta::PrimitiveType::Impl))
        return TypeKind::Primitive;
    if (&kind == &typeid(meta::Class::Impl))
        return TypeKind::Class;
    if (dynamic_cast<meta::Enum::Impl*>(element))
        return TypeKind::Enum;
    if (dynamic_cast<meta::DataType::Impl*>(element))
        return TypeKind::DataType;
    if (dynamic_cast<meta::Class::Impl*>(element))
        return TypeKind::Class;
    return dynamic_cast<meta::PrimitiveType::Impl*>(element) ? TypeKind::Primitive
                                                             : TypeKind::Other;
}

meta::Class::Impl* classImpl(meta::Type const& type)
{
    return kindOf(type) == TypeKind::Class ? static_cast<meta::Class::Impl*>(type.getElementImpl())
                                           : nullptr;
}
}  // namespace tarn::kiln::internal
