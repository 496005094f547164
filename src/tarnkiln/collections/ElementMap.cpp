#include "tarnkiln/collections/ElementMap.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(K)                                                                         \
    template class ReferenceAssociativeContainer<                                                  \
        K, ModelElement, std::map<K, ModelElement, support::TotalLess<K>>>;                        \
    template class ElementMap<K, ModelElement>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
