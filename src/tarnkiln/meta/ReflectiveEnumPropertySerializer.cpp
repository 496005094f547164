#include "tarnkiln/meta/ReflectiveEnumPropertySerializer.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/support/CarriedValue.h"

#include <typeinfo>

namespace tarn::kiln::meta {
namespace {

Enum enumerationOf(Type const& type)
{
    Enum const enumeration = Enum::cast(type);
    if (!enumeration)
        reportException(
            tarnkiln::messages::CannotCastIncompatibleTypes(internal::qualifiedName(type)));
    return enumeration;
}
}  // namespace

ReflectiveEnumPropertySerializer::~ReflectiveEnumPropertySerializer() = default;

ustring ReflectiveEnumPropertySerializer::serializeValue(Value const& value) const
{
    return m_form.textOf(enumerationOf(value.getType()), value.getValue<long>());
}

Value ReflectiveEnumPropertySerializer::parseValue(ustring const& text, Type const& type) const
{
    return Value::createEnumValue(m_form.literalOf(enumerationOf(type), text));
}

Value ReflectiveEnumPropertySerializer::createEmptyOptionalValue(Type const&) const
{
    StandardTypes::ensureInitialized();
    return support::CarriedValue<int>::makeAbsent(StandardTypes::integerMeta);
}

Value ReflectiveEnumPropertySerializer::createDefaultValue(Type const& type) const
{
    for (auto const& [name, literal] : enumerationOf(type)->getLiterals())
    {
        if (literal)
            return Value::createEnumValue(literal);
    }
    throw std::bad_cast();
}

ReflectiveEnumPropertySerializerAsName::ReflectiveEnumPropertySerializerAsName()
    : ReflectiveEnumPropertySerializer(support::EnumText::NAME)
{}

ReflectiveEnumPropertySerializerAsName::~ReflectiveEnumPropertySerializerAsName() = default;

ReflectiveEnumPropertySerializerAsValue::ReflectiveEnumPropertySerializerAsValue()
    : ReflectiveEnumPropertySerializer(support::EnumText::VALUE)
{}

ReflectiveEnumPropertySerializerAsValue::~ReflectiveEnumPropertySerializerAsValue() = default;

ReflectiveEnumPropertySerializerAsPublicId::ReflectiveEnumPropertySerializerAsPublicId()
    : ReflectiveEnumPropertySerializer(support::EnumText::PUBLIC_ID)
{}

ReflectiveEnumPropertySerializerAsPublicId::~ReflectiveEnumPropertySerializerAsPublicId() = default;
}  // namespace tarn::kiln::meta
