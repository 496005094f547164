#include "tarnkiln/collections/PrimitiveSequence.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(T)                                                                         \
    template class PrimitiveCollection<T, std::vector<T>>;                                         \
    template class PrimitiveSequence<T>;
TARNKILN_FOR_EACH_PRIMITIVE_TYPE(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
