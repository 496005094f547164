#include "tarnkiln/collections/internal/QualifiedName.h"

#include "tarnkiln/meta/TypeImpl.h"

namespace tarn::kiln::internal {

ustring qualifiedNameOf(meta::Type const& type)
{
    return type ? type->getQualifiedName() : ustring();
}
}  // namespace tarn::kiln::internal
