/// \file
/// Which C++ types a `Value` can hold and be read as.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/collections/Fwd.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional/optional_fwd.hpp>

#include <concepts>
#include <set>
#include <type_traits>
#include <vector>

namespace boost::posix_time {
class ptime;
}

namespace tarn::kiln::support {

template <class T, class... Types>
concept OneOf = (std::same_as<T, Types> || ...);

/// Whether `T` stands for a data type of a metamodel; generated code says so.
template <class T> inline constexpr bool isDataType = false;

/// Plain values.
template <class T>
concept PlainScalar =
    OneOf<T, bool, signed char, unsigned char, short, unsigned short, int, unsigned int, long,
          unsigned long, double, ustring, string, UUID, boost::posix_time::ptime,
          meta::TransactionOrigin, meta::ExtensionPrototype, meta::Language> || isDataType<T>;

/// Enumerations of metamodels; their values are carried by the numbers of the literals.
template <class T>
concept Literals = std::is_enum_v<T> && !PlainScalar<T>;

/// Handles of elements; `T` must be a complete type.
template <class T>
concept ElementReference = std::derived_from<T, ModelElement>;

/// The containers that a value can own. Those of handles are ordered by UUID.
template <class T> inline constexpr bool isContainerPayload = false;
template <class T>
inline constexpr bool isContainerPayload<std::vector<T>> =
    PlainScalar<T> || OneOf<T, Model, meta::Operation>;
template <class T>
inline constexpr bool isContainerPayload<std::set<T>> =
    PlainScalar<T> || OneOf<T, Model, meta::Operation>;

template <class T> inline constexpr bool isOptionalPayload = false;
template <class T>
inline constexpr bool isOptionalPayload<boost::optional<T>> = PlainScalar<T> || OneOf<T, Model>;

/// What a value can hold besides elements.
template <class T>
concept PlainPayload =
    PlainScalar<T> || OneOf<T, Model> || isOptionalPayload<T> || isContainerPayload<T>;

/// What a value can be made from.
template <class T>
concept Payload = PlainPayload<T> || ElementReference<T>;

/// Collections that elements own.
template <class T>
concept CollectionReference =
    OneOf<T, ReferenceCollection&, AbstractPrimitiveCollection&, StringToStringMap&>;

/// How `Value` keeps and reads a `T`; defined and instantiated in `ValueAccess.cpp`.
template <class T> struct TARNKILN_EXPORT ValueAccess
{
    /// A value of `type`, whether or not that is one whose values hold a `T`.
    static Value make(meta::Type const& type, T const& payload);
    /// Gives a value that holds nothing yet the payload and the shape.
    static void store(Value& value, T const& payload);
    static void check(Value const& value);
    static T read(Value const& value);
};

/// The same for collections, which a value shares; in `ValueCollections.cpp`.
template <class Collection> struct TARNKILN_EXPORT ValueAccess<Collection&>
{
    static void check(Value const& value);
    static Collection& read(Value const& value);
};
}  // namespace tarn::kiln::support
