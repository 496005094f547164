/// \file
/// What sequences and sets of plain values share.
#pragma once
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/PrimitiveTraits.h"

#include <utility>
#include <vector>

namespace tarn::kiln {

/// Holds the container.
///
/// \tparam T  a type with `support::PrimitiveTraits`; those of `PrimitiveTypes.h` have it.
template <class T, class Container>
class TARNKILN_EXPORT PrimitiveCollection : public AbstractPrimitiveCollection
{
public:
    using value_type = T;

    bool empty() const { return m_entries.empty(); }
    Container const& getEntries() const { return m_entries; }

    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return support::PrimitiveTraits<T>::type(); }
    void copyContents(AbstractOwnedCollection const& other) override;
    void basicSwapContents(AbstractOwnedCollection& other) noexcept override
    {
        m_entries.swap(static_cast<PrimitiveCollection&>(other).m_entries);
    }
    void basicDropContents() noexcept override { m_entries.clear(); }
    // AbstractPrimitiveCollection
    void clear() override;
    std::size_t size() const override { return m_entries.size(); }
    std::vector<Value> getAllValues() const override;

protected:
    using AbstractPrimitiveCollection::AbstractPrimitiveCollection;

    /// The type of the property, or that of the collection where the property is not known.
    meta::Type getEntryType() const
    {
        meta::Type const declared = getPropertyType();
        return declared ? declared : getCollectionType();
    }

    Container m_entries;
};

template <class T, class Container>
void PrimitiveCollection<T, Container>::copyContents(AbstractOwnedCollection const& other)
{
    Container copy = static_cast<PrimitiveCollection const&>(other).m_entries;
    Operation operation(*this);
    modifying();
    m_entries.swap(copy);
    operation.commit();
}

template <class T, class Container> void PrimitiveCollection<T, Container>::clear()
{
    if (isOwnerDead())
        return;
    Operation operation(*this);
    modifying();
    m_entries.clear();
    operation.commit();
}

template <class T, class Container>
std::vector<Value> PrimitiveCollection<T, Container>::getAllValues() const
{
    meta::Type const type = getCollectionType();
    std::vector<Value> result;
    if (!type)
        return result;
    result.reserve(m_entries.size());
    for (T const& entry : m_entries)
        result.push_back(support::PrimitiveTraits<T>::toValue(entry, type));
    return result;
}
}  // namespace tarn::kiln
