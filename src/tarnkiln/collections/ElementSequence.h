/// \file
/// An ordered collection of references to elements.
#pragma once
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/SaturatedBloomFilter.h"
#include "tarnkiln/collections/SequenceEntries.h"
#include "tarnkiln/collections/SequenceIterator.h"
#include "tarnkiln/collections/TypedReferenceCollection.h"

#include <algorithm>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

namespace tarn::kiln {

/// References in the order in which they were put there, proxies among them.
///
/// A proxy is resolved in its place when it is read. A sequence with an opposite is unique,
/// whatever it was told. Positions count from 0 and are trusted.
template <class T>
class TARNKILN_EXPORT ElementSequence : public TypedReferenceCollection<T, support::SequenceEntries>
{
    using Base = TypedReferenceCollection<T, support::SequenceEntries>;

public:
    class GenericSequence;

    using value_type = T;
    using const_iterator = support::SequenceIterator<T>;
    using iterator = const_iterator;

    /// \param owner     null makes a snapshot.
    /// \param unique    whether an element may be in here only once.
    /// \param opposite  none, if there is no other end.
    ElementSequence(ModelElement::Impl* owner, bool unique, Feature const& feature,
                    Feature const& opposite);
    /// With the opposite that `feature` has.
    ElementSequence(ModelElement::Impl* owner, bool unique, Feature const& feature)
        : ElementSequence(owner, unique, feature, feature.opposite())
    {}
    ~ElementSequence() override;

    /// \name Reading
    /// @{
    std::size_t size() const { return m_entries.size(); }  ///< Counts proxies.
    bool empty() const { return m_entries.empty(); }
    bool isUnique() const { return m_unique; }
    /// The entry, resolved in its place if it is a proxy that can be.
    T const& at(std::size_t index) const;
    T const& operator[](std::size_t index) const { return at(index); }
    const_iterator begin() const { return {*this, 0}; }
    const_iterator end() const { return {*this, size()}; }
    /// Whether `element` counts as an entry. In a one-to-many association its own reference to the
    /// owner decides. False for null, destroyed elements and proxies.
    bool contains(ModelElement const& element) const;
    /// The first position of `element`, without resolving any entry; `size()` if it is absent.
    std::size_t indexOf(ModelElement const& element) const;
    /// @}

    /// \name Changing
    /// All but `replace` ignore a null or destroyed element.
    /// @{
    /// Appends, unless the sequence is unique and contains `element`.
    void push_back(T const& element);
    /// Puts `element` before the entry at `index`; returns where it is now. A unique sequence that
    /// holds it is not changed.
    std::size_t insert(std::size_t index, T const& element);
    const_iterator insert(const_iterator const& position, T const& element)
    {
        return {*this, insert(position.index(), element)};
    }
    /// \throws tarnkiln::messages::CannotAddNonExistentObject  if `element` is null or destroyed.
    /// \throws tarnkiln::messages::CannotAddSecondObject  if the sequence is unique and contains
    ///     `element` at another position.
    void replace(std::size_t index, T const& element);
    /// Puts `element` at `index`, moving what is there if it is in here already. Two changes.
    void ensureAt(std::size_t index, T const& element);
    void erase(std::size_t index);
    /// Returns the position of the entry behind the erased one.
    const_iterator erase(const_iterator const& position)
    {
        erase(position.index());
        return position;
    }
    /// Erases the first entry that is `element`, resolving the proxies before it.
    void remove(ModelElement const& element);
    void clear();
    /// Lets the sequence rule out elements by `filter`, which takes in the present entries; null
    /// removes it. Danger: emptying without upkeep and a rollback leave the filter as it was, so
    /// that a restored element may be added a second time.
    void setFilter(std::unique_ptr<SaturatedBloomFilter> filter);
    /// @}

    // ReferenceCollection
    std::vector<ModelElement> getAllValues() const override;
    std::vector<ModelElement> getAllValuesAndProxies() const override;
    GenericCollectionInterface* getGenericInterface() const override;
    void replaceProxy(ModelElement const& element, unsigned long index) override;
    void resolveAll() override;
    void resolveLocal() override;

protected:
    // ReferenceCollection
    void basicAdd(ModelElement const& element) override;
    void basicRemove(ModelElement const& element) override;
    void basicCopyValues(ReferenceCollection const& other) override;
    bool basicContainsProxyTo(ModelElement const& target) override;

    /// Puts `element`, which is live and not an entry, in the place of the entry at `index`.
    virtual void replaceElement(std::size_t index, ModelElement const& element);

    using Base::m_entries;
    using Base::m_owner;

private:
    friend class support::SequenceIterator<T>;

    T const& entryAt(std::size_t index) const { return static_cast<T const&>(m_entries[index]); }
    bool isProxyAt(std::size_t index) const
    {
        return m_entries.mayHoldProxies() && Base::isProxy(m_entries[index]);
    }
    void resolveAt(std::size_t index) const;
    std::size_t find(ModelElement const& element, std::size_t likelyIndex) const;
    std::size_t findForChange(ModelElement const& element) const;
    std::optional<bool> containsWithoutSearch(ModelElement const& element) const;
    bool containsForChange(ModelElement const& element) const;
    void countIn(ModelElement const& element) const;
    void countOut(ModelElement const& element) const;

    bool const m_unique;
    std::unique_ptr<SaturatedBloomFilter> m_filter;  ///< Counts what is in here and no proxy.
    mutable GenericSequence m_generic;
};

/// The view of a sequence for code that knows no element class.
template <class T> class ElementSequence<T>::GenericSequence final : public GenericSequenceInterface
{
public:
    explicit GenericSequence(ElementSequence& sequence) : m_sequence(sequence) {}

    // GenericCollectionInterface
    std::size_t genericSize() const override { return m_sequence.size(); }
    void genericAdd(ModelElement const& element) override
    {
        if (passes(element))
            m_sequence.push_back(T::cast(element));
    }
    void genericEnsureAt(ModelElement const& element, unsigned long index) override
    {
        if (passes(element))
            m_sequence.ensureAt(index, T::cast(element));
    }
    void genericRemove(ModelElement const& element) override
    {
        if (passes(element))
            m_sequence.remove(element);
    }
    void genericClear() override { m_sequence.clear(); }
    void genericBasicClear() override { m_sequence.basicClear(); }

    // GenericSequenceInterface
    ModelElement genericAt(unsigned long index) override { return m_sequence.at(index); }
    void genericInsert(ModelElement const& element, unsigned long index) override
    {
        if (passes(element))
            m_sequence.insert(index, T::cast(element));
    }
    void genericReplace(ModelElement const& element, unsigned long index) override
    {
        passes(element);
        m_sequence.replace(index, T::cast(element));
    }
    void genericRemoveAt(unsigned long index) override { m_sequence.erase(index); }
    int genericIndexOf(ModelElement const& element) const override
    {
        if (!element || !m_sequence.acceptsElement(element))
            return -1;
        std::size_t const index = m_sequence.indexOf(element);
        return index == m_sequence.size() ? -1 : static_cast<int>(index);
    }

private:
    /// False for null and destroyed elements; refuses those of a wrong class.
    bool passes(ModelElement const& element) const
    {
        if (!element)
            return false;
        m_sequence.checkElementClass(element);
        return true;
    }

    ElementSequence& m_sequence;
};

template <class T>
ElementSequence<T>::ElementSequence(ModelElement::Impl* owner, bool unique, Feature const& feature,
                                    Feature const& opposite)
    : Base(owner, feature, opposite),
      m_unique(unique || opposite),
      m_generic(*this)
{}

template <class T> ElementSequence<T>::~ElementSequence() = default;

template <class T> T const& ElementSequence<T>::at(std::size_t index) const
{
    resolveAt(index);
    return entryAt(index);
}

template <class T> bool ElementSequence<T>::contains(ModelElement const& element) const
{
    std::optional<bool> const known = containsWithoutSearch(element);
    return known ? *known : indexOf(element) != size();
}

/// What can be told without a look at the entries.
template <class T>
std::optional<bool> ElementSequence<T>::containsWithoutSearch(ModelElement const& element) const
{
    if (!element || Base::isProxy(element))
        return false;
    if (Base::hasSingleOpposite())
        return Base::isReferredBackBy(element);
    if (m_filter && !m_filter->contains(element.getImpl()->getUuid()))
        return false;
    return std::nullopt;
}

/// The same as `contains`, for an element that is about to be added.
template <class T> bool ElementSequence<T>::containsForChange(ModelElement const& element) const
{
    std::optional<bool> const known = containsWithoutSearch(element);
    return known ? *known : findForChange(element) != size();
}

template <class T> std::size_t ElementSequence<T>::indexOf(ModelElement const& element) const
{
    return m_entries.findFirst(element);
}

template <class T> void ElementSequence<T>::push_back(T const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    Base::checkCompatibleModel(Base::implOf(element));
    if (m_unique && containsForChange(element))
        return;

    T const added = element;
    AbstractOwnedCollection::Operation operation(*this);
    basicAdd(added);
    Base::linkAdded(added);
    operation.commit();
}

template <class T> std::size_t ElementSequence<T>::insert(std::size_t index, T const& element)
{
    if (!element || Base::isOwnerDead())
        return index;
    Base::checkCompatibleModel(Base::implOf(element));
    if (m_unique)
    {
        std::size_t const present = findForChange(element);
        if (present != size())
            return present;
    }

    T const added = element;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    std::size_t const place = std::min(index, size());
    m_entries.insert(place, added);
    Base::linkAdded(added);
    countIn(added);
    operation.commit();
    return find(added, place);
}

template <class T> void ElementSequence<T>::replace(std::size_t index, T const& element)
{
    if (Base::isOwnerDead())
        return;
    resolveAt(index);
    if (element == m_entries[index])
        return;
    if (!element)
        Base::reportCannotAddNonExistentObject();
    if (m_unique && containsForChange(element))
        Base::reportCannotAddSecondObject();
    replaceElement(index, element);
}

template <class T>
void ElementSequence<T>::replaceElement(std::size_t index, ModelElement const& element)
{
    T const added = Base::toEntry(element);
    Base::checkCompatibleModel(Base::implOf(added));
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    resolveAt(index);
    T const removed = entryAt(index);
    if (m_owner && Base::getOpposite())
    {
        if (!Base::isProxy(added))
            m_owner->_callInverseAdd(*Base::implOf(added), Base::getOpposite());
    }
    else
    {
        Base::linkAdded(added);
    }
    Base::unlinkRemoved(removed);
    countOut(removed);
    countIn(added);
    // Linking may have taken an earlier entry of the same element out.
    std::size_t const place = find(removed, index);
    if (place != size())
        m_entries.exchange(place, added);
    operation.commit();
}

template <class T> void ElementSequence<T>::ensureAt(std::size_t index, T const& element)
{
    if (!element || Base::isOwnerDead())
        return;
    std::size_t const present = insert(index, element);
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    if (index < size() && present < size())
        m_entries.swapEntries(present, index);
    operation.commit();
}

template <class T> void ElementSequence<T>::erase(std::size_t index)
{
    if (Base::isOwnerDead())
        return;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    if (Base::hasUpkeep())
    {
        resolveAt(index);
        T const removed = entryAt(index);
        Base::unlinkRemoved(removed);
    }
    countOut(m_entries[index]);
    ModelElement const released = m_entries.take(index);
    operation.commit();
}

template <class T> void ElementSequence<T>::remove(ModelElement const& element)
{
    if (!m_entries.mayHoldProxies())
    {
        std::size_t const place = findForChange(element);
        if (place != size())
            erase(place);
        return;
    }
    for (std::size_t index = 0; index < size(); ++index)
    {
        if (at(index) == element)
            return erase(index);
    }
}

template <class T> void ElementSequence<T>::clear()
{
    if (Base::isOwnerDead())
        return;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    if (Base::hasUpkeep() || m_filter)
    {
        for (std::size_t index = 0; index < size(); ++index)
        {
            if (Base::hasUpkeep())
            {
                resolveAt(index);
                T const removed = entryAt(index);
                Base::unlinkRemoved(removed);
            }
            countOut(m_entries[index]);
        }
    }
    support::SequenceEntries const released = std::exchange(m_entries, support::SequenceEntries());
    operation.commit();
}

template <class T> void ElementSequence<T>::setFilter(std::unique_ptr<SaturatedBloomFilter> filter)
{
    m_filter = std::move(filter);
    m_entries.forEach([&](ModelElement const& entry) { countIn(entry); });
}

template <class T> std::vector<ModelElement> ElementSequence<T>::getAllValues() const
{
    if (!m_entries.mayHoldProxies())
        return getAllValuesAndProxies();
    std::vector<ModelElement> result;
    result.reserve(size());
    for (std::size_t index = 0; index < size(); ++index)
    {
        T const& entry = at(index);
        if (!Base::isProxy(entry))
            result.push_back(entry);
    }
    return result;
}

template <class T> std::vector<ModelElement> ElementSequence<T>::getAllValuesAndProxies() const
{
    std::vector<ModelElement> result;
    m_entries.appendTo(result);
    return result;
}

template <class T> GenericCollectionInterface* ElementSequence<T>::getGenericInterface() const
{
    return &m_generic;
}

template <class T>
void ElementSequence<T>::replaceProxy(ModelElement const& element, unsigned long index)
{
    T const added = Base::toEntry(element);
    ModelElement const removed = m_entries.exchange(index, added);
    countOut(removed);
    countIn(added);
    Base::linkAdded(added);
}

template <class T> void ElementSequence<T>::resolveAll()
{
    for (std::size_t index = 0; m_entries.mayHoldProxies() && index < size(); ++index)
        resolveAt(index);
}

template <class T> void ElementSequence<T>::resolveLocal()
{
    for (std::size_t index = 0; m_entries.mayHoldProxies() && index < size(); ++index)
    {
        if (isProxyAt(index) && !Base::namesModel(m_entries[index]))
            resolveAt(index);
    }
}

template <class T> void ElementSequence<T>::basicAdd(ModelElement const& element)
{
    T added = Base::toEntry(element);
    AbstractOwnedCollection::AnnouncedOperation operation(*this);
    m_entries.append(std::move(added));
    countIn(element);
    operation.commit();
}

template <class T> void ElementSequence<T>::basicRemove(ModelElement const& element)
{
    std::size_t const index = findForChange(element);
    if (index == size())
        return;
    AbstractOwnedCollection::AnnouncedOperation operation(*this);
    ModelElement const released = m_entries.take(index);
    countOut(released);
    operation.commit();
}

/// A snapshot shares what it copies. Other copies don't, for only one of those that share may have
/// its entries found fast.
template <class T> void ElementSequence<T>::basicCopyValues(ReferenceCollection const& other)
{
    support::SequenceEntries const& present = static_cast<ElementSequence const&>(other).m_entries;
    support::SequenceEntries copy = m_owner ? present.duplicate() : present;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.swap(copy);
    operation.commit();
}

template <class T> bool ElementSequence<T>::basicContainsProxyTo(ModelElement const& target)
{
    if (!m_owner || !target || Base::isProxy(target) || !m_entries.mayHoldProxies())
        return false;
    for (std::size_t index = 0; index < size(); ++index)
    {
        if (isProxyAt(index) && Base::peekResolveProxy(m_entries[index]) == target)
        {
            m_entries.exchange(index, Base::toEntry(target));
            countIn(target);
            return true;
        }
    }
    return false;
}

/// Puts the element that a proxy names in its place, unless the other end does not refer back.
template <class T> void ElementSequence<T>::resolveAt(std::size_t index) const
{
    if (!isProxyAt(index))
        return;
    T const proxy = entryAt(index);
    ModelElement const target = Base::resolveEntry(proxy);
    if (!target || !Base::acceptsElement(target))
        return;
    // Resolving may have loaded, and loading may have changed this sequence.
    std::size_t const place = find(proxy, index);
    if (place == size())
        return;
    m_entries.exchange(place, target);
    countIn(target);
}

/// The position of the very object, at `likelyIndex` or else the first one; `size()` if absent.
template <class T>
std::size_t ElementSequence<T>::find(ModelElement const& element, std::size_t likelyIndex) const
{
    if (likelyIndex < size() && m_entries[likelyIndex] == element)
        return likelyIndex;
    return m_entries.findFirst(element);
}

/// The position of an element that is about to leave or to be added. Any will do where it can be in
/// here only once, and it is often near to the last one. Remembers how to find others.
template <class T> std::size_t ElementSequence<T>::findForChange(ModelElement const& element) const
{
    bool const mustBeFirst = !m_unique || m_filter;
    return m_owner ? m_entries.findForChange(element, mustBeFirst) : m_entries.findFirst(element);
}

template <class T> void ElementSequence<T>::countIn(ModelElement const& element) const
{
    if (m_filter && element.getImpl() && !Base::isProxy(element))
        m_filter->add(element.getImpl()->getUuid());
}

template <class T> void ElementSequence<T>::countOut(ModelElement const& element) const
{
    if (m_filter && element.getImpl() && !Base::isProxy(element))
        m_filter->remove(element.getImpl()->getUuid());
}

extern template class TypedReferenceCollection<ModelElement, support::SequenceEntries>;
extern template class ElementSequence<ModelElement>;
}  // namespace tarn::kiln
