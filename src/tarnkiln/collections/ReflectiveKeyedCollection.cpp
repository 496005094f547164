#include "tarnkiln/collections/ReflectiveKeyedCollection.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(K)                                                                         \
    template class ReflectiveKeyedCollection<ElementMap<K, ModelElement>>;                         \
    template class ReflectiveKeyedCollection<ElementMultimap<K, ModelElement>>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DEFINE)
TARNKILN_DEFINE(ReflectiveDataType)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
