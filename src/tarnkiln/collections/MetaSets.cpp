// The sets of the metamodel's classes.
#include "tarnkiln/collections/MetaCollections.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(T) template class UnorderedElementSet<T>;
TARNKILN_FOR_EACH_META_CLASS(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
