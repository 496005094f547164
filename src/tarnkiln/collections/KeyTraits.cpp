#include "tarnkiln/collections/KeyTraits.h"

#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"

#include <type_traits>

namespace tarn::kiln::support {
namespace {

bool isEnumeration(meta::Type const& type)
{
    return static_cast<bool>(meta::Enum::cast(type));
}
}  // namespace

template <class K> K KeyTraits<K>::fromValue(Value const& value)
{
    // A literal's number travels as unsigned but reads as signed.
    if constexpr (std::is_same_v<K, unsigned long>)
    {
        if (isEnumeration(value.getType()))
            return static_cast<unsigned long>(value.getValue<long>());
    }
    return value.getValue<K>();
}

template <class K> Value KeyTraits<K>::toValue(K const& key, meta::Type const& keyType)
{
    if constexpr (std::is_same_v<K, UUID>)
        return Value(meta::standardTypeOf<UUID>(), key);
    if constexpr (std::is_same_v<K, unsigned long>)
    {
        if (isEnumeration(keyType))
            return Value(keyType, static_cast<long>(key));
    }
    return Value(keyType ? keyType : meta::standardTypeOf<K>(), key);
}

template <class K> meta::Type KeyTraits<K>::fallbackType()
{
    if constexpr (std::is_same_v<K, ustring>)
        return meta::standardTypeOf<K>();
    else
        return {};
}

meta::Type qualifierTypeOf(meta::Property const& collectionProperty)
{
    meta::Property const qualifier = collectionProperty->getQualifiedBy();
    return qualifier ? qualifier->getType() : meta::Type();
}

#define TARNKILN_DEFINE(K) template struct KeyTraits<K>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln::support
