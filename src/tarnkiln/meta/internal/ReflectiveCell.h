/// \file
/// What a reflective element keeps for one property.
#pragma once
#include <cstdint>

namespace tarn::kiln::internal {

/// How the word of a `ReflectiveCell` is to be read.
enum class CellState : std::uint8_t
{
    Empty =
        0,  ///< A plain value: absent, as the slot's empty value is. Else: nothing, or a pointer.
    Optional,  ///< A plain value, packed, of the shape `OptionalSingle`.
    Single,    ///< A plain value, packed, of the shape `Single`.
    Boxed,     ///< A pointer to a `Value` of its own.
    Loaded     ///< A collection that the data source was asked to fill.
};

/// A word and how to read it; says nothing without the `ReflectiveSlot` that it is kept for, which
/// also frees what it points to.
///
/// | Slot | Word |
/// |---|---|
/// | number, Boolean, date-time, enumeration | the payload itself |
/// | text | a pointer to a `PackedText`; null for an empty one |
/// | UUID | a pointer to it; null for the nil one |
/// | another plain value | `Boxed` |
/// | reference | a counted pointer to the target, which may be a proxy or dead |
/// | collection | an owned pointer to it; null until it is first asked for |
/// | container | nothing: the link is the storage |
struct ReflectiveCell
{
    std::uint64_t word = 0;
    CellState state = CellState::Empty;

    /// Whether it is a plain value whose payload the word tells.
    bool isPacked() const { return state == CellState::Optional || state == CellState::Single; }
    template <class T> T* pointer() const { return reinterpret_cast<T*>(word); }
    void point(void* target) { word = reinterpret_cast<std::uint64_t>(target); }
};
}  // namespace tarn::kiln::internal
