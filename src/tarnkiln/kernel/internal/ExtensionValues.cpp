#include "tarnkiln/kernel/internal/ExtensionValues.h"

#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/meta/ExtensionImpl.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln::internal {

ExtensionValues::Entry* ExtensionValues::place(meta::Extension const& extension)
{
    for (Entry& entry : m_entries)
    {
        if (entry.extension == extension)
            return &entry;
    }
    return nullptr;
}

ExtensionValues::DynamicValue* ExtensionValues::find(meta::Extension const& extension)
{
    Entry* const entry = place(extension);
    return entry && !entry->value.isEmpty() ? &entry->value : nullptr;
}

void ExtensionValues::reserve(meta::Extension const& extension)
{
    if (!place(extension))
        m_entries.push_back({extension, DynamicValue()});
}

void ExtensionValues::put(meta::Extension const& extension, DynamicValue value)
{
    if (Entry* const entry = place(extension))
        entry->value.swap(value);
    else
        m_entries.push_back({extension, std::move(value)});
}

// What dies in the functions below may ask for the values of this element again.

void ExtensionValues::reset(meta::Extension const& extension) noexcept
{
    if (Entry* const entry = place(extension))
        DynamicValue const dropped = std::move(entry->value);
}

void ExtensionValues::eraseNamesakes(ustring const& name, meta::Extension const& present) noexcept
{
    auto const isStale = [&](Entry const& entry) {
        return entry.extension != present && entry.extension->getName() == name;
    };
    for (;;)
    {
        auto const found = std::find_if(m_entries.begin(), m_entries.end(), isStale);
        if (found == m_entries.end())
            return;
        Entry const dropped = std::move(*found);
        m_entries.erase(found);
    }
}

void ExtensionValues::resetAll() noexcept
{
    for (std::size_t i = 0; i < m_entries.size(); ++i)
        DynamicValue const dropped = std::move(m_entries[i].value);
}

void ExtensionValues::dropReferences() noexcept
{
    for (std::size_t i = 0; i < m_entries.size(); ++i)
    {
        if (!m_entries[i].value.refersToElements())
            continue;
        if (AbstractOwnedCollection* const collection = m_entries[i].value.getCollection())
            collection->basicDropContents();
        else
            DynamicValue const dropped = std::move(m_entries[i].value);
    }
}

void ExtensionValues::replaceExtension(meta::Extension const& before,
                                       meta::Extension const& after) noexcept
{
    Entry* const entry = place(before);
    if (!entry)
        return;
    entry->extension = after;
    if (AbstractOwnedCollection* const collection = entry->value.getCollection())
        collection->basicSetProperty(after);
}
}  // namespace tarn::kiln::internal
