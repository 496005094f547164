/// \file
/// An ordered collection of plain values.
#pragma once
#include "tarnkiln/collections/GenericPrimitiveSequenceInterface.h"
#include "tarnkiln/collections/PrimitiveCollection.h"
#include "tarnkiln/collections/PrimitiveTypes.h"
#include "tarnkiln/collections/SequenceIteratorPrimitive.h"

#include <algorithm>
#include <memory>
#include <vector>

namespace tarn::kiln {

/// Values in the order in which they were put there; each once, if the sequence is unique.
///
/// A unique sequence that is given a value it holds does nothing, and announces nothing. Positions
/// count from 0 and are trusted.
template <class T>
class TARNKILN_EXPORT PrimitiveSequence : public PrimitiveCollection<T, std::vector<T>>
{
    using Base = PrimitiveCollection<T, std::vector<T>>;

public:
    class SequenceInterface;

    using const_iterator = internal::SequenceIteratorPrimitive<T, false>;
    using iterator = const_iterator;

    /// \param owner  null makes a snapshot.
    PrimitiveSequence(ModelElement::Impl* owner, bool unique, Feature const& feature);
    ~PrimitiveSequence() override;

    /// \name Reading
    /// @{
    bool isUnique() const { return m_unique; }
    const_iterator begin() const { return m_entries.begin(); }
    const_iterator end() const { return m_entries.end(); }
    T operator[](std::size_t index) const { return m_entries[index]; }
    /// The first position of `value`; `end()` if it is absent.
    const_iterator find(T const& value) const { return std::find(begin(), end(), value); }
    /// @}

    /// \name Changing
    /// @{
    void push_back(T const& value);
    /// Puts `value` before `position`; returns where it, or the equal one of a unique sequence, is.
    const_iterator insert(const_iterator const& position, T const& value);
    void replace(std::size_t index, T const& value);
    /// Returns the position of the entry behind the erased one.
    const_iterator erase(const_iterator const& position);
    /// Erases the first entry that equals `value`.
    void remove(T const& value);
    /// @}

    // AbstractPrimitiveCollection
    void genericAdd(Value const& value) override;
    void genericRemove(Value const& value) override;
    GenericPrimitiveInterface* getGenericInterface() const override;
    int getKind() const override { return AbstractPrimitiveCollection::SEQUENCE; }

protected:
    using Base::m_entries;

private:
    bool const m_unique;
    std::unique_ptr<SequenceInterface> m_generic;
};

/// The view of a sequence for code that does not know its type.
template <class T>
class PrimitiveSequence<T>::SequenceInterface final : public GenericPrimitiveSequenceInterface
{
    using Traits = support::PrimitiveTraits<T>;

public:
    explicit SequenceInterface(PrimitiveSequence& sequence) : m_sequence(sequence) {}

    // GenericPrimitiveSequenceInterface
    Value genericAt(unsigned long index) override
    {
        return Traits::toValue(m_sequence[index], m_sequence.getEntryType());
    }
    void genericInsert(Value const& value, unsigned long index) override
    {
        m_sequence.insert(position(index), Traits::fromValue(value));
    }
    void genericReplace(Value const& value, unsigned long index) override
    {
        m_sequence.replace(index, Traits::fromValue(value));
    }
    void genericRemoveAt(unsigned long index) override { m_sequence.erase(position(index)); }
    int genericIndexOf(Value const& value) const override
    {
        auto const found = m_sequence.find(Traits::fromValue(value));
        return found == m_sequence.end() ? -1 : static_cast<int>(found - m_sequence.begin());
    }

private:
    const_iterator position(unsigned long index) const
    {
        return m_sequence.begin() + static_cast<std::ptrdiff_t>(index);
    }

    PrimitiveSequence& m_sequence;
};

template <class T>
PrimitiveSequence<T>::PrimitiveSequence(ModelElement::Impl* owner, bool unique,
                                        Feature const& feature)
    : Base(owner, feature),
      m_unique(unique),
      m_generic(std::make_unique<SequenceInterface>(*this))
{}

template <class T> PrimitiveSequence<T>::~PrimitiveSequence() = default;

template <class T> void PrimitiveSequence<T>::push_back(T const& value)
{
    insert(end(), value);
}

template <class T>
typename PrimitiveSequence<T>::const_iterator
PrimitiveSequence<T>::insert(const_iterator const& position, T const& value)
{
    if (Base::isOwnerDead())
        return position;
    if (m_unique)
    {
        const_iterator const present = find(value);
        if (present != end())
            return present;
    }
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    const_iterator const inserted = m_entries.insert(position, value);
    operation.commit();
    return inserted;
}

template <class T> void PrimitiveSequence<T>::replace(std::size_t index, T const& value)
{
    if (Base::isOwnerDead() || (m_unique && find(value) != end()))
        return;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_entries[index] = value;
    operation.commit();
}

template <class T>
typename PrimitiveSequence<T>::const_iterator
PrimitiveSequence<T>::erase(const_iterator const& position)
{
    if (Base::isOwnerDead())
        return position;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    const_iterator const next = m_entries.erase(position);
    operation.commit();
    return next;
}

template <class T> void PrimitiveSequence<T>::remove(T const& value)
{
    const_iterator const place = find(value);
    if (place != end())
        erase(place);
}

template <class T> void PrimitiveSequence<T>::genericAdd(Value const& value)
{
    push_back(support::PrimitiveTraits<T>::fromValue(value));
}

template <class T> void PrimitiveSequence<T>::genericRemove(Value const& value)
{
    remove(support::PrimitiveTraits<T>::fromValue(value));
}

template <class T> GenericPrimitiveInterface* PrimitiveSequence<T>::getGenericInterface() const
{
    return m_generic.get();
}

#define TARNKILN_DECLARE(T)                                                                        \
    extern template class TARNKILN_EXPORT PrimitiveCollection<T, std::vector<T>>;                  \
    extern template class TARNKILN_EXPORT PrimitiveSequence<T>;
TARNKILN_FOR_EACH_PRIMITIVE_TYPE(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
