#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"
#include "tarnkiln/meta/internal/LocalTime.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <ctime>
#include <exception>

namespace tarn::kiln::meta {

using internal::TypeKind;

namespace {

bool isRandom(Type const& type, ustring const& text)
{
    return type == StandardTypes::uuidMeta && text == u"random";
}

bool isNow(Type const& type, ustring const& text)
{
    return type == StandardTypes::dateTimeMeta && text == u"now";
}

boost::optional<Value> absentValueOf(Property const& property)
{
    try
    {
        return Value::createEmptyValue(property);
    }
    catch (std::exception const&)
    {
        return boost::none;
    }
}

boost::optional<Value> literalOf(Enum const& enumeration, ustring const& name)
{
    EnumLiteral const literal = enumeration->getLiterals().find(name);
    return literal ? boost::make_optional(Value::createEnumValue(literal)) : boost::none;
}
}  // namespace

ustring Property::Impl::identifier() const
{
    StructuredType const owner = getOwningType();
    return owner ? owner->getQualifiedName() + u"." + getName() : getName();
}

bool Property::Impl::isDynamicDefault() const
{
    StandardTypes::ensureInitialized();
    return m_defaultValue &&
           (isRandom(getType(), *m_defaultValue) || isNow(getType(), *m_defaultValue));
}

boost::optional<Value> Property::Impl::defaultValue() const
{
    StandardTypes::ensureInitialized();
    Type const type = getType();
    if (getUpper() >= 2 || !type)
        return boost::none;
    TypeKind const kind = internal::kindOf(type);
    if (kind == TypeKind::Class || kind == TypeKind::DataType ||
        type == StandardTypes::hostArrayMeta)
        return boost::none;
    if (!m_defaultValue)
        return absentValueOf(Property(const_cast<Impl*>(this)));

    ustring const& text = *m_defaultValue;
    if (kind == TypeKind::Enum)
        return literalOf(Enum::cast(type), text);
    if (isRandom(type, text))
        return Value(type, generateNewUuid());
    if (isNow(type, text))
        return Value(type, internal::toLocalTime(std::time(nullptr)));
    auto const parsed = PropertySerializerRegistry::getInstance().parseInAnyFlavour(text, type);
    return parsed ? boost::make_optional(parsed->first) : boost::none;
}
}  // namespace tarn::kiln::meta
