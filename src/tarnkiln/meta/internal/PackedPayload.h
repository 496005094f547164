/// \file
/// How plain values are packed into a word.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/internal/SlotKind.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <new>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

namespace tarn::kiln::internal {

/// A text in one piece of memory, as its length and its characters. Null stands for an empty one.
template <class Char> class PackedText
{
public:
    using Text = std::basic_string<Char>;
    using View = std::basic_string_view<Char>;

    static bool fits(View text) { return text.size() <= std::numeric_limits<Length>::max(); }
    static std::uint64_t pack(View text)
    {
        if (text.empty())
            return 0;
        auto const length = static_cast<Length>(text.size());
        auto* const block =
            static_cast<std::byte*>(::operator new(sizeof length + text.size() * sizeof(Char)));
        std::memcpy(block, &length, sizeof length);
        std::memcpy(block + sizeof length, text.data(), text.size() * sizeof(Char));
        return reinterpret_cast<std::uint64_t>(block);
    }
    static View view(std::uint64_t word)
    {
        if (word == 0)
            return View();
        auto const* const block = reinterpret_cast<std::byte const*>(word);
        Length length;
        std::memcpy(&length, block, sizeof length);
        return View(reinterpret_cast<Char const*>(block + sizeof length), length);
    }
    static void free(std::uint64_t word) { ::operator delete(reinterpret_cast<void*>(word)); }

private:
    using Length = std::uint32_t;
};

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
    static bool fits(T const& /*payload*/) { return true; }
    static bool equals(std::uint64_t word, T const& payload) { return unpack(word) == payload; }
    static void free(std::uint64_t word)
    {
        if constexpr (!IN_PLACE)
            delete reinterpret_cast<T*>(word);
    }
};

template <class Char> struct Packed<std::basic_string<Char>>
{
    using Text = std::basic_string<Char>;

    static constexpr bool IN_PLACE = false;

    static bool fits(Text const& payload) { return PackedText<Char>::fits(payload); }
    static std::uint64_t pack(Text const& payload) { return PackedText<Char>::pack(payload); }
    static Text unpack(std::uint64_t word) { return Text(PackedText<Char>::view(word)); }
    static bool equals(std::uint64_t word, Text const& payload)
    {
        return PackedText<Char>::view(word) == payload;
    }
    static void free(std::uint64_t word) { PackedText<Char>::free(word); }
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
