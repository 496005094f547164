#include "tarnkiln/collections/ElementSequence.h"

namespace tarn::kiln {

template class TypedReferenceCollection<ModelElement, std::vector<ModelElement>>;
template class ElementSequence<ModelElement>;
}  // namespace tarn::kiln
