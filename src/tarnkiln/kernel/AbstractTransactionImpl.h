/// \file
/// What stands behind a `Transaction`.
#pragma once
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <cstdint>

namespace tarn::kiln {

/// The transaction of a model, or a nested one over it. Counted by its handles, on one thread.
class TARNKILN_EXPORT AbstractTransactionImpl
{
public:
    AbstractTransactionImpl(AbstractTransactionImpl const&) = delete;
    AbstractTransactionImpl& operator=(AbstractTransactionImpl const&) = delete;

    virtual TransactionResult commit(boost::optional<Value> const& message) = 0;
    virtual TransactionResult rollBack() = 0;
    virtual bool isRollBackOnly() const = 0;
    virtual void addFirstChangeCallback(std::function<void()> const& callback) = 0;
    virtual void eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation) = 0;
    virtual ~AbstractTransactionImpl();
    /// Gives one handle back; what the last one does depends on the kind of transaction.
    virtual void removeRef() = 0;

    void addRef() { ++m_handleCount; }
    std::uint32_t getHandleCount() const { return m_handleCount; }
    meta::TransactionOrigin const& getOrigin() const { return m_origin; }

protected:
    explicit AbstractTransactionImpl(meta::TransactionOrigin const& origin);

    static constexpr std::uint32_t HANDLES_DELETING = 0xDEAD;

    std::uint32_t m_handleCount = 0;
    meta::TransactionOrigin m_origin;
};
}  // namespace tarn::kiln
