/// \file
/// A keyed collection with any number of elements a key.
#pragma once
#include "tarnkiln/collections/GenericMultimapInterface.h"
#include "tarnkiln/collections/ReferenceAssociativeContainer.h"

#include <map>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln {

/// References by key; elements of one key stand in the order in which they came.
template <class K, class T>
class TARNKILN_EXPORT ElementMultimap
    : public ReferenceAssociativeContainer<K, T, std::multimap<K, T, support::TotalLess<K>>>
{
    using Base = ReferenceAssociativeContainer<K, T, std::multimap<K, T, support::TotalLess<K>>>;

public:
    class MyGenericInterface;
    using typename Base::KeyExtractor;

    /// \param owner     null makes a snapshot.
    /// \param opposite  none, if there is no other end.
    ElementMultimap(ModelElement::Impl* owner, KeyExtractor extractor, Feature const& feature,
                    Feature const& opposite)
        : Base(owner, std::move(extractor), feature, opposite),
          m_generic(std::make_unique<MyGenericInterface>(*this))
    {}
    /// With the opposite that `feature` has.
    ElementMultimap(ModelElement::Impl* owner, KeyExtractor extractor, Feature const& feature)
        : ElementMultimap(owner, std::move(extractor), feature, feature.opposite())
    {}

    /// The elements filed under `key`, alive or dead, in the order in which they came.
    std::vector<T> find(K const& key) const
    {
        std::vector<T> result;
        auto const [first, last] = this->m_entries.equal_range(key);
        for (auto place = first; place != last; ++place)
            result.push_back(place->second);
        return result;
    }

    // ReferenceCollection
    GenericCollectionInterface* getGenericInterface() const override { return m_generic.get(); }

private:
    std::unique_ptr<MyGenericInterface> m_generic;
};

/// The view of a multimap for code that knows neither key type nor element class.
template <class K, class T>
class ElementMultimap<K, T>::MyGenericInterface final : public GenericMultimapInterface
{
public:
    explicit MyGenericInterface(ElementMultimap& map) : m_map(map) {}

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

    // GenericMultimapInterface
    std::vector<ModelElement> genericFind(Value const& key) override
    {
        std::vector<T> const found = m_map.find(support::KeyTraits<K>::fromValue(key));
        return {found.begin(), found.end()};
    }
    meta::Type getKeyType() const override { return m_map.getKeyType(); }
    std::vector<Value> genericKeys() const override { return m_map.getKeys(); }

private:
    ElementMultimap& m_map;
};

#define TARNKILN_DECLARE(K)                                                                        \
    extern template class TARNKILN_EXPORT ReferenceAssociativeContainer<                           \
        K, ModelElement, std::multimap<K, ModelElement, support::TotalLess<K>>>;                   \
    extern template class TARNKILN_EXPORT ElementMultimap<K, ModelElement>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
