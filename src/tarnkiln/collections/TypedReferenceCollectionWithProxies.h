/// \file
/// What the collections share that can not keep a proxy among their entries.
#pragma once
#include "tarnkiln/collections/ProxyTable.h"
#include "tarnkiln/collections/TypedReferenceCollection.h"

#include <memory>
#include <vector>

namespace tarn::kiln {

/// A container of resolved elements, with a side table for the proxies, which have neither hash
/// nor key. Sizes, look-ups and `getAllValues` see the container only.
///
/// A proxy becomes an entry on one of four roads:
///
/// | Road | Moves | Asks the other end | Keeps the other end in step |
/// |---|---|---|---|
/// | `replaceProxy` | the proxy that names the element | no | yes |
/// | `resolveAll` | all that resolve, if there is an opposite | yes | no |
/// | `resolveLocal` | all that resolve and name no model | no | no |
/// | `basicContainsProxyTo` | one that means the target | no | no |
template <class T, class Container>
class TARNKILN_EXPORT TypedReferenceCollectionWithProxies
    : public TypedReferenceCollection<T, Container>
{
    using Base = TypedReferenceCollection<T, Container>;

public:
    /// Files `proxy` under its id; one that is there already stays.
    ///
    /// \throws tarnkiln::messages::CannotCreateCrossModelAssociation  if the property is composite
    ///     and the proxy names a model.
    void addProxy(ModelElement const& proxy);
    /// Takes out the proxy with the id of `proxy`.
    void removeProxy(ModelElement const& proxy);

    // AbstractOwnedCollection
    void basicSwapContents(AbstractOwnedCollection& other) noexcept override
    {
        Base::basicSwapContents(other);
        m_proxies.swap(static_cast<TypedReferenceCollectionWithProxies&>(other).m_proxies);
    }
    void basicDropContents() noexcept override
    {
        Base::basicDropContents();
        if (m_proxies)
            m_proxies->clear();
    }

    // ReferenceCollection
    std::vector<ModelElement> getAllValuesAndProxies() const override;
    void replaceProxy(ModelElement const& element, unsigned long index) override;
    void resolveAll() override;
    void resolveLocal() override;
    void basicAddWithProxy(ModelElement const& element) override;

protected:
    using Base::Base;

    // ReferenceCollection
    void basicClear() override;
    void basicCopyValues(ReferenceCollection const& other) override;
    bool basicContainsProxyTo(ModelElement const& target) override;

    /// Puts a resolved element into the container, unannounced; false if it did not go in.
    virtual bool insertResolved(ModelElement const& element) = 0;

    bool hasProxies() const { return m_proxies && !m_proxies->empty(); }
    void clearProxies();

    using Base::m_entries;
    using Base::m_owner;

private:
    std::vector<ModelElement> copyProxies() const;
    void moveToEntries(ModelElement const& proxy, ModelElement const& element);

    std::unique_ptr<support::ProxyTable> m_proxies;  ///< Null before the first proxy.
};

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::addProxy(ModelElement const& proxy)
{
    if (Base::isOwnerDead())
        return;
    if (Base::isComposite() && Base::namesModel(proxy))
        Base::reportCannotCreateCrossModelAssociation();
    if (!m_proxies)
        m_proxies = std::make_unique<support::ProxyTable>(/*buckets=*/1);
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_proxies->emplace(*proxy.getImpl()->getProxyIdImpl(), proxy);
    operation.commit();
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::removeProxy(ModelElement const& proxy)
{
    if (!m_proxies || Base::isOwnerDead())
        return;
    ModelElement const held = proxy;
    AbstractOwnedCollection::Operation operation(*this);
    Base::modifying();
    m_proxies->erase(*held.getImpl()->getProxyIdImpl());
    operation.commit();
}

template <class T, class Container>
std::vector<ModelElement>
TypedReferenceCollectionWithProxies<T, Container>::getAllValuesAndProxies() const
{
    std::vector<ModelElement> result = this->getAllValues();
    if (m_proxies)
    {
        result.reserve(result.size() + m_proxies->size());
        for (auto const& [id, proxy] : *m_proxies)
            result.push_back(proxy);
    }
    return result;
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::replaceProxy(ModelElement const& element,
                                                                     unsigned long /*index*/)
{
    if (!m_proxies)
        return;
    ProxyId const id = element.getImpl()->getPersistentProxyId(/*omitModel=*/true);
    if (!m_proxies->contains(id) || !insertResolved(element))
        return;
    m_proxies->erase(id);
    Base::linkAdded(element);
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::resolveAll()
{
    if (!hasProxies())
        return;
    for (ModelElement const& proxy : copyProxies())
    {
        ModelElement const target = Base::resolveProxy(proxy);
        if (!target || Base::isProxy(target) || !Base::getOpposite() || !m_owner)
            continue;
        if (m_owner->_inverseContainsThis(target.getImpl(), Base::getOpposite()))
            moveToEntries(proxy, target);
    }
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::resolveLocal()
{
    if (!hasProxies())
        return;
    for (ModelElement const& proxy : copyProxies())
    {
        if (Base::namesModel(proxy))
            continue;
        ModelElement const target = Base::resolveProxy(proxy);
        if (target && !Base::isProxy(target))
            moveToEntries(proxy, target);
    }
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::basicAddWithProxy(
    ModelElement const& element)
{
    if (Base::isProxy(element))
        addProxy(element);
    else
        this->basicAdd(element);
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::basicClear()
{
    Base::basicClear();
    clearProxies();
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::basicCopyValues(
    ReferenceCollection const& other)
{
    auto const& source = static_cast<TypedReferenceCollectionWithProxies const&>(other);
    auto copy =
        source.m_proxies ? std::make_unique<support::ProxyTable>(*source.m_proxies) : nullptr;
    AbstractOwnedCollection::Operation operation(*this);
    Base::basicCopyValues(other);
    m_proxies.swap(copy);
    operation.commit();
}

template <class T, class Container>
bool TypedReferenceCollectionWithProxies<T, Container>::basicContainsProxyTo(
    ModelElement const& target)
{
    if (!target || !hasProxies())
        return false;
    for (ModelElement const& proxy : copyProxies())
    {
        if (Base::peekResolveProxy(proxy) == target && insertResolved(target))
        {
            m_proxies->erase(*proxy.getImpl()->getProxyIdImpl());
            return true;
        }
    }
    return false;
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::clearProxies()
{
    if (m_proxies)
        support::ProxyTable(1).swap(*m_proxies);
}

/// What is loaded while a proxy is resolved may change the table, so that roads walk a copy.
template <class T, class Container>
std::vector<ModelElement> TypedReferenceCollectionWithProxies<T, Container>::copyProxies() const
{
    std::vector<ModelElement> result;
    result.reserve(m_proxies->size());
    for (auto const& [id, proxy] : *m_proxies)
        result.push_back(proxy);
    return result;
}

template <class T, class Container>
void TypedReferenceCollectionWithProxies<T, Container>::moveToEntries(ModelElement const& proxy,
                                                                      ModelElement const& element)
{
    // Loading may have taken the proxy out, or dropped the whole table.
    ProxyId const& id = *proxy.getImpl()->getProxyIdImpl();
    if (m_proxies && m_proxies->contains(id) && insertResolved(element))
        m_proxies->erase(id);
}
}  // namespace tarn::kiln
