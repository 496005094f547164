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

/// One of several owners that keep an element by its key.
///
/// `requireFree` fails if the key is taken there.
template <class Owner, class RequireFree> struct KeyedBy
{
    Owner owner;
    Slot const& toOwner;
    RequireFree requireFree;
};
template <class Owner, class RequireFree>
KeyedBy(Owner, Slot const&, RequireFree) -> KeyedBy<Owner, RequireFree>;

/// For a collection that admits several elements of one key.
inline constexpr auto anyKey = [] {};

/// The same for an element that stands in collections of several owners.
template <class Key, class Store, class... Owner, class... RequireFree>
void changeKey(ModelElement::Impl& element, Key const& present, Key const& key, Store store,
               KeyedBy<Owner, RequireFree> const&... places)
{
    if (key == present || !element.isLive())
        return;
    auto const whereOwned = [](auto const& place, auto step) {
        if (place.owner)
            step(place);
    };
    (whereOwned(places, [](auto const& place) { place.requireFree(); }), ...);
    ModelElement const self(&element);

    JoiningTransaction transaction(element);
    auto const leave = [&](auto const& place) {
        element._inverseRemoveThis(place.owner.getImpl(), *place.toOwner.opposite);
    };
    (whereOwned(places, leave), ...);
    store();
    auto const join = [&](auto const& place) {
        element._inverseAddThis(place.owner.getImpl(), *place.toOwner.opposite, /*force=*/true);
    };
    (whereOwned(places, join), ...);
    transaction.commit();
}
}  // namespace tarn::kiln::support
