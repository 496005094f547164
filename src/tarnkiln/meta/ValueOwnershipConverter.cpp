#include "tarnkiln/meta/ValueOwnershipConverter.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/MetaRegistry.h"

namespace tarn::kiln::meta {

ValueOwnershipConverter::~ValueOwnershipConverter() = default;

void MetaRegistry::registerOwnershipConverter(Type const& type,
                                              std::unique_ptr<ValueOwnershipConverter> converter)
{
    LockedModel const locked(*this);
    m_converters.emplace(type, std::move(converter));
}

void MetaRegistry::unregisterOwnershipConverter(Type const& type)
{
    LockedModel const locked(*this);
    m_converters.erase(type);
}

Value MetaRegistry::convertValueForOwnership(Value const& value)
{
    ValueOwnershipConverter* const converter = findConverter(value);
    return converter ? converter->convert(value) : value;
}

void MetaRegistry::releaseOwnedValue(Value const& value)
{
    if (ValueOwnershipConverter* const converter = findConverter(value))
        converter->release(value);
}

ValueOwnershipConverter* MetaRegistry::findConverter(Value const& value) const
{
    auto const position = m_converters.find(value.getType());
    return position != m_converters.end() ? position->second.get() : nullptr;
}
}  // namespace tarn::kiln::meta
