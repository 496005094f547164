#include "tarnkiln/meta/AttributeMapImpl.h"

namespace tarn::kiln::meta {

ModelElement AttributeMap::Impl::getOwner() const
{
    return container();
}
}  // namespace tarn::kiln::meta
