/// \file
/// What a type of plain values registers to make its collections.
#pragma once
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln::support {

/// The collection that `owner` keeps as its value of `property`; the caller owns it.
template <class T>
AbstractOwnedCollection* makePrimitiveCollection(ModelElement const& owner,
                                                 meta::Property const& property)
{
    if (property->isOrdered())
        return new PrimitiveSequence<T>(owner.getImpl(), property->isUnique(), property);
    return new PrimitiveSet<T>(owner.getImpl(), property);
}
}  // namespace tarn::kiln::support
