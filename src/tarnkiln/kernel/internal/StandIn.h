/// \file
/// What makes an element a proxy.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/internal/LinkedList.h"
#include "tarnkiln/kernel/internal/ModelName.h"

#include <atomic>

namespace tarn::kiln::internal {

class StandIns;

/// The id of the element that a proxy stands in for, and the place of the proxy among those of its
/// model, which it leaves when it goes.
///
/// Most ids are UUIDs, which are kept as such: their texts are made when somebody asks for them.
///
/// Threads: the id may be asked for anywhere; all else happens on the thread of the model.
class StandIn : public Linked<StandIn>
{
public:
    StandIn(ModelElement::Impl& proxy, ProxyId const& id, StandIns& all);
    StandIn(StandIn const&) = delete;
    StandIn& operator=(StandIn const&) = delete;
    ~StandIn();

    ProxyId const& getId() const;
    /// Null if the id is none, or is written in an unusual form.
    UUID const* getUuid() const { return m_isUuid ? &m_uuid : nullptr; }
    /// Null if the id has no model part.
    ModelName const* getModelName() const { return m_modelName.get(); }

private:
    friend class StandIns;

    ModelElement::Impl& m_proxy;
    StandIns* m_all;  ///< Null once the model is gone.
    UUID m_uuid;
    bool m_isUuid;
    ModelNames::Handle const m_modelName;
    mutable std::atomic<ProxyId const*> m_id{nullptr};  ///< Owned; null until asked for.
};

/// The proxies of a model.
class StandIns
{
public:
    StandIns() = default;
    StandIns(StandIns const&) = delete;
    StandIns& operator=(StandIns const&) = delete;

    ModelNames& names() { return m_names; }
    void insert(StandIn& one);
    void erase(StandIn& one);
    /// Takes those of another model over, and calls `visit(ModelElement::Impl&)` for each.
    template <class Visit> void takeOver(StandIns& others, Visit const& visit)
    {
        while (StandIn* const one = others.m_all.first())
        {
            others.erase(*one);
            insert(*one);
            visit(one->m_proxy);
        }
    }
    /// Lets all go, and calls `visit(ModelElement::Impl&)` for each.
    template <class Visit> void clear(Visit const& visit)
    {
        while (StandIn* const one = m_all.first())
        {
            erase(*one);
            visit(one->m_proxy);
        }
    }

private:
    LinkedList<StandIn> m_all;
    ModelNames m_names;
};
}  // namespace tarn::kiln::internal
