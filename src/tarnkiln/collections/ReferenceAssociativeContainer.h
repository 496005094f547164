/// \file
/// What maps and multimaps of elements share.
#pragma once
#include "tarnkiln/collections/KeyTraits.h"
#include "tarnkiln/collections/TotalLess.h"
#include "tarnkiln/collections/TypedReferenceCollectionWithProxies.h"

#include <functional>
#include <map>
#include <type_traits>
#include <utility>
#include <vector>

namespace tarn::kiln {

/// References filed under a key that is read from each element as it enters.
///
/// Nothing files an element anew when its key changes: it stays under the old key, and `erase`,
/// which looks under the new one, misses it. The properties of associations and the names of
/// metamodel elements leave and re-enter their collection around the change. Proxies have no key
/// and stand beside the container.
///
/// Entries are ordered by key; elements under one key stand in the order in which they came.
///
/// \tparam Container  `std::map` or `std::multimap` from `K` to `T`.
template <class K, class T, class Container>
class TARNKILN_EXPORT ReferenceAssociativeContainer
    : public TypedReferenceCollectionWithProxies<T, Container>
{
    using Base = TypedReferenceCollectionWithProxies<T, Container>;

public:
    /// Reads the key from an element. May raise what keeps an element without a key out.
    using KeyExtractor = std::function<K(ModelElement::Impl*)>;
    using key_type = K;
    using mapped_type = T;
    using value_type = typename Container::value_type;
    using const_iterator = typename Container::const_iterator;
    using iterator = const_iterator;

    /// \name Reading: resolved entries only
    /// @{
    std::size_t size() const { return m_entries.size(); }
    bool empty() const { return m_entries.empty(); }
    /// Pairs of key and element, ascending.
    const_iterator begin() const { return m_entries.begin(); }
    const_iterator end() const { return m_entries.end(); }
    std::size_t count(K const& key) const { return m_entries.count(key); }
    /// Whether `element` stands under its present key.
    bool contains(ModelElement const& element) const;
    /// @}

    /// \name Changing: null and destroyed elements are ignored
    /// @{
    /// Files an element, or keeps a proxy, unless it is there.
    ///
    /// \throws tarnkiln::messages::CannotCreateCrossModelAssociation, CircularContainment  if the
    ///     owner may not refer to `element`.
    /// \throws tarnkiln::messages::UniquenessConstraint  if this is a map and its key is taken.
    void insert(T const& element);
    /// Takes out a proxy, or the element if it stands under its present key.
    void erase(ModelElement const& element);
    void clear();
    /// @}

    // ReferenceCollection
    std::vector<ModelElement> getAllValues() const override;

protected:
    ReferenceAssociativeContainer(ModelElement::Impl* owner, KeyExtractor extractor,
                                  Feature const& feature, Feature const& opposite);

    // ReferenceCollection
    void basicAdd(ModelElement const& element) override;
    void basicRemove(ModelElement const& element) override;
    bool insertResolved(ModelElement const& element) override;

    meta::Type getKeyType() const;
    std::vector<Value> getKeys() const;
    /// False for null and destroyed elements; refuses those of a wrong class.
    bool passes(ModelElement const& element) const;

    using Base::m_entries;

private:
    /// Whether a key has one element at most.
    static constexpr bool UNIQUE = std::is_same_v<Container, std::map<K, T, support::TotalLess<K>>>;

    K keyOf(ModelElement const& element) const { return m_extractor(element.getImpl()); }
    const_iterator find(K const& key, ModelElement const& element) const;

    KeyExtractor const m_extractor;
};

template <class K, class T, class Container>
ReferenceAssociativeContainer<K, T, Container>::ReferenceAssociativeContainer(
    ModelElement::Impl* owner, KeyExtractor extractor, Feature const& feature,
    Feature const& opposite)
    : Base(owner, feature, opposite),
      m_extractor(std::move(extractor))
{}

template <class K, class T, class Container>
bool ReferenceAssociativeContainer<K, T, Container>::contains(ModelElement const& element) const
{
    return element && !Base::isProxy(element) && find(keyOf(element), element) != end();
}

template <class K, class T, class Container>
void ReferenceAssociativeContainer<K, T, Container>::insert(T const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    Base::checkCompatibleModel(Base::implOf(element));
    if (Base::isProxy(element))
        return Base::addProxy(element);
    K const key = keyOf(element);
    if (find(key, element) != end())
        return;
    if (UNIQUE && m_entries.contains(key))
        Base::reportUniquenessConstraint();

    T const added = element;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.emplace(key, added);
    Base::linkAdded(added);
    operation.commit();
}

template <class K, class T, class Container>
void ReferenceAssociativeContainer<K, T, Container>::erase(ModelElement const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    if (Base::isProxy(element))
        return Base::removeProxy(element);
    K const key = keyOf(element);
    if (find(key, element) == end())
        return;

    ModelElement const removed = element;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    Base::unlinkRemoved(removed);
    m_entries.erase(find(key, removed));
    operation.commit();
}

template <class K, class T, class Container>
void ReferenceAssociativeContainer<K, T, Container>::clear()
{
    if (Base::isOwnerDead())
        return;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    if (Base::hasUpkeep())
    {
        for (ModelElement const& element : getAllValues())
            Base::unlinkRemoved(element);
    }
    Container released;
    m_entries.swap(released);
    operation.commit();
    Base::clearProxies();
}

template <class K, class T, class Container>
std::vector<ModelElement> ReferenceAssociativeContainer<K, T, Container>::getAllValues() const
{
    std::vector<ModelElement> result;
    result.reserve(m_entries.size());
    for (auto const& [key, element] : m_entries)
        result.push_back(element);
    return result;
}

/// A map keeps the entry of a key that is taken.
template <class K, class T, class Container>
void ReferenceAssociativeContainer<K, T, Container>::basicAdd(ModelElement const& element)
{
    T const added = Base::toEntry(element);
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.emplace(keyOf(added), added);
    operation.commit();
}

template <class K, class T, class Container>
void ReferenceAssociativeContainer<K, T, Container>::basicRemove(ModelElement const& element)
{
    ModelElement const removed = element;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    auto const place = find(keyOf(removed), removed);
    if (place != end())
        m_entries.erase(place);
    operation.commit();
}

template <class K, class T, class Container>
bool ReferenceAssociativeContainer<K, T, Container>::insertResolved(ModelElement const& element)
{
    if (!Base::acceptsElement(element))
        return false;
    std::size_t const before = m_entries.size();
    m_entries.emplace(keyOf(element), T::cast(element));
    return m_entries.size() != before;
}

template <class K, class T, class Container>
meta::Type ReferenceAssociativeContainer<K, T, Container>::getKeyType() const
{
    meta::Property const& property = Base::getCollectionProperty();
    return property ? support::qualifierTypeOf(property) : support::KeyTraits<K>::fallbackType();
}

template <class K, class T, class Container>
std::vector<Value> ReferenceAssociativeContainer<K, T, Container>::getKeys() const
{
    meta::Type const type = getKeyType();
    std::vector<Value> result;
    for (auto place = begin(); place != end(); place = m_entries.upper_bound(place->first))
        result.push_back(support::KeyTraits<K>::toValue(place->first, type));
    return result;
}

template <class K, class T, class Container>
bool ReferenceAssociativeContainer<K, T, Container>::passes(ModelElement const& element) const
{
    if (!element)
        return false;
    Base::checkElementClass(element);
    return true;
}

template <class K, class T, class Container>
typename ReferenceAssociativeContainer<K, T, Container>::const_iterator
ReferenceAssociativeContainer<K, T, Container>::find(K const& key,
                                                     ModelElement const& element) const
{
    auto const [first, last] = std::as_const(m_entries).equal_range(key);
    for (auto place = first; place != last; ++place)
    {
        if (place->second == element)
            return place;
    }
    return end();
}
}  // namespace tarn::kiln
