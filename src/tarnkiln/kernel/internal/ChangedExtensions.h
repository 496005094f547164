/// \file
/// What a change record knows about extension values.
#pragma once
#include "tarnkiln/kernel/DynamicValue.h"
#include "tarnkiln/kernel/internal/ExtensionValues.h"
#include "tarnkiln/meta/Extension.h"

#include <memory>
#include <vector>

namespace tarn::kiln::internal {

/// The extensions that changed on one element, in the order of their first change, and the values
/// that they had before, if the record keeps any.
class ChangedExtensions
{
public:
    using DynamicValue = ModelElement::Impl::DynamicValue;

    struct Entry
    {
        meta::Extension extension;
        DynamicValue old;     ///< Empty in a shallow record.
        bool wasSet = false;  ///< Whether the element itself had `old`, or only by default.
        /// Takes the contents of `old`, if the element has lost its collection when they return.
        std::unique_ptr<AbstractOwnedCollection> spare;
    };

    std::vector<Entry> const& entries() const { return m_entries; }
    /// Null if the extension did not change.
    Entry const* find(meta::Extension const& extension) const;
    /// Takes an entry in, in the place of one for the same extension.
    void keep(Entry entry);
    /// Exchanges the present values of the element for the old ones, as far as the extensions are
    /// still there. Needs no memory that was not there before.
    void swapWith(ExtensionValues& values) noexcept;

private:
    std::vector<Entry> m_entries;
};
}  // namespace tarn::kiln::internal
