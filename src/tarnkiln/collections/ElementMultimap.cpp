#include "tarnkiln/collections/ElementMultimap.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(K)                                                                         \
    template class ReferenceAssociativeContainer<                                                  \
        K, ModelElement, std::multimap<K, ModelElement, support::TotalLess<K>>>;                   \
    template class ElementMultimap<K, ModelElement>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
