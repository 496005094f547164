#include "tarnkiln/kernel/internal/DeclaredExtensions.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln::internal {

namespace {

/// The place of `extension` among the records from `first` to `last`; else `last`.
template <class Iterator>
Iterator findIn(std::pair<Iterator, Iterator> const& range, meta::Extension const& extension)
{
    return std::find_if(range.first, range.second,
                        [&](auto const& entry) { return entry.second.extension == extension; });
}
}  // namespace

std::vector<meta::Extension> DeclaredExtensions::named(ustring const& name) const
{
    std::vector<meta::Extension> result;
    auto const [first, last] = m_records.equal_range(name);
    for (auto place = first; place != last; ++place)
        result.push_back(place->second.extension);
    return result;
}

std::vector<meta::Extension> DeclaredExtensions::all() const
{
    std::vector<meta::Extension> result;
    for (auto const& [name, record] : m_records)
        result.push_back(record.extension);
    return result;
}

DeclaredExtensions::Record const* DeclaredExtensions::find(ustring const& name,
                                                           meta::Extension const& extension) const
{
    auto const range = m_records.equal_range(name);
    auto const place = findIn(range, extension);
    return place == range.second ? nullptr : &place->second;
}

bool DeclaredExtensions::isCurrent(Record const& record) const
{
    if (!record.extension)
        return false;
    auto const* const group = record.extension->getOwnerImpl();
    return group && group->isLive() && group->getModelID() == m_modelCounter &&
           group->getOwningClassImpl() == record.extended.getImpl();
}

DeclaredExtensions::Record const* DeclaredExtensions::findFor(meta::Class const& metaClass,
                                                              ustring const& name) const
{
    Record const* nearest = nullptr;
    if (!metaClass)
        return nearest;
    auto const [first, last] = m_records.equal_range(name);
    for (auto place = first; place != last; ++place)
    {
        Record const& record = place->second;
        if (isCurrent(record) && metaClass->isA(record.extended) &&
            (!nearest || record.extended->isA(nearest->extended)))
            nearest = &record;
    }
    return nearest;
}

void DeclaredExtensions::add(ustring const& name, Record record)
{
    m_records.emplace(name, std::move(record));
}

void DeclaredExtensions::remove(ustring const& name, meta::Extension const& extension)
{
    auto const range = m_records.equal_range(name);
    auto const place = findIn(range, extension);
    if (place != range.second)
        m_records.erase(place);
}
}  // namespace tarn::kiln::internal
