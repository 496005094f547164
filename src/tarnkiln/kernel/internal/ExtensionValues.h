/// \file
/// The extension values of one element.
#pragma once
#include "tarnkiln/kernel/DynamicValue.h"
#include "tarnkiln/meta/Extension.h"

#include <vector>

namespace tarn::kiln::internal {

/// What an element has set, and the collections that were read from it, by extension.
///
/// An element has one from its first value on; it then holds what the element would hold in its
/// place. Few extensions are set on one element, so they lie in a row. The place of a value that is
/// reset stays, so that a rollback puts it in again without an allocation. There may be values of
/// extensions that are no more, until somebody asks for their name.
///
/// Threads: as the element's model.
class ExtensionValues
{
public:
    using DynamicValue = ModelElement::Impl::DynamicValue;

    struct Entry
    {
        meta::Extension extension;
        DynamicValue value;  ///< Empty if it was reset.
    };

    ExtensionValues() = default;
    ExtensionValues(ExtensionValues const&) = delete;
    ExtensionValues& operator=(ExtensionValues const&) = delete;

    std::vector<Entry> const& entries() const { return m_entries; }
    /// Null if there is none. Lives until the next change.
    DynamicValue* find(meta::Extension const& extension);

    /// Makes a place for a value of `extension`, so that its `put` can not fail.
    void reserve(meta::Extension const& extension);
    /// Enters a value, in the place of one that was there.
    void put(meta::Extension const& extension, DynamicValue value);
    void reset(meta::Extension const& extension) noexcept;
    /// Lets entries go that are of that name and of another extension than `present`.
    void eraseNamesakes(ustring const& name, meta::Extension const& present) noexcept;
    void resetAll() noexcept;
    /// Drops all elements that are held, and empties what collects them.
    void dropReferences() noexcept;
    /// Makes the entry of `before` one of `after`, which has the same type and shape.
    void replaceExtension(meta::Extension const& before, meta::Extension const& after) noexcept;

    support::ModelAnchor* anchor = nullptr;  ///< Of a dead element. Counted by the element.

private:
    Entry* place(meta::Extension const& extension);

    std::vector<Entry> m_entries;
};
}  // namespace tarn::kiln::internal
