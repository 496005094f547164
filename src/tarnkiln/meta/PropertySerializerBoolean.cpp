#include "tarnkiln/meta/PropertySerializerBoolean.h"

#include <typeinfo>

namespace tarn::kiln::meta {

PropertySerializerBoolean::~PropertySerializerBoolean() = default;

ustring PropertySerializerBoolean::doSerializeValue(bool const& value) const
{
    return value ? u"true" : u"false";
}

bool PropertySerializerBoolean::doParseValue(ustring const& text) const
{
    if (text == u"true")
        return true;
    if (text == u"false")
        return false;
    throw std::bad_cast();
}
}  // namespace tarn::kiln::meta
