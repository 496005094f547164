#include "tarnkiln/meta/internal/PlainPlace.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/internal/PackedPayload.h"

#include <boost/optional.hpp>

#include <typeinfo>

namespace tarn::kiln::internal {
namespace {

/// Whether values of `kind` are of `type`, as the comparators for it expect.
bool suits(SlotKind kind, meta::Type const& type)
{
    if (kind == SlotKind::Enumeration)
        return plainKindOf(type) == kind;
    return withPayloadType(kind, [&]<class T>() { return type == meta::standardTypeOf<T>(); });
}

template <class T> KeptValue lookAt(void const* field)
{
    return keptValue(KeptValue::Shape::Single, static_cast<T const*>(field));
}

template <class T> KeptValue lookIntoOptional(void const* field)
{
    T const* const payload = static_cast<boost::optional<T> const*>(field)->get_ptr();
    return keptValue(payload ? KeptValue::Shape::Optional : KeptValue::Shape::Absent, payload);
}

template <class T> KeptValue unpack(KeptValue::Shape shape, std::uint64_t word)
{
    static T const defaultPayload{};
    if constexpr (TextPayload<T>)
    {
        auto const text = PackedText<typename T::value_type>::view(word);
        return {shape, text.empty() ? defaultPayload.data() : text.data(), text.size()};
    }
    else
        return {shape, word ? reinterpret_cast<void const*>(word) : &defaultPayload};
}
}  // namespace

KeptBy keptBy(ModelElement::Impl const& element)
{
    if (typeid(element) == typeid(ReflectiveModelElementImpl))
        return KeptBy::Layout;
    return element.isReadByFields() ? KeptBy::Class : KeptBy::Nobody;
}

PlainPlace PlainPlace::find(ModelElement::Impl const& element, KeptBy by,
                            meta::Property const& property)
{
    PlainPlace place;
    if (by == KeptBy::Nobody || !property || property->getUpper() >= 2)
        return place;
    meta::Type const type = property->getType();
    if (by == KeptBy::Class)
    {
        StoredField const field = element.findStoredField(property);
        if (!field.type || !place.useField(field))
            return PlainPlace();
    }
    else
    {
        ReflectiveSlot const* const slot = cellsOf(element).layout().find(property);
        if (!slot || slot->kind() >= SlotKind::Other || slot->type() != type ||
            !element.getMetaClass()->isATypeOf(property))
            return PlainPlace();
        place.useCell(element, *slot);
    }
    return suits(place.m_kind, type) ? place : PlainPlace();
}

/// False if there are no comparators for fields of its type.
bool PlainPlace::useField(StoredField const& field)
{
    m_offset = field.offset;
    m_form = Form::Field;
    if (field.isLiteral)
    {
        m_kind = SlotKind::Enumeration;
        return *field.type == typeid(int) || *field.type == typeid(unsigned) ||
               *field.type == typeid(long) || *field.type == typeid(unsigned long);
    }
    for (int number = 0; number < static_cast<int>(SlotKind::Enumeration); ++number)
    {
        m_kind = static_cast<SlotKind>(number);
        bool const found = withPayloadType(m_kind, [&]<class T>() {
            bool const isOptional = *field.type == typeid(boost::optional<T>);
            if (!isOptional && *field.type != typeid(T))
                return false;
            if (isOptional || TextPayload<T>)
                m_form = Form::OtherField;
            m_look = isOptional ? lookIntoOptional<T> : lookAt<T>;
            return true;
        });
        if (found)
            return true;
    }
    return false;
}

void PlainPlace::useCell(ModelElement::Impl const& element, ReflectiveSlot const& slot)
{
    m_form = Form::Cell;
    m_kind = slot.kind();
    m_offset = offsetIn(element, &cellsOf(element).word(slot));
    m_stateOffset = offsetIn(element, &cellsOf(element).state(slot));
    withPayloadType(m_kind, [&]<class T>() {
        m_isInPlace = Packed<T>::IN_PLACE;
        m_unpack = unpack<T>;
    });
}
}  // namespace tarn::kiln::internal
