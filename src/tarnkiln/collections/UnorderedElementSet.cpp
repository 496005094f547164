#include "tarnkiln/collections/UnorderedElementSet.h"

namespace tarn::kiln {

template class TypedReferenceCollection<ModelElement, support::ElementHashSet<ModelElement>>;
template class TypedReferenceCollectionWithProxies<ModelElement,
                                                   support::ElementHashSet<ModelElement>>;
template class UnorderedElementSet<ModelElement>;
}  // namespace tarn::kiln
