#include "tarnkiln/collections/UnorderedElementSet.h"

namespace tarn::kiln {

template class TypedReferenceCollection<ModelElement, internal::ElementHashSet<ModelElement>>;
template class TypedReferenceCollectionWithProxies<ModelElement,
                                                   internal::ElementHashSet<ModelElement>>;
template class UnorderedElementSet<ModelElement>;
}  // namespace tarn::kiln
