#include "tarnkiln/collections/ReflectiveDataTypeCollection.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <algorithm>
#include <iterator>
#include <type_traits>

namespace tarn::kiln {

using tarnkiln::messages::CannotCastIncompatibleTypes;

namespace {

[[noreturn]] void failCast(meta::Type const& type)
{
    reportException(CannotCastIncompatibleTypes(internal::qualifiedName(type)));
}

ReflectiveDataType const& entryOf(ReflectiveDataType const& entry)
{
    return entry;
}

template <class K>
ReflectiveDataType const& entryOf(std::pair<K const, ReflectiveDataType> const& entry)
{
    return entry.second;
}

/// Keys of an enumeration are the numbers of its literals.
template <class K> K keyOfValue(Value const& value)
{
    if constexpr (std::is_same_v<K, int>)
    {
        if (internal::isEnumType(value.getType()))
            return static_cast<int>(value.getValue<long>());
    }
    return value.getValue<K>();
}

template <class K> Value valueOfKey(K const& key, meta::Type const& type)
{
    if constexpr (std::is_same_v<K, int>)
    {
        if (internal::isEnumType(type))
            return Value(type, static_cast<long>(key));
    }
    return Value(type, key);
}
}  // namespace

template <class Container>
ReflectiveDataTypeCollection<Container>::ReflectiveDataTypeCollection(
    meta::DataType const& dataType, ModelElement const& owner, meta::Property const& property)
    : AbstractPrimitiveCollection(owner.getImpl(), property),
      m_dataType(dataType)
{}

template <class Container>
void ReflectiveDataTypeCollection<Container>::copyContents(AbstractOwnedCollection const& other)
{
    Container copy = static_cast<ReflectiveDataTypeCollection const&>(other).m_entries;
    modifying();
    m_entries.swap(copy);
}

template <class Container> void ReflectiveDataTypeCollection<Container>::clear()
{
    if (isOwnerDead())
        return;
    modifying();
    m_entries.clear();
}

template <class Container>
std::vector<Value> ReflectiveDataTypeCollection<Container>::getAllValues() const
{
    std::vector<Value> result;
    result.reserve(m_entries.size());
    for (auto const& entry : m_entries)
        result.push_back(Value::createReflectiveDataTypeValue(entryOf(entry)));
    return result;
}

template <class Container>
void ReflectiveDataTypeCollection<Container>::checkEntry(Value const& value) const
{
    if (value.getFlags() > ValueFlags::Single || value.getType() != m_dataType)
        failCast(m_dataType);
}

ReflectiveDataTypeSequence::ReflectiveDataTypeSequence(meta::DataType const& dataType,
                                                       ModelElement const& owner,
                                                       meta::Property const& property)
    : ReflectiveDataTypeCollection(dataType, owner, property)
{}

ReflectiveDataTypeSequence::~ReflectiveDataTypeSequence() = default;

void ReflectiveDataTypeSequence::genericAdd(Value const& value)
{
    genericInsert(value, m_entries.size());
}

void ReflectiveDataTypeSequence::genericRemove(Value const& value)
{
    Position const place = positionOf(value);
    if (place != m_entries.end())
        genericRemoveAt(static_cast<unsigned long>(place - m_entries.begin()));
}

GenericPrimitiveInterface* ReflectiveDataTypeSequence::getGenericInterface() const
{
    return const_cast<ReflectiveDataTypeSequence*>(this);
}

Value ReflectiveDataTypeSequence::genericAt(unsigned long index)
{
    return Value::createReflectiveDataTypeValue(m_entries[index]);
}

void ReflectiveDataTypeSequence::genericInsert(Value const& value, unsigned long index)
{
    checkEntry(value);
    if (isOwnerDead())
        return;
    modifying();
    m_entries.insert(m_entries.begin() + static_cast<std::ptrdiff_t>(index),
                     value.toReflectiveDataType());
}

void ReflectiveDataTypeSequence::genericReplace(Value const& value, unsigned long index)
{
    checkEntry(value);
    if (isOwnerDead())
        return;
    modifying();
    m_entries[index] = value.toReflectiveDataType();
}

void ReflectiveDataTypeSequence::genericRemoveAt(unsigned long index)
{
    if (isOwnerDead())
        return;
    modifying();
    m_entries.erase(m_entries.begin() + static_cast<std::ptrdiff_t>(index));
}

int ReflectiveDataTypeSequence::genericIndexOf(Value const& value) const
{
    Position const place = positionOf(value);
    return place == m_entries.end() ? -1 : static_cast<int>(place - m_entries.begin());
}

ReflectiveDataTypeSequence::Position
ReflectiveDataTypeSequence::positionOf(Value const& value) const
{
    checkEntry(value);
    return std::find(m_entries.begin(), m_entries.end(), value.toReflectiveDataType());
}

template <class K>
ReflectiveDataTypeAssociative<K>::ReflectiveDataTypeAssociative(meta::DataType const& dataType,
                                                                meta::Property const& qualifier,
                                                                ModelElement const& owner,
                                                                meta::Property const& property,
                                                                bool qualificationUnique)
    : Base(dataType, owner, property),
      m_qualifier(qualifier),
      m_qualificationUnique(qualificationUnique)
{}

template <class K> ReflectiveDataTypeAssociative<K>::~ReflectiveDataTypeAssociative() = default;

template <class K> void ReflectiveDataTypeAssociative<K>::genericAdd(Value const& value)
{
    Base::checkEntry(value);
    ReflectiveDataType const entry = value.toReflectiveDataType();
    K const key = keyOf(entry);
    if (Base::isOwnerDead() || (m_qualificationUnique && m_entries.contains(key)))
        return;
    Base::modifying();
    m_entries.emplace(key, entry);
}

template <class K> void ReflectiveDataTypeAssociative<K>::genericRemove(Value const& value)
{
    Base::checkEntry(value);
    ReflectiveDataType const entry = value.toReflectiveDataType();
    if (Base::isOwnerDead())
        return;
    auto [place, end] = m_entries.equal_range(keyOf(entry));
    while (place != end)
    {
        if (place->second == entry)
        {
            Base::modifying();
            place = m_entries.erase(place);
            if (place == end)
                break;
        }
        // Behind an erased entry this is one step too many, and clients rely on it.
        ++place;
    }
}

template <class K>
GenericPrimitiveInterface* ReflectiveDataTypeAssociative<K>::getGenericInterface() const
{
    return const_cast<ReflectiveDataTypeAssociative*>(this);
}

template <class K>
std::vector<Value> ReflectiveDataTypeAssociative<K>::genericFind(Value const& key)
{
    std::vector<Value> result;
    auto const [begin, end] = m_entries.equal_range(keyOfValue<K>(key));
    for (auto place = begin; place != end; ++place)
        result.push_back(Value::createReflectiveDataTypeValue(place->second));
    return result;
}

template <class K> std::vector<Value> ReflectiveDataTypeAssociative<K>::genericKeys() const
{
    meta::Type const type = getKeyType();
    std::vector<Value> result;
    for (auto place = m_entries.begin(); place != m_entries.end();
         place = m_entries.upper_bound(place->first))
        result.push_back(valueOfKey(place->first, type));
    return result;
}

template <class K> meta::Type ReflectiveDataTypeAssociative<K>::getKeyType() const
{
    return m_qualifier->getType();
}

template <class K> K ReflectiveDataTypeAssociative<K>::keyOf(ReflectiveDataType const& entry) const
{
    return keyOfValue<K>(entry.getPropertyValue(m_qualifier));
}

template class ReflectiveDataTypeCollection<std::vector<ReflectiveDataType>>;
#define TARNKILN_DEFINE(K)                                                                         \
    template class ReflectiveDataTypeCollection<std::multimap<K, ReflectiveDataType>>;             \
    template class ReflectiveDataTypeAssociative<K>;
TARNKILN_FOR_EACH_DATATYPE_KEY(TARNKILN_DEFINE)
#undef TARNKILN_DEFINE
}  // namespace tarn::kiln
