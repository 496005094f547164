/// \file
/// What a class registers to make collections of its elements.
#pragma once
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln::support {

/// The collection that `owner` keeps as its value of `property`; the caller owns it.
template <class C>
AbstractOwnedCollection* makeElementCollection(ModelElement const& owner,
                                               meta::Property const& property)
{
    if (property->isOrdered())
        return new ElementSequence<C>(owner.getImpl(), property->isUnique(), property);
    return new UnorderedElementSet<C>(owner.getImpl(), property);
}
}  // namespace tarn::kiln::support
