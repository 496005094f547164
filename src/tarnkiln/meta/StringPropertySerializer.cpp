#include "tarnkiln/meta/StringPropertySerializer.h"

namespace tarn::kiln::meta {

StringPropertySerializer::~StringPropertySerializer() = default;

ustring StringPropertySerializer::doSerializeValue(ustring const& value) const
{
    return value;
}

ustring StringPropertySerializer::doParseValue(ustring const& text) const
{
    return text;
}
}  // namespace tarn::kiln::meta
