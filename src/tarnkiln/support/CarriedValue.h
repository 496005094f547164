/// \file
/// The payloads of values, as serializers make and read them.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional.hpp>

#include <iterator>
#include <set>
#include <type_traits>
#include <vector>

namespace tarn::kiln::support {

/// Whether `type` is `own`, or both are primitive types of the same qualified name, as a metamodel
/// that is read at run time may declare one.
TARNKILN_EXPORT bool isSameOrNamesake(meta::Type const& type, meta::Type const& own);

/// Values that carry a `T`, whatever their type.
///
/// In contrast to `Value` itself, nothing is checked of a type that comes with a payload; when
/// a value is read its type may also be `own`, the type of the serializer, or a namesake of that.
///
/// \tparam T  what a `Value` can hold; or any enumeration, which is carried as the number of
///            a literal.
template <class T> class CarriedValue
{
    using Carrier = std::conditional_t<std::is_enum_v<T> && !PlainPayload<T>, long, T>;
    template <ValueFlags SHAPE>
    using Container =
        std::conditional_t<SHAPE == ValueFlags::Sequence, std::vector<Carrier>, std::set<Carrier>>;

public:
    /// A `Single` value.
    static Value make(meta::Type const& type, T const& payload)
    {
        return ValueAccess<Carrier>::make(type, static_cast<Carrier>(payload));
    }
    /// An `OptionalSingle` value without payload.
    static Value makeAbsent(meta::Type const& type)
    {
        return ValueAccess<boost::optional<Carrier>>::make(type, boost::none);
    }

    /// The payload of a `Single` value; `T()` if there is none.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type) if it is of another type or shape.
    static T read(Value const& value, meta::Type const& own)
    {
        if (value.getFlags() != ValueFlags::Single || !isSameOrNamesake(value.getType(), own))
            ValueAccess<Carrier>::check(value);
        return static_cast<T>(ValueAccess<Carrier>::read(value));
    }
    /// Fails likewise unless the value can be read as an optional one.
    static void checkOptional(Value const& value, meta::Type const& own)
    {
        if (value.getFlags() > ValueFlags::Single || !isSameOrNamesake(value.getType(), own))
            checkOptional(value);
    }

    /// An unmanaged collection of the payloads of `Single` values.
    template <ValueFlags SHAPE>
    static Value combine(meta::Type const& type, std::vector<Value> const& values,
                         meta::Type const& own)
    {
        Container<SHAPE> entries;
        for (Value const& value : values)
            entries.insert(entries.end(), static_cast<Carrier>(read(value, own)));
        return ValueAccess<Container<SHAPE>>::make(type, entries);
    }

private:
    /// The values of an enumeration can't be read as optional numbers, but by `getEnumNumber`.
    static void checkOptional(Value const& value)
    {
        if constexpr (std::is_same_v<Carrier, T>)
            ValueAccess<boost::optional<T>>::check(value);
        else
            value.getEnumNumber();
    }
};
}  // namespace tarn::kiln::support
