#include "tarnkiln/collections/StringToStringMap.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <algorithm>
#include <iterator>

namespace tarn::kiln {

StringToStringMap::StringToStringMap(ModelElement::Impl* owner, Feature const& feature)
    : AbstractOwnedCollection(owner, feature)
{}

StringToStringMap::~StringToStringMap() = default;

bool StringToStringMap::operator==(StringToStringMap const& other) const
{
    return size() == other.size() && std::all_of(begin(), end(), [&](auto const& entry) {
               auto const place = other.find(entry.first);
               return place != other.end() && place->second == entry.second;
           });
}

void StringToStringMap::insert(ustring const& key, ustring const& value,
                               CollisionResolution resolution)
{
    if (isOwnerDead())
        return;
    auto const [first, last] = m_entries.equal_range(key);
    if (std::any_of(first, last, [&](auto const& entry) { return entry.second == value; }))
        return;
    bool const collides = first != last;
    if (collides && resolution == Keep)
        return;
    if (collides && resolution == Fail)
        reportException(tarnkiln::messages::UniquenessConstraint());

    Operation operation(*this);
    modifying();
    if (collides && resolution == Replace)
        first->second = value;
    else
        m_entries.emplace(key, value);
    operation.commit();
}

StringToStringMap::const_iterator StringToStringMap::erase(const_iterator position)
{
    if (isOwnerDead())
        return position;
    Operation operation(*this);
    modifying();
    const_iterator const next = m_entries.erase(position);
    operation.commit();
    return next;
}

void StringToStringMap::erase(const_iterator first, const_iterator last)
{
    if (isOwnerDead())
        return;
    Operation operation(*this);
    modifying();
    m_entries.erase(first, last);
    operation.commit();
}

std::size_t StringToStringMap::erase(ustring const& key)
{
    if (isOwnerDead())
        return 0;
    auto const [first, last] = m_entries.equal_range(key);
    if (first == last)
        return 0;
    auto const count = static_cast<std::size_t>(std::distance(first, last));
    erase(first, last);
    return count;
}

void StringToStringMap::clear()
{
    if (isOwnerDead())
        return;
    Operation operation(*this);
    modifying();
    m_entries.clear();
    operation.commit();
}

void StringToStringMap::assign(StringToStringMap const& other)
{
    Entries copy = other.m_entries;
    Operation operation(*this);
    modifying();
    m_entries.swap(copy);
    operation.commit();
}

void StringToStringMap::merge(StringToStringMap const& other)
{
    if (isOwnerDead())
        return;
    Entries const added = other.m_entries;
    Operation operation(*this);
    modifying();
    for (auto const& [key, value] : added)
    {
        auto const place = m_entries.find(key);
        if (place != m_entries.end())
            place->second = value;
        else
            m_entries.emplace(key, value);
    }
    operation.commit();
}

meta::Type StringToStringMap::getCollectionType() const
{
    return meta::StandardTypes::stringMeta;
}

void StringToStringMap::copyContents(AbstractOwnedCollection const& other)
{
    assign(static_cast<StringToStringMap const&>(other));
}
}  // namespace tarn::kiln
