/// \file
/// The bodies of setters of a property by which a collection of the owner keeps its elements.
#pragma once
#include "tarnkiln/support/Field.h"

namespace tarn::kiln::support {

/// Fails with `UniquenessConstraint` if a live element of `map` has that key.
template <class Map, class Key> void requireFreeKey(Map const& map, Key const& key)
{
    if (map.find(key))
        reportException(tarnkiln::messages::UniquenessConstraint());
}

/// Gives an element another key: it leaves the owner's collection, changes, and comes back.
///
/// \param owner        the owner; may be empty, then there is nothing to leave.
/// \param toOwner      the element's reference to it.
/// \param requireFree  fails if the key is taken; called before anything changes.
/// \param store        stores the key.
template <class Key, class Owner, class RequireFree, class Store>
void changeKey(ModelElement::Impl& element, Key const& present, Key const& key, Owner const& owner,
               Slot const& toOwner, RequireFree requireFree, Store store)
{
    if (key == present || !element.isLive())
        return;
    if (owner)
        requireFree();
    ModelElement const self(&element);

    JoiningTransaction transaction(element);
    if (owner)
        element._inverseRemoveThis(owner.getImpl(), *toOwner.opposite);
    store();
    if (owner)
        element._inverseAddThis(owner.getImpl(), *toOwner.opposite, /*force=*/true);
    transaction.commit();
}
}  // namespace tarn::kiln::support
