#include "tarnkiln/meta/PropertySerializerDouble.h"

#include "sill/dtoa/NumberConversion.h"

#include <cstddef>
#include <typeinfo>

namespace tarn::kiln::meta {

PropertySerializerDouble::~PropertySerializerDouble() = default;

ustring PropertySerializerDouble::doSerializeValue(double const& value) const
{
    return sill::dtoa::to_ustring(value);
}

double PropertySerializerDouble::doParseValue(ustring const& text) const
{
    return sill::dtoa::detail::strtod<char16_t>(text);
}

PropertySerializerDoubleBackwardsCompatible::~PropertySerializerDoubleBackwardsCompatible() =
    default;

double PropertySerializerDoubleBackwardsCompatible::doParseValue(ustring const& text) const
{
    std::size_t separator = text.find(u',');
    if (separator == ustring::npos)
        separator = text.find(u'/');
    if (separator == ustring::npos)
        throw std::bad_cast();
    ustring number = text;
    number[separator] = u'.';
    return PropertySerializerDouble::doParseValue(number);
}
}  // namespace tarn::kiln::meta
