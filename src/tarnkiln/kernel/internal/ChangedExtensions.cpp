#include "tarnkiln/kernel/internal/ChangedExtensions.h"

#include "tarnkiln/collections/AbstractOwnedCollection.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln::internal {

ChangedExtensions::Entry const* ChangedExtensions::find(meta::Extension const& extension) const
{
    auto const found = std::find_if(m_entries.begin(), m_entries.end(), [&](Entry const& entry) {
        return entry.extension == extension;
    });
    return found == m_entries.end() ? nullptr : &*found;
}

void ChangedExtensions::keep(Entry entry)
{
    if (auto* const known = const_cast<Entry*>(find(entry.extension)))
        *known = std::move(entry);
    else
        m_entries.push_back(std::move(entry));
}

namespace {

void swapCollection(ChangedExtensions::Entry& entry, ExtensionValues& values)
{
    AbstractOwnedCollection& old = *entry.old.getCollection();
    ExtensionValues::DynamicValue* const present = values.find(entry.extension);
    if (present && present->isCollection())
        present->getCollection()->basicSwapContents(old);
    else if (!present && entry.spare)
    {
        entry.spare->basicSwapContents(old);
        values.put(entry.extension, ExtensionValues::DynamicValue(entry.spare.release()));
    }
}

void swapValue(ChangedExtensions::Entry& entry, ExtensionValues& values)
{
    ExtensionValues::DynamicValue* const present = values.find(entry.extension);
    if (present)
        present->swap(entry.old);
    else if (entry.wasSet)
        values.put(entry.extension, std::move(entry.old));
    if (!entry.wasSet)
        values.reset(entry.extension);
}
}  // namespace

void ChangedExtensions::swapWith(ExtensionValues& values) noexcept
{
    for (Entry& entry : m_entries)
    {
        if (!entry.extension || entry.old.isEmpty())
            continue;
        if (entry.old.isCollection())
            swapCollection(entry, values);
        else
            swapValue(entry, values);
    }
}
}  // namespace tarn::kiln::internal
