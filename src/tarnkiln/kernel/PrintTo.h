/// \file
/// How GoogleTest shows what it would take for a container of bytes or would change by looking.
///
/// Handles, values and identifiers need no more than their own headers, since GoogleTest streams
/// them. A test program that compares UUIDs or collections of elements includes this too, in all
/// of its sources or they may disagree; it needs no header of GoogleTest itself.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/Types.h"

#include <boost/uuid/uuid_io.hpp>

#include <concepts>
#include <ostream>

namespace tarn::kiln {

/// Shows the collection as `<<` does. Iteration would put elements in the place of proxies.
template <std::derived_from<AbstractOwnedCollection> Collection>
void PrintTo(Collection const& collection, std::ostream* out)
{
    *out << static_cast<AbstractOwnedCollection const&>(collection);
}
}  // namespace tarn::kiln

namespace boost::uuids {

inline void PrintTo(uuid const& id, std::ostream* out)
{
    *out << id;
}
}  // namespace boost::uuids
