// The keyed collections of the metamodel's classes.
#include "tarnkiln/collections/MetaCollections.h"

namespace tarn::kiln {

#define TARNKILN_DEFINE(T) template class ElementMap<ustring, T>;
TARNKILN_FOR_EACH_NAMED_MEMBER(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE

template class ElementMultimap<ustring, meta::Operation>;
template class ElementMap<unsigned long, meta::DynamicExtensions>;
}  // namespace tarn::kiln
