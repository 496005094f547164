#include "tarnkiln/kernel/internal/TypeKind.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"

namespace tarn::kiln::internal {

meta::Class::Impl* classImpl(meta::Type const& type)
{
    return dynamic_cast<meta::Class::Impl*>(type.getElementImpl());
}

bool isEnumType(meta::Type const& type)
{
    return dynamic_cast<meta::Enum::Impl*>(type.getElementImpl()) != nullptr;
}
}  // namespace tarn::kiln::internal
