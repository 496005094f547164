/// \file
/// The text forms of enumerations that have no serializers of their own.
#pragma once
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/support/EnumText.h"

namespace tarn::kiln::meta {

/// Serves every enumeration: it takes the literals from the type of the value or that of the call.
/// A type that is no enumeration is refused as a value of another type is. Of many values it makes
/// no collection.
///
/// An absent value has the type `Integer`. The default is the first literal by name.
class TARNKILN_EXPORT ReflectiveEnumPropertySerializer : public PropertySerializer
{
public:
    ~ReflectiveEnumPropertySerializer() override;

    // PropertySerializer
    ustring serializeValue(Value const& value) const override;
    Value parseValue(ustring const& text, Type const& type) const override;
    Value createEmptyOptionalValue(Type const& type) const override;
    /// \throws std::bad_cast  if the enumeration has no literals.
    Value createDefaultValue(Type const& type) const override;

protected:
    explicit ReflectiveEnumPropertySerializer(support::EnumText const& form) : m_form(form) {}

private:
    support::EnumText const& m_form;
};

/// Writes the name of a literal.
class TARNKILN_EXPORT ReflectiveEnumPropertySerializerAsName final
    : public ReflectiveEnumPropertySerializer
{
public:
    ReflectiveEnumPropertySerializerAsName();
    ~ReflectiveEnumPropertySerializerAsName() override;
};

/// Writes the number of a literal.
class TARNKILN_EXPORT ReflectiveEnumPropertySerializerAsValue final
    : public ReflectiveEnumPropertySerializer
{
public:
    ReflectiveEnumPropertySerializerAsValue();
    ~ReflectiveEnumPropertySerializerAsValue() override;
};

/// Writes the public identifier of a literal, or its name where there is none; reads identifiers
/// only.
class TARNKILN_EXPORT ReflectiveEnumPropertySerializerAsPublicId final
    : public ReflectiveEnumPropertySerializer
{
public:
    ReflectiveEnumPropertySerializerAsPublicId();
    ~ReflectiveEnumPropertySerializerAsPublicId() override;
};
}  // namespace tarn::kiln::meta
