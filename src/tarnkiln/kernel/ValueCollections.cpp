/// \file
/// How values hold collections, and what entries they have.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln {
namespace support {
namespace {

bool isManagedCollection(Value const& value)
{
    return value.isManaged() && value.getFlags() > ValueFlags::Single;
}

template <class Collection> bool suits(Value const& value);

template <> bool suits<ReferenceCollection>(Value const& value)
{
    return isManagedCollection(value) && internal::classImpl(value.getType());
}

template <> bool suits<AbstractPrimitiveCollection>(Value const& value)
{
    return isManagedCollection(value) && !internal::classImpl(value.getType());
}

template <> bool suits<StringToStringMap>(Value const& value)
{
    meta::StandardTypes::ensureInitialized();
    return value.getFlags() == ValueFlags::Single && value.getType().getElementImpl() &&
           value.getType() == meta::StandardTypes::stringToStringMapMeta;
}
}  // namespace

template <class Collection> void ValueAccess<Collection&>::check(Value const& value)
{
    if (!suits<Collection>(value))
        value.failCast();
}

template <class Collection> Collection& ValueAccess<Collection&>::read(Value const& value)
{
    // A payload of the value's own is no collection of an element.
    auto* const held = value.m_payload.isOwned()
                           ? nullptr
                           : static_cast<AbstractOwnedCollection*>(value.m_payload.address());
    auto* const collection = dynamic_cast<Collection*>(held);
    if (!collection)
        value.failCast();
    return *collection;
}

template struct TARNKILN_EXPORT ValueAccess<ReferenceCollection&>;
template struct TARNKILN_EXPORT ValueAccess<AbstractPrimitiveCollection&>;
template struct TARNKILN_EXPORT ValueAccess<StringToStringMap&>;
}  // namespace support

std::vector<Value> Value::extractEntryValues() const
{
    if (m_flags == ValueFlags::OptionalSingle)
        return {};
    if (m_flags == ValueFlags::Single)
        return {*this};
    if (m_managed && !internal::classImpl(m_type))
        return getValue<AbstractPrimitiveCollection&>().getAllValues();
    // A managed collection of references gets here and fails: it has no extractor, and one that a
    // former payload left behind finds no container.
    if (!m_extractor)
        failCast();
    return m_extractor(*this);
}
}  // namespace tarn::kiln
