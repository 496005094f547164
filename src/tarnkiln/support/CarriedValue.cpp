#include "tarnkiln/support/CarriedValue.h"

#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/PrimitiveType.h"

namespace tarn::kiln::support {

bool isSameOrNamesake(meta::Type const& type, meta::Type const& own)
{
    if (type == own)
        return type.getElementImpl() != nullptr;
    return meta::PrimitiveType::cast(type) && meta::PrimitiveType::cast(own) &&
           internal::qualifiedName(type) == internal::qualifiedName(own);
}
}  // namespace tarn::kiln::support
