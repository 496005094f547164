/// \file
/// How plain values are packed into a word.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/internal/SlotKind.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <cstdint>
#include <cstring>
#include <type_traits>
#include <utility>

namespace tarn::kiln::internal {

/// A payload of type `T` as a word: itself if it fits, else a pointer, null for the default value.
template <class T> struct Packed
{
    static constexpr bool IN_PLACE =
        sizeof(T) <= sizeof(std::uint64_t) && std::is_trivially_copyable_v<T>;

    static std::uint64_t pack(T const& payload)
    {
        std::uint64_t word = 0;
        if constexpr (IN_PLACE)
            std::memcpy(&word, &payload, sizeof(T));
        else if (!(payload == T()))
            word = reinterpret_cast<std::uint64_t>(new T(payload));
        return word;
    }
    static T unpack(std::uint64_t word)
    {
        if constexpr (IN_PLACE)
        {
            T payload;
            std::memcpy(static_cast<void*>(&payload), &word, sizeof(T));
            return payload;
        }
        else
        {
            return word ? *reinterpret_cast<T const*>(word) : T();
        }
    }
    static bool equals(std::uint64_t word, T const& payload) { return unpack(word) == payload; }
    static void free(std::uint64_t word)
    {
        if constexpr (!IN_PLACE)
            delete reinterpret_cast<T*>(word);
    }
};

/// Calls `visit.template operator()<T>()` with the C++ type of the payloads of a packed kind.
template <class Visit> decltype(auto) withPayloadType(SlotKind kind, Visit&& visit)
{
    switch (kind)
    {
    case SlotKind::Boolean:
        return visit.template operator()<bool>();
    case SlotKind::Integer8:
        return visit.template operator()<signed char>();
    case SlotKind::Integer16:
        return visit.template operator()<short>();
    case SlotKind::Integer:
        return visit.template operator()<int>();
    case SlotKind::UInteger8:
        return visit.template operator()<unsigned char>();
    case SlotKind::UInteger16:
        return visit.template operator()<unsigned short>();
    case SlotKind::UnlimitedNatural:
        return visit.template operator()<unsigned int>();
    case SlotKind::UInteger64:
        return visit.template operator()<unsigned long>();
    case SlotKind::Real:
        return visit.template operator()<double>();
    case SlotKind::DateTime:
        return visit.template operator()<boost::posix_time::ptime>();
    case SlotKind::String:
        return visit.template operator()<ustring>();
    case SlotKind::StdString:
        return visit.template operator()<string>();
    case SlotKind::Uuid:
        return visit.template operator()<UUID>();
    default:  // a literal's number travels as a `long`
        return visit.template operator()<long>();
    }
}
}  // namespace tarn::kiln::internal
