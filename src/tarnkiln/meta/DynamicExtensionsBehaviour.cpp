#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/support/Keyed.h"

namespace tarn::kiln::meta {

void DynamicExtensions::Impl::setModelID(unsigned long modelID)
{
    support::refuseProxy(*this);
    support::changeKey(
        *this, getModelID(), modelID, getOwningClass(), OWNING_CLASS,
        [&] { support::requireFreeKey(getOwningClass()->getExtensions(), modelID); },
        [&] { support::setScalar(*this, m_modelID, MODEL_ID, modelID); });
}
}  // namespace tarn::kiln::meta
