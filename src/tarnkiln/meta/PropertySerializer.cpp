#include "tarnkiln/meta/PropertySerializer.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/reportException.h"

namespace tarn::kiln::meta {

PropertySerializer::~PropertySerializer() = default;

boost::optional<ustring> PropertySerializer::serializeOptionalValue(Value const&) const
{
    return boost::none;
}

Value PropertySerializer::toOptionalValue(Value const& value) const
{
    return value;
}

Value PropertySerializer::parseOptionalValue(ustring const& text, Type const& type) const
{
    return parseValue(text, type);
}

void PropertySerializer::releaseValue(Value&&, Type const&) const {}

Value PropertySerializer::combineAsUnmanagedSequenceValue(Type const&,
                                                          std::vector<Value> const&) const
{
    reportException(tarnkiln::messages::InvalidValue());
}

Value PropertySerializer::combineAsUnmanagedSetValue(Type const&, std::vector<Value> const&) const
{
    reportException(tarnkiln::messages::InvalidValue());
}
}  // namespace tarn::kiln::meta
