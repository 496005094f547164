/// \file
/// Where elements of one kind keep a plain value.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tarnkiln/meta/internal/ReflectiveCells.h"
#include "tarnkiln/meta/internal/SlotKind.h"

#include <concepts>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <typeinfo>

namespace tarn::kiln::internal {

/// What an element keeps for a property, without a `Value` around it.
struct KeptValue
{
    enum class Shape : std::uint8_t
    {
        Single,    ///< A value of that shape.
        Optional,  ///< A value of the shape `OptionalSingle` that is there.
        Absent,    ///< An absent value of the shape `OptionalSingle`.
        Unknown    ///< The element must be asked.
    };

    Shape shape = Shape::Unknown;
    /// Of the C++ type of the place's kind, but the characters of a text; a literal's is its
    /// number, of which 32 bits count. Lies in the element. Null if there is none.
    void const* payload = nullptr;
    std::size_t length = 0;  ///< Of a text.
};

template <class T>
concept TextPayload = std::same_as<T, string> || std::same_as<T, ustring>;

/// The payload, which is there, of a place whose kind has the C++ type `T`; a view of a text.
template <class T> decltype(auto) payloadOf(KeptValue const& value)
{
    if constexpr (TextPayload<T>)
        return std::basic_string_view<typename T::value_type>(
            static_cast<typename T::value_type const*>(value.payload), value.length);
    else
        return *static_cast<T const*>(value.payload);
}

/// \param payload  null if there is none.
template <class T> KeptValue keptValue(KeptValue::Shape shape, T const* payload)
{
    if constexpr (TextPayload<T>)
        return payload ? KeptValue{shape, payload->data(), payload->size()} : KeptValue{shape};
    else
        return {shape, payload};
}

/// How elements may be told apart so that those of one kind keep their values alike.
enum class KeptBy : std::uint8_t
{
    Class,   ///< A generated class: the C++ class.
    Layout,  ///< A class known at run time: the layout.
    Nobody   ///< Each element must be asked.
};

/// How elements of the C++ class of `element` are told apart.
KeptBy keptBy(ModelElement::Impl const& element);

inline ReflectiveCells const& cellsOf(ModelElement::Impl const& element)
{
    return static_cast<ReflectiveModelElementImpl const&>(element).getCells();
}

/// Tells apart elements that keep their values in different ways.
class KindKeys
{
public:
    /// The same for elements that keep them alike: the C++ class or the layout. Of elements that
    /// must be asked, the C++ class.
    void const* of(ModelElement::Impl const& element)
    {
        std::type_info const* const type = &typeid(element);
        if (type != m_lastType)
        {
            m_lastType = type;
            m_isByLayout = keptBy(element) == KeptBy::Layout;
        }
        return m_isByLayout ? static_cast<void const*>(&cellsOf(element).layout()) : type;
    }

private:
    std::type_info const* m_lastType = nullptr;
    bool m_isByLayout = false;
};

/// How far `place` lies behind where the element begins.
inline std::ptrdiff_t offsetIn(ModelElement::Impl const& element, void const* place)
{
    return static_cast<char const*>(place) - reinterpret_cast<char const*>(&element);
}

/// The place of one property in the elements of one kind.
///
/// Reading there is reading by `getPropertyValue` with all rights, and never fails.
class PlainPlace
{
public:
    /// No place: all values are unknown.
    PlainPlace() = default;
    /// The place that elements of the kind of `element` have for a property with one value, if it
    /// is a plain one and of a type with comparators.
    static PlainPlace find(ModelElement::Impl const& element, KeptBy by,
                           meta::Property const& property);

    bool isKnown() const { return m_form != Form::None; }
    SlotKind kind() const { return m_kind; }
    /// Whether the element itself holds the payload, if there is one, and not only a pointer to it;
    /// said of no optional field.
    bool isInPlace() const
    {
        return m_form == Form::Field || (m_form == Form::Cell && m_isInPlace);
    }
    /// The payload of a place of which that is true; null if `read` must tell the shape.
    void const* findSingle(ModelElement::Impl const& element) const
    {
        bool const isSingle = m_form == Form::Field || stateIn(element) == CellState::Single;
        return isSingle ? fieldOf(element) : nullptr;
    }
    /// The field or the word of the cell; where the element begins, if nothing is known.
    void const* fieldOf(ModelElement::Impl const& element) const
    {
        return reinterpret_cast<char const*>(&element) + m_offset;
    }

    KeptValue read(ModelElement::Impl const& element) const
    {
        switch (m_form)
        {
        case Form::Field:
            return {KeptValue::Shape::Single, fieldOf(element)};
        case Form::OtherField:
            return m_look(fieldOf(element));
        case Form::Cell:
            return readCell(element);
        case Form::None:
            break;
        }
        return {};
    }

private:
    enum class Form : std::uint8_t
    {
        None,
        Field,       ///< Of a payload that always is there.
        OtherField,  ///< Of a text, or an optional one.
        Cell
    };

    bool useField(StoredField const& field);
    void useCell(ModelElement::Impl const& element, ReflectiveSlot const& slot);
    CellState stateIn(ModelElement::Impl const& element) const
    {
        return *reinterpret_cast<CellState const*>(reinterpret_cast<char const*>(&element) +
                                                   m_stateOffset);
    }
    KeptValue readCell(ModelElement::Impl const& element) const
    {
        CellState const state = stateIn(element);
        if (state == CellState::Empty)
            return {KeptValue::Shape::Absent, nullptr};
        if (state != CellState::Single && state != CellState::Optional)
            return {};
        KeptValue::Shape const shape =
            state == CellState::Single ? KeptValue::Shape::Single : KeptValue::Shape::Optional;
        void const* const word = fieldOf(element);
        return m_isInPlace ? KeptValue{shape, word}
                           : m_unpack(shape, *static_cast<std::uint64_t const*>(word));
    }

    Form m_form = Form::None;
    SlotKind m_kind = SlotKind::Other;
    bool m_isInPlace = false;          ///< The word of the cell is the payload.
    std::ptrdiff_t m_offset = 0;       ///< From where the element begins.
    std::ptrdiff_t m_stateOffset = 0;  ///< The same of the state of a cell.
    KeptValue (*m_look)(void const* field) = nullptr;
    KeptValue (*m_unpack)(KeptValue::Shape shape, std::uint64_t word) = nullptr;
};
}  // namespace tarn::kiln::internal
