/// \file
/// A transaction inside another one of the same model.
#pragma once
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"

namespace tarn::kiln::internal {

/// Holds the transaction that it is nested in open until it has committed, and dooms it when it is
/// dropped uncommitted. Copies of a handle on it share one commit.
class NestedTransaction final : public AbstractTransactionImpl
{
public:
    explicit NestedTransaction(TransactionImpl* parent)
        : AbstractTransactionImpl(parent->getOrigin()),
          m_parent(parent)
    {}
    ~NestedTransaction() override { parent().forgetCommit(); }

    // AbstractTransactionImpl
    TransactionResult commit(boost::optional<Value> const& message) override
    {
        if (m_done)
            return TransactionResult::NotCompleted;
        m_done = true;
        return parent().hasEnded() ? TransactionResult::NotCompleted : parent().commit(message);
    }
    TransactionResult rollBack() override
    {
        if (m_done)
            return TransactionResult::NotCompleted;
        m_done = true;
        return parent().nestedFailed();
    }
    bool isRollBackOnly() const override { return m_parent.isRollBackOnly(); }
    void addFirstChangeCallback(std::function<void()> const& callback) override
    {
        if (!m_done)
            parent().addFirstChangeCallback(callback);
    }
    void eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation) override
    {
        parent().eventEmitted(std::move(invocation));
    }
    void removeRef() override
    {
        if (--m_handleCount != 0)
            return;
        m_handleCount = HANDLES_DELETING;
        if (!m_done)
        {
            m_done = true;
            parent().nestedFailed();
        }
        delete this;
    }

private:
    TransactionImpl& parent() const { return static_cast<TransactionImpl&>(*m_parent.getImpl()); }

    Transaction m_parent;
    bool m_done = false;
};
}  // namespace tarn::kiln::internal
