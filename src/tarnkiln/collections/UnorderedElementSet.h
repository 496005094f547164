/// \file
/// An unordered collection of references to elements.
#pragma once
#include "tarnkiln/collections/ElementHashSet.h"
#include "tarnkiln/collections/TypedReferenceCollectionWithProxies.h"
#include "tarnkiln/collections/WrapperInterface.h"

#include <algorithm>
#include <memory>
#include <vector>

namespace tarn::kiln {

/// Each element once, in no promised order; proxies in a table beside the set.
///
/// Elements are found by the hash of their UUID. One whose UUID became nil while it was in here is
/// still found, by a scan.
template <class T>
class TARNKILN_EXPORT UnorderedElementSet
    : public TypedReferenceCollectionWithProxies<T, support::ElementHashSet<T>>
{
    using Container = support::ElementHashSet<T>;
    using Base = TypedReferenceCollectionWithProxies<T, Container>;

public:
    using value_type = T;
    using const_iterator = typename Container::const_iterator;
    using iterator = const_iterator;

    /// \param owner     null makes a snapshot.
    /// \param opposite  none, if there is no other end.
    UnorderedElementSet(ModelElement::Impl* owner, Feature const& feature, Feature const& opposite);
    /// With the opposite that `feature` has.
    UnorderedElementSet(ModelElement::Impl* owner, Feature const& feature)
        : UnorderedElementSet(owner, feature, feature.opposite())
    {}

    /// \name Reading: resolved entries only
    /// @{
    std::size_t size() const { return m_entries.size(); }
    bool empty() const { return m_entries.empty(); }
    const_iterator begin() const { return m_entries.begin(); }
    const_iterator end() const { return m_entries.end(); }
    bool contains(ModelElement const& element) const { return find(element) != end(); }
    /// @}

    /// \name Changing: null and destroyed elements are ignored
    /// @{
    /// Adds an element or a proxy, unless it is there.
    ///
    /// \throws tarnkiln::messages::CannotCreateCrossModelAssociation, CircularContainment  if the
    ///     owner may not refer to `element`.
    void insert(T const& element);
    /// Takes out an element or a proxy.
    void erase(ModelElement const& element);
    void clear();
    /// @}

    // ReferenceCollection
    std::vector<ModelElement> getAllValues() const override;
    GenericCollectionInterface* getGenericInterface() const override { return &m_generic; }

protected:
    // ReferenceCollection
    void basicAdd(ModelElement const& element) override;
    void basicRemove(ModelElement const& element) override;
    bool insertResolved(ModelElement const& element) override;

    using Base::m_entries;

private:
    friend class WrapperInterface<UnorderedElementSet>;

    const_iterator find(ModelElement const& element) const;

    mutable WrapperInterface<UnorderedElementSet> m_generic{*this};
};

template <class T>
UnorderedElementSet<T>::UnorderedElementSet(ModelElement::Impl* owner, Feature const& feature,
                                            Feature const& opposite)
    : Base(owner, feature, opposite)
{}

template <class T> void UnorderedElementSet<T>::insert(T const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    Base::checkCompatibleModel(Base::implOf(element));
    if (Base::isProxy(element))
        return Base::addProxy(element);
    if (contains(element))
        return;

    T const added = element;
    AbstractOwnedCollection::Operation operation(*this);
    basicAdd(added);
    Base::linkAdded(added);
    operation.commit();
}

template <class T> void UnorderedElementSet<T>::erase(ModelElement const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    if (Base::isProxy(element))
        return Base::removeProxy(element);
    if (!contains(element))
        return;

    ModelElement const removed = element;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    Base::unlinkRemoved(removed);
    m_entries.erase(find(removed));
    operation.commit();
}

template <class T> void UnorderedElementSet<T>::clear()
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

template <class T> std::vector<ModelElement> UnorderedElementSet<T>::getAllValues() const
{
    return {m_entries.begin(), m_entries.end()};
}

template <class T> void UnorderedElementSet<T>::basicAdd(ModelElement const& element)
{
    T const added = Base::toEntry(element);
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.insert(added);
    operation.commit();
}

template <class T> void UnorderedElementSet<T>::basicRemove(ModelElement const& element)
{
    auto const place = find(element);
    if (place == end())
        return;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    T const released = *place;
    m_entries.erase(find(released));
    operation.commit();
}

template <class T> bool UnorderedElementSet<T>::insertResolved(ModelElement const& element)
{
    return Base::acceptsElement(element) && m_entries.insert(T::cast(element)).second;
}

template <class T>
typename UnorderedElementSet<T>::const_iterator
UnorderedElementSet<T>::find(ModelElement const& element) const
{
    auto const place = m_entries.find(element);
    if (place != end() || !element.getImpl() || !element.getImpl()->getUuid().is_nil())
        return place;
    return std::find_if(begin(), end(), [&](T const& entry) { return entry == element; });
}

extern template class TypedReferenceCollection<ModelElement, support::ElementHashSet<ModelElement>>;
extern template class TypedReferenceCollectionWithProxies<ModelElement,
                                                          support::ElementHashSet<ModelElement>>;
extern template class UnorderedElementSet<ModelElement>;
}  // namespace tarn::kiln
