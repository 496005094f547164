#include "tarnkiln/collections/ReflectiveElementMap.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(K) template class ReflectiveElementMap<K>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DEFINE)
TARNKILN_DEFINE(ReflectiveDataType)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
