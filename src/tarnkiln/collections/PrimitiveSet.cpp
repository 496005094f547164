#include "tarnkiln/collections/PrimitiveSet.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(T)                                                                         \
    template class PrimitiveCollection<T, std::set<T, support::TotalLess<T>>>;                     \
    template class PrimitiveSet<T>;
TARNKILN_FOR_EACH_PRIMITIVE_TYPE(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
