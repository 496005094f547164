#include "tarnkiln/support/EnumText.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"

#include <boost/lexical_cast.hpp>

#include <typeinfo>

namespace tarn::kiln::support {

using meta::Enum;
using meta::EnumLiteral;

namespace {

EnumLiteral found(EnumLiteral const& literal)
{
    if (!literal)
        throw std::bad_cast();
    return literal;
}

EnumLiteral literalWith(Enum const& enumeration, long number)
{
    int const value = static_cast<int>(number);
    return value == number ? enumeration->findLiteralByValue(value) : EnumLiteral();
}

ustring nameOf(Enum const& enumeration, long number)
{
    EnumLiteral const literal = literalWith(enumeration, number);
    return literal ? literal->getName() : ustring();
}

EnumLiteral literalOfName(Enum const& enumeration, ustring const& text)
{
    return found(enumeration->getLiterals().find(text));
}

ustring digitsOf(Enum const&, long number)
{
    return sill::i18n::to_ustring(boost::lexical_cast<string>(number));
}

EnumLiteral literalOfDigits(Enum const& enumeration, ustring const& text)
{
    return found(
        enumeration->findLiteralByValue(boost::lexical_cast<int>(sill::i18n::to_string(text))));
}

ustring publicIdOf(Enum const& enumeration, long number)
{
    EnumLiteral const literal = literalWith(enumeration, number);
    if (!literal)
        return {};
    return literal->getPublicIdentifier().value_or(literal->getName());
}

EnumLiteral literalOfPublicId(Enum const& enumeration, ustring const& text)
{
    return found(enumeration->findLiteralByPublicIdentifier(text));
}
}  // namespace

constinit EnumText const EnumText::NAME = {nameOf, literalOfName};
constinit EnumText const EnumText::VALUE = {digitsOf, literalOfDigits};
constinit EnumText const EnumText::PUBLIC_ID = {publicIdOf, literalOfPublicId};
}  // namespace tarn::kiln::support
