/// \file
/// The collection that holds the annotations of an element.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"
#include "tarnkiln/kernel/Types.h"

#include <cstddef>
#include <unordered_map>

namespace tarn::kiln {

/// Texts under texts, in no promised order. A key may have several values.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT StringToStringMap : public AbstractOwnedCollection
{
public:
    /// What `insert` does with a key that has another value. Any other number means `Add`.
    enum CollisionResolution : int
    {
        Fail = 0,     ///< Raises `UniquenessConstraint`.
        Keep = 1,     ///< Keeps what is there.
        Replace = 2,  ///< Overwrites the value of the key's first entry.
        Add = 3       ///< Adds a further entry.
    };

    using Entries = std::unordered_multimap<ustring, ustring>;
    using const_iterator = Entries::const_iterator;
    using iterator = const_iterator;

    /// \param owner  null makes a snapshot.
    StringToStringMap(ModelElement::Impl* owner, Feature const& feature);
    ~StringToStringMap() override;

    /// \name Reading
    /// @{
    std::size_t size() const { return m_entries.size(); }
    bool empty() const { return m_entries.empty(); }
    /// Pairs of key and value; those of one key stand together.
    const_iterator begin() const { return m_entries.begin(); }
    const_iterator end() const { return m_entries.end(); }
    /// The first entry of `key`; `end()` if there is none.
    const_iterator find(ustring const& key) const { return m_entries.find(key); }
    std::size_t count(ustring const& key) const { return m_entries.count(key); }
    /// Equal sizes, and for each entry of this map the first one of its key in `other` has the same
    /// value. Danger: with several values under one key that is no equality, since their order
    /// decides.
    bool operator==(StringToStringMap const& other) const;
    /// @}

    /// \name Changing
    /// @{
    /// Adds an entry. Does nothing if the very pair is there, whatever the policy.
    ///
    /// \throws tarnkiln::messages::UniquenessConstraint  if `key` has another value and the policy
    ///     is `Fail`.
    void insert(ustring const& key, ustring const& value, CollisionResolution resolution);
    /// Returns the next position.
    const_iterator erase(const_iterator position);
    void erase(const_iterator first, const_iterator last);
    /// Erases all entries of `key` and returns their number; announces nothing if there is none.
    std::size_t erase(ustring const& key);
    void clear();
    void assign(StringToStringMap const& other);
    void copyValues(StringToStringMap const& other) { assign(other); }
    /// Takes each entry of `other` in, over the value of the first entry of its key if there is
    /// one. Announces a change in any case.
    void merge(StringToStringMap const& other);
    /// @}

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override;
    void copyContents(AbstractOwnedCollection const& other) override;
    void basicSwapContents(AbstractOwnedCollection& other) noexcept override
    {
        m_entries.swap(static_cast<StringToStringMap&>(other).m_entries);
    }
    void basicDropContents() noexcept override { m_entries.clear(); }

private:
    Entries m_entries;
};
}  // namespace tarn::kiln
