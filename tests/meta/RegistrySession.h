/// \file
/// How tests change the registry model.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/MetaRegistry.h"

namespace tarnkiln::tests {

/// A lock of the registry with an open transaction, which is taken back unless it is committed.
class RegistrySession
{
public:
    RegistrySession() : m_locked(tarn::kiln::meta::MetaRegistry::getInstance()) {}

    tarn::kiln::Model const& getModel() const { return m_locked.getModel(); }
    void commit() { EXPECT_EQ(m_transaction.commit(), tarn::kiln::TransactionResult::Committed); }
    void rollBack()
    {
        EXPECT_EQ(m_transaction.rollBack(), tarn::kiln::TransactionResult::RolledBack);
    }

private:
    tarn::kiln::meta::MetaRegistry::LockedModel m_locked;
    tarn::kiln::Transaction m_transaction = getModel()->beginTransaction(/*revertible=*/true);
};

/// A new, named element of the registry model, such as a `Class`, and its end with the test.
template <class Handle> class RegistryElement
{
public:
    explicit RegistryElement(tarn::kiln::ustring const& name)
    {
        RegistrySession session;
        m_handle = Handle::create(session.getModel());
        m_handle->setName(name);
        session.commit();
    }
    RegistryElement(RegistryElement const&) = delete;
    RegistryElement& operator=(RegistryElement const&) = delete;
    ~RegistryElement() { destroy(); }

    void destroy()
    {
        if (!m_handle)
            return;
        RegistrySession session;
        m_handle->destroy();
        session.commit();
    }

    Handle const& get() const { return m_handle; }
    operator Handle const&() const { return m_handle; }
    auto* operator->() const { return m_handle.getImpl(); }

private:
    Handle m_handle;
};
}  // namespace tarnkiln::tests
