#include "tarnkiln/collections/AbstractPrimitiveCollection.h"

namespace tarn::kiln {

AbstractPrimitiveCollection::~AbstractPrimitiveCollection() = default;

GenericPrimitiveInterface* AbstractPrimitiveCollection::getGenericInterface() const
{
    return nullptr;
}
}  // namespace tarn::kiln
