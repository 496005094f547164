/// \file
/// A keyed collection with one element a key.
#pragma once
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/ReferenceAssociativeContainer.h"

#include <map>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln {

/// References by key; an element whose key is taken is refused.
///
///     packages = std::make_unique<ElementMap<ustring, Package>>(owner, nameOfPackage, NESTED);
template <class K, class T>
class TARNKILN_EXPORT ElementMap
    : public ReferenceAssociativeContainer<K, T, std::map<K, T, support::TotalLess<K>>>
{
    using Base = ReferenceAssociativeContainer<K, T, std::map<K, T, support::TotalLess<K>>>;

public:
    class MyGenericInterface;
    using typename Base::KeyExtractor;

    /// \param owner     null makes a snapshot.
    /// \param opposite  none, if there is no other end.
    ElementMap(ModelElement::Impl* owner, KeyExtractor extractor, Feature const& feature,
               Feature const& opposite)
        : Base(owner, std::move(extractor), feature, opposite),
          m_generic(std::make_unique<MyGenericInterface>(*this))
    {}
    /// With the opposite that `feature` has.
    ElementMap(ModelElement::Impl* owner, KeyExtractor extractor, Feature const& feature)
        : ElementMap(owner, std::move(extractor), feature, feature.opposite())
    {}

    /// The element filed under `key`, alive or dead; empty if there is none.
    T find(K const& key) const
    {
        auto const place = this->m_entries.find(key);
        return place == this->m_entries.end() ? T() : place->second;
    }

    // ReferenceCollection
    GenericCollectionInterface* getGenericInterface() const override { return m_generic.get(); }

private:
    std::unique_ptr<MyGenericInterface> m_generic;
};

/// The view of a map for code that knows neither key type nor element class.
template <class K, class T>
class ElementMap<K, T>::MyGenericInterface final : public GenericMapInterface
{
public:
    explicit MyGenericInterface(ElementMap& map) : m_map(map) {}

    // GenericCollectionInterface
    std::size_t genericSize() const override { return m_map.size(); }
    void genericAdd(ModelElement const& element) override
    {
        if (m_map.passes(element))
            m_map.insert(T::cast(element));
    }
    void genericRemove(ModelElement const& element) override
    {
        if (m_map.passes(element))
            m_map.erase(element);
    }
    void genericClear() override { m_map.clear(); }
    void genericBasicClear() override { m_map.basicClear(); }

    // GenericMapInterface
    ModelElement genericFind(Value const& key) override
    {
        return m_map.find(support::KeyTraits<K>::fromValue(key));
    }
    meta::Type getKeyType() const override { return m_map.getKeyType(); }
    std::vector<Value> genericKeys() const override { return m_map.getKeys(); }

private:
    ElementMap& m_map;
};

#define TARNKILN_DECLARE(K)                                                                        \
    extern template class TARNKILN_EXPORT ReferenceAssociativeContainer<                           \
        K, ModelElement, std::map<K, ModelElement, support::TotalLess<K>>>;                        \
    extern template class TARNKILN_EXPORT ElementMap<K, ModelElement>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
