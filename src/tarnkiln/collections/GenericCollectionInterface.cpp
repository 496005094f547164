#include "tarnkiln/collections/GenericCollectionInterface.h"

namespace tarn::kiln {

GenericCollectionInterface::~GenericCollectionInterface() = default;

void GenericCollectionInterface::genericEnsureAt(ModelElement const& element,
                                                 unsigned long /*index*/)
{
    genericAdd(element);
}
}  // namespace tarn::kiln
