/// \file
/// An unordered property's collection of plain values.
#pragma once
#include "tarnkiln/collections/PrimitiveCollection.h"
#include "tarnkiln/collections/PrimitiveTypes.h"
#include "tarnkiln/collections/TotalLess.h"

#include <set>

namespace tarn::kiln {

/// Each value once, ascending.
///
/// Unlike a unique sequence, a set announces and commits the adding of a value that it holds and
/// the removal of one that it does not hold.
template <class T>
class TARNKILN_EXPORT PrimitiveSet
    : public PrimitiveCollection<T, std::set<T, support::TotalLess<T>>>
{
    using Container = std::set<T, support::TotalLess<T>>;
    using Base = PrimitiveCollection<T, Container>;

public:
    using const_iterator = typename Container::const_iterator;
    using iterator = const_iterator;

    /// \param owner  null makes a snapshot.
    PrimitiveSet(ModelElement::Impl* owner, Feature const& feature) : Base(owner, feature) {}

    const_iterator begin() const { return m_entries.begin(); }
    const_iterator end() const { return m_entries.end(); }
    bool contains(T const& value) const { return m_entries.contains(value); }

    void insert(T const& value);
    void erase(T const& value);

    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override
    {
        insert(support::PrimitiveTraits<T>::fromValue(value));
    }
    void genericRemove(Value const& value) override
    {
        erase(support::PrimitiveTraits<T>::fromValue(value));
    }
    int getKind() const override { return AbstractPrimitiveCollection::SET; }

protected:
    using Base::m_entries;
};

template <class T> void PrimitiveSet<T>::insert(T const& value)
{
    if (Base::isOwnerDead())
        return;
    T const added = value;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.insert(added);
    operation.commit();
}

template <class T> void PrimitiveSet<T>::erase(T const& value)
{
    if (Base::isOwnerDead())
        return;
    T const removed = value;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries.erase(removed);
    operation.commit();
}

#define TARNKILN_DECLARE(T)                                                                        \
    extern template class TARNKILN_EXPORT                                                          \
        PrimitiveCollection<T, std::set<T, support::TotalLess<T>>>;                                \
    extern template class TARNKILN_EXPORT PrimitiveSet<T>;
TARNKILN_FOR_EACH_PRIMITIVE_TYPE(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
