#include "tarnkiln/collections/DataTypeKeys.h"

#include "tarnkiln/collections/QualifierKeys.h"

namespace tarn::kiln {

ReflectiveDataType dataTypeKeyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    Value const value = support::readQualifier(element, qualifier);
    if (value.isAbsent())
        support::reportMissingKey(qualifier);
    return value.toReflectiveDataType();
}

namespace support {

ReflectiveDataType KeyTraits<ReflectiveDataType>::fromValue(Value const& value)
{
    return value.toReflectiveDataType();
}

Value KeyTraits<ReflectiveDataType>::toValue(ReflectiveDataType const& key, meta::Type const&)
{
    return Value::createReflectiveDataTypeValue(key);
}

meta::Type KeyTraits<ReflectiveDataType>::fallbackType()
{
    return {};
}
}  // namespace support
}  // namespace tarn::kiln
