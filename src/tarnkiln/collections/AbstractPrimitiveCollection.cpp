#include "tarnkiln/collections/AbstractPrimitiveCollection.h"

#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {

AbstractPrimitiveCollection::~AbstractPrimitiveCollection() = default;

GenericPrimitiveInterface* AbstractPrimitiveCollection::getGenericInterface() const
{
    return nullptr;
}

meta::Type AbstractPrimitiveCollection::getPropertyType() const
{
    meta::Property const& property = getCollectionProperty();
    return property ? property->getType() : meta::Type();
}
}  // namespace tarn::kiln
