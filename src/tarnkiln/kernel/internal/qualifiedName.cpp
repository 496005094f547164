#include "tarnkiln/kernel/internal/qualifiedName.h"

#include "tarnkiln/meta/Type.h"
#include "tarnkiln/meta/TypeImpl.h"

namespace tarn::kiln::internal {

ustring qualifiedName(meta::Type const& type)
{
    return type ? type->getQualifiedName() : ustring();
}
}  // namespace tarn::kiln::internal
