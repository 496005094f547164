#include "tarnkiln/meta/DatatypeSerializer.h"

namespace tarn::kiln::meta {

DatatypeSerializer::~DatatypeSerializer() = default;

boost::optional<Value> DatatypeSerializer::fromOptionalValue(Value const&) const
{
    return boost::none;
}

Value DatatypeSerializer::toOptionalValue(Value const& value) const
{
    return value;
}
}  // namespace tarn::kiln::meta
