/// \file
/// How handles, values and what belongs to them are shown to people.
///
///     std::cout << book;                  // Book "Emma" 8d5a0ea6-2f6b-4c1e-9f2c-0f8f3c1d7a52
///     EXPECT_EQ(shelf->getBest(), book);  // fails with both of them in words
///
/// GoogleTest streams what it can. A test program gets readable messages if each source that
/// compares such objects includes this; it needs no header of GoogleTest itself. The forms may
/// change with versions: no program should read them. Nothing is resolved or loaded to be shown.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/ElementHandle.h"
#include "tarnkiln/kernel/ModelId.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"

#include <boost/uuid/uuid_io.hpp>

#include <concepts>
#include <ostream>

namespace tarn::kiln {

/// The object behind a handle of any class: its class, its name or the URI of a model if it has
/// one, its UUID, and whether it is destroyed or stands in for another element.
///
/// The name is the property `name`, if the class has one that holds a single text.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ElementHandle const& handle);

/// Type, shape unless it is `Single`, and contents, texts in quotes and all else in its text form.
///
///     String "Emma"
///     OptionalSingle of Integer, absent
///     Sequence of Integer {3, 5}
///
/// What the serializer of a client's type raises passes.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, Value const& value);

/// The entries in braces, proxies as they stand. A long collection is cut.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out,
                                         AbstractOwnedCollection const& collection);

/// Type and identifier, as `uuid:8d5a0ea6-...`.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ElementId const& id);
/// The same with the model, as `uuid:8d5a0ea6-... in file:books`.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ProxyId const& id);
/// The whole id.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ModelId const& id);

/// The name of the shape; the number of one that has none.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ValueFlags flags);
/// The name of the result.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, TransactionResult result);

/// For GoogleTest, which would walk the collection and so put elements in the place of proxies.
template <std::derived_from<AbstractOwnedCollection> Collection>
void PrintTo(Collection const& collection, std::ostream* out)
{
    *out << static_cast<AbstractOwnedCollection const&>(collection);
}
}  // namespace tarn::kiln

namespace boost::uuids {

/// For GoogleTest, which would take a UUID for a container of bytes.
inline void PrintTo(uuid const& id, std::ostream* out)
{
    *out << id;
}
}  // namespace boost::uuids
