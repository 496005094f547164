/// \file
/// What all reference collections over a container of typed handles share.
#pragma once
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/meta/Class.h"

#include <type_traits>
#include <utility>

namespace tarn::kiln {

/// Holds the container and knows the element class.
///
/// \tparam T          a handle class with `cast` and `metaClass`.
/// \tparam Container  of `T`s, by themselves or as mapped values.
template <class T, class Container>
class TARNKILN_EXPORT TypedReferenceCollection : public ReferenceCollection
{
public:
    // AbstractOwnedCollection
    meta::Type getCollectionType() const override { return T::metaClass(); }
    void basicSwapContents(AbstractOwnedCollection& other) noexcept override
    {
        m_entries.swap(static_cast<TypedReferenceCollection&>(other).m_entries);
    }
    void basicDropContents() noexcept override
    {
        // The handles go last: what they release must not find them half removed.
        Container const released = std::exchange(m_entries, Container());
    }
    // ReferenceCollection
    meta::Class const& getElementClass() const override { return T::metaClass(); }
    bool acceptsElement(ModelElement const& element) const override;

protected:
    using ReferenceCollection::ReferenceCollection;

    // ReferenceCollection
    void basicClear() override;
    void basicCopyValues(ReferenceCollection const& other) override;

    /// `element` as the container holds it.
    ///
    /// \throws tarnkiln::messages::CannotAddIncompatibleTypes  if its class does not suit.
    T toEntry(ModelElement const& element) const;

    mutable Container m_entries;  ///< Changed in const operations by resolving proxies only.
};

template <class T, class Container>
bool TypedReferenceCollection<T, Container>::acceptsElement(ModelElement const& element) const
{
    if constexpr (std::is_same_v<T, ModelElement>)
        return true;
    else
        return T::cast(element).getElementImpl() != nullptr;
}

template <class T, class Container>
T TypedReferenceCollection<T, Container>::toEntry(ModelElement const& element) const
{
    checkElementClass(element);
    return T::cast(element);
}

template <class T, class Container> void TypedReferenceCollection<T, Container>::basicClear()
{
    modifying();
    // The handles go last: what they release must not find them half removed.
    Container const released = std::exchange(m_entries, Container());
}

template <class T, class Container>
void TypedReferenceCollection<T, Container>::basicCopyValues(ReferenceCollection const& other)
{
    Container copy = static_cast<TypedReferenceCollection const&>(other).m_entries;
    Operation operation(*this);
    modifying();
    m_entries.swap(copy);
    operation.commit();
}
}  // namespace tarn::kiln
