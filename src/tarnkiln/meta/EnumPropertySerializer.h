/// \file
/// The text forms of enumerations that have a C++ type.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/support/EnumText.h"

namespace tarn::kiln::meta {

/// Writes and reads the literals of the enumeration that it is made for. The default is `E()`.
///
/// \tparam E  the C++ enumeration, with the numbers of the literals.
template <class E> class EnumPropertySerializer : public DefaultPropertySerializer<E>
{
protected:
    EnumPropertySerializer(Type const& enumeration, support::EnumText const& form)
        : DefaultPropertySerializer<E>(enumeration),
          m_form(form)
    {}

    // DefaultPropertySerializer
    ustring doSerializeValue(E const& value) const override
    {
        return m_form.textOf(Enum::cast(this->getType()), static_cast<long>(value));
    }
    E doParseValue(ustring const& text) const override
    {
        return static_cast<E>(m_form.literalOf(Enum::cast(this->getType()), text)->getValue());
    }

private:
    support::EnumText const& m_form;
};

/// Writes the name of a literal.
template <class E> class EnumPropertySerializerAsName final : public EnumPropertySerializer<E>
{
public:
    explicit EnumPropertySerializerAsName(Type const& enumeration)
        : EnumPropertySerializer<E>(enumeration, support::EnumText::NAME)
    {}
};

/// Writes the number of a literal.
template <class E> class EnumPropertySerializerAsValue final : public EnumPropertySerializer<E>
{
public:
    explicit EnumPropertySerializerAsValue(Type const& enumeration)
        : EnumPropertySerializer<E>(enumeration, support::EnumText::VALUE)
    {}
};

/// Writes the public identifier of a literal, or its name where there is none; reads identifiers
/// only.
template <class E> class EnumPropertySerializerAsPublicId final : public EnumPropertySerializer<E>
{
public:
    explicit EnumPropertySerializerAsPublicId(Type const& enumeration)
        : EnumPropertySerializer<E>(enumeration, support::EnumText::PUBLIC_ID)
    {}
};
}  // namespace tarn::kiln::meta
