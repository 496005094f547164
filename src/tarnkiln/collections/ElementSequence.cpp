#include "tarnkiln/collections/ElementSequence.h"

namespace tarn::kiln {

template class TypedReferenceCollection<ModelElement, support::SequenceEntries>;
template class ElementSequence<ModelElement>;
}  // namespace tarn::kiln
