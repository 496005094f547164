/// \file
/// The kinds of properties that reflective elements store each in its own way.
#pragma once
#include "tarnkiln/meta/Fwd.h"

#include <cstdint>

namespace tarn::kiln::internal {

enum class SlotKind : std::uint8_t
{
    // Plain values that are packed into a word, or pointed to by it.
    Boolean,
    Integer8,
    Integer16,
    Integer,
    Integer64,
    UInteger8,
    UInteger16,
    UnlimitedNatural,
    UInteger64,
    Real,
    DateTime,
    String,
    StdString,
    Uuid,
    Enumeration,

    Other,        ///< A plain value of any other type, kept as a `Value`.
    Annotations,  ///< One `StringToStringMap`.
    Values,       ///< A collection of plain values.
    References,   ///< A collection of references to elements.
    Reference,
    Container  ///< The reference to the container, opposite of a composite property.
};

constexpr bool isPlain(SlotKind kind)
{
    return kind <= SlotKind::Other;
}
/// Whether the word is all there is to a packed value.
constexpr bool isInPlace(SlotKind kind)
{
    return kind < SlotKind::String || kind == SlotKind::Enumeration;
}
constexpr bool isCollection(SlotKind kind)
{
    return kind >= SlotKind::Annotations && kind <= SlotKind::References;
}

/// The kind of a single value of `type`, which is not a class.
SlotKind plainKindOf(meta::Type const& type);
}  // namespace tarn::kiln::internal
