/// \file
/// The one type that carries the value of any property.
///
///     Value const title(meta::StandardTypes::stringMeta, ustring(u"Emma"));
///     title.getValue<ustring>();                      // u"Emma"
///     title.getValue<int>();                          // raises CannotCastIncompatibleTypes
///
///     Value const author = book->getPropertyValue(authorOfBook,
///     ModelElement::Impl::PUBLIC_ACCESS); author.getValue<ModelElement>();                // the
///     element, or an empty handle
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ValueMeta.h"
#include "tarnkiln/kernel/ValuePayload.h"
#include "tarnkiln/kernel/ValueTraits.h"

#include <boost/optional.hpp>

#include <cstddef>
#include <iosfwd>
#include <vector>

namespace tarn::kiln::support {
struct PayloadAccess;
}

namespace tarn::kiln {

/// A scalar, an element, a data type value or a collection, with its type and shape.
///
/// | Holds | Payload | A copy |
/// |---|---|---|
/// | scalar, optional scalar | the scalar; nothing if absent | has its own |
/// | element | a handle; may be empty | refers to the same element |
/// | literal of an enumeration | its number | has its own |
/// | value of a data type | its C++ class, or a `ReflectiveDataType` | has its own |
/// | unmanaged collection | a `std::vector` or `std::set` | has its own |
/// | managed collection | an element's collection, which it does not own | shares it |
///
/// Dangers: a managed collection must outlive the value. A value that was moved from holds nothing
/// but keeps its type. Assignment, unlike construction, leaves the target's `extractEntryValues` of
/// unmanaged collections as it was.
///
/// Threads: a plain value; distinct objects may be used on distinct threads.
class TARNKILN_EXPORT Value : public ValueMeta
{
public:
    /// \name Construction
    /// @{
    /// A value of `type` that holds a copy of `payload`.
    ///
    /// The shape is `Single`, that of a `boost::optional` `OptionalSingle`; a `std::vector` makes
    /// an unmanaged `Sequence`, a `std::set` an unmanaged `Set`. For an enumeration `payload` is a
    /// `long`.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of `type`) if such
    ///     values are not of that type.
    template <support::Payload T> Value(meta::Type const& type, T const& payload);

    /// The same, of the property's type. The shape does not depend on the property.
    template <support::PlainPayload T>
    static Value createPrimitiveValue(meta::Property const& property, T const& payload);
    /// The same for an element. The type is the property's, not the class of the element, so that
    /// two values of a property that hold the same element are equal.
    template <support::ElementReference T>
    static Value createElementValue(meta::Property const& property, T const& element);
    /// A `Single` value of the enumeration that has the literal.
    static Value createEnumValue(meta::EnumLiteral const& literal);
    /// An `OptionalSingle` value of the property's type, an enumeration; absent without a number.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the type) if
    ///     that is no enumeration.
    static Value createOptionalEnumValue(meta::Property const& property,
                                         boost::optional<long> const& number);
    /// A `Single` value of the data type, marked as reflective.
    static Value createReflectiveDataTypeValue(ReflectiveDataType const& value);
    /// The same with all fields at their defaults, or an absent one if it is not `required`.
    ///
    /// \throws tarnkiln::messages::NoSuchType  (qualified name) if one is required of a type that
    /// is
    ///     empty or dead.
    static Value createReflectiveDataTypeValue(meta::DataType const& type, bool required);
    /// A value that shares `collection`, an element's value of `property`. Null is none. For a
    /// property with one value, a map of texts, the shape is `Single`, be it optional or not.
    static Value createCollectionValue(meta::Property const& property,
                                       AbstractOwnedCollection* collection);
    /// The value of a property that has none.
    ///
    /// | Type | Required | Optional |
    /// |---|---|---|
    /// | a class | an empty handle | the same |
    /// | a data type with a serializer | the serializer's default value | its absent one |
    /// | a data type without, outside the registry | a reflective value | an absent one |
    /// | all others, by their serializer | its default value | its absent one |
    ///
    /// \throws tarnkiln::messages::InvalidValue  if a type of the last row, or a data type of the
    ///     registry, has no serializer.
    /// \throws std::bad_cast  for an enumeration without literals.
    static Value createEmptyValue(meta::Type const& type, bool required);
    /// The same for the property's type, required if the lower bound is 1.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the type) if the
    ///     property has many values.
    static Value createEmptyValue(meta::Property const& property);

    Value(Value const& other) = default;
    /// Leaves the other value without payload, but of the same type and shape.
    Value(Value&& other) noexcept = default;
    ~Value() = default;
    Value& operator=(Value const& other);
    /// Swaps the payloads and copies type and shape, which the other value keeps.
    Value& operator=(Value&& other) noexcept;
    /// @}

    /// Equal payloads of the same type and shape; managed collections are equal if they are the
    /// same object. Key type, `isReflective` and `isManaged` do not matter.
    bool operator==(Value const& other) const;

    /// \name Reading
    /// @{
    /// The payload as a `T`; the default of `T` if there is none.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type) as `checkCompatible` does, if a collection is asked for and there is none, and if
    ///     the element held is not a `T`.
    template <class T>
    requires support::Payload<T> || support::CollectionReference<T> T getValue()
    const;

    /// Fails unless the value may be read as a `T`, its payload aside.
    ///
    /// | T | Shape | Type |
    /// |---|---|---|
    /// | scalar | `Single` | the standard type of `T`; for `long` also an enumeration |
    /// | `boost::optional` of a scalar | `Single` or `OptionalSingle` | the standard type |
    /// | element handle | `Single` or `OptionalSingle` | a live class that extends `T`'s |
    /// | `Model` | `Single` or `OptionalSingle` | that of model values or the class `Model` |
    /// | `std::vector`, `std::set` | `Sequence`, `Set`; unmanaged | as for an entry |
    /// | `ReferenceCollection&` | a managed collection | a class |
    /// | `AbstractPrimitiveCollection&` | a managed collection | not a class |
    /// | `StringToStringMap&` | `Single` | `StringToStringMap` |
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type)
    template <class T>
    requires support::Payload<T> || support::CollectionReference<T>
    void checkCompatible() const;

    /// The number that stands for a literal: the payload of an enumeration value or of an `Integer`
    /// value, optional or not; none if there is no payload.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type) if it is of another type or shape.
    boost::optional<long> getEnumNumber() const;

    /// The entries as `Single` values. A `Single` value is its own entry; an `OptionalSingle` one
    /// has none, whatever it holds.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the value's
    ///     type) for a managed collection that is null or of references, and for an unmanaged one
    ///     that was assigned to a value of another kind.
    std::vector<Value> extractEntryValues() const;

    /// The fields of a value of a data type, whichever form it has.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the class of
    /// data
    ///     types) if it is of another type, or of one that has no serializer.
    /// \throws tarnkiln::messages::InvalidValue  if it is reflective and absent.
    ReflectiveDataType toReflectiveDataType() const;

    /// Whether there is no payload; never so for a value that holds an empty handle.
    bool isAbsent() const { return !m_payload.address(); }
    /// @}

    /// \name Properties
    /// @{
    /// Fails unless the value can be the value of `property`. A class must extend the property's,
    /// any other type must be the same. The shape must be the same, but a `Single` value suits an
    /// optional property too, and an absent value of any type suits an optional enumeration.
    ///
    /// \throws tarnkiln::messages::InvalidValue  if `property` or its type is not live.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the property's
    ///     type) if the type does not suit.
    /// \throws tarnkiln::messages::InvalidValue  if the shape does not suit.
    void checkCompatibleWithProperty(meta::Property const& property) const;
    /// Whether `checkCompatibleWithProperty` does not fail.
    bool isCompatibleWithProperty(meta::Property const& property) const;
    /// @}

private:
    template <class T> friend struct support::ValueAccess;
    friend struct support::PayloadAccess;

    using Extractor = std::vector<Value> (*)(Value const&);

    /// Without payload and functions.
    Value(ValueMeta const& meta, std::nullptr_t) : ValueMeta(meta) {}
    Value(meta::Type const& type, ValueFlags flags, std::nullptr_t) : ValueMeta(type, flags) {}

    /// `type`, with the registry started before it is read.
    static meta::Type const& started(meta::Type const& type);
    static meta::Type typeOf(meta::Property const& property);
    /// An element of a class that extends `required`, as a value of `property`.
    static Value createReference(meta::Property const& property, ModelElement const& element,
                                 meta::Class const& required);

    [[noreturn]] void failCast() const;
    void storeElement(ModelElement const& element, meta::Class const& required);
    void checkElement(meta::Class const& required) const;
    /// Null if there is no payload.
    ModelElement const* element() const;
    /// The payload as a `T`; null if there is none. Fails if it is something else.
    template <class T> T const* payload() const;

    ValuePayload m_payload;
    Extractor m_extractor = nullptr;  ///< Not null only for an unmanaged collection.
};

/// Shows type, shape unless it is `Single`, and contents to people, texts in quotes and all else in
/// its text form.
///
///     String "Emma"
///     OptionalSingle of Integer, absent
///     Sequence of Integer {3, 5}
///
/// Long collections are cut. Resolves and loads nothing, and may change with versions. What the
/// serializer of a client's type raises passes.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, Value const& value);

template <support::Payload T>
Value::Value(meta::Type const& type, T const& payload)
    : Value(started(type), ValueFlags::Single, nullptr)
{
    if constexpr (support::ElementReference<T>)
        storeElement(payload, T::metaClass());
    else
    {
        support::ValueAccess<T>::store(*this, payload);
        checkCompatible<T>();
    }
}

template <support::PlainPayload T>
Value Value::createPrimitiveValue(meta::Property const& property, T const& payload)
{
    return Value(typeOf(property), payload);
}

template <support::ElementReference T>
Value Value::createElementValue(meta::Property const& property, T const& element)
{
    return createReference(property, element, T::metaClass());
}

template <class T>
requires support::Payload<T> || support::CollectionReference<T>
void Value::checkCompatible() const
{
    if constexpr (support::ElementReference<T>)
        checkElement(T::metaClass());
    else
        support::ValueAccess<T>::check(*this);
}

template <class T>
requires support::Payload<T> || support::CollectionReference<T> T Value::getValue()
const
{
    checkCompatible<T>();
    if constexpr (support::ElementReference<T>)
    {
        ModelElement const* const held = element();
        if (!held || !held->getElementImpl())
            return T();
        T const result = T::cast(*held);
        if (!result.getElementImpl())
            failCast();
        return result;
    }
    else
        return support::ValueAccess<T>::read(*this);
}
}  // namespace tarn::kiln
