#include "tarnkiln/kernel/Transaction.h"

#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractDeferredInvocation.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <utility>

namespace tarn::kiln {

AbstractTransactionImpl::AbstractTransactionImpl(meta::TransactionOrigin const& origin)
    : m_origin(origin)
{}

AbstractTransactionImpl::~AbstractTransactionImpl() = default;

Transaction::Transaction(AbstractTransactionImpl* impl) : m_impl(impl)
{
    if (m_impl)
        m_impl->addRef();
}

Transaction::Transaction(Transaction const& other) : Transaction(other.m_impl) {}

Transaction::Transaction(Transaction&& other) noexcept
    : m_impl(std::exchange(other.m_impl, nullptr))
{}

void Transaction::drop()
{
    m_impl->removeRef();
}

Transaction& Transaction::operator=(Transaction other) noexcept
{
    std::swap(m_impl, other.m_impl);
    return *this;
}

TransactionResult Transaction::commit(boost::optional<Value> const& message) const
{
    return m_impl->commit(message);
}

TransactionResult Transaction::commit() const
{
    return m_impl->commit(boost::none);
}

TransactionResult Transaction::commit(string const& message) const
{
    meta::MetaRegistry::getInstance();
    return m_impl->commit(Value(meta::StandardTypes::stdstringMeta, message));
}

TransactionResult Transaction::commit(ustring const& message) const
{
    meta::MetaRegistry::getInstance();
    return m_impl->commit(Value(meta::StandardTypes::stringMeta, message));
}

TransactionResult Transaction::commit(char const* message) const
{
    return commit(string(message));
}

TransactionResult Transaction::commit(char16_t const* message) const
{
    return commit(ustring(message));
}

TransactionResult Transaction::rollBack() const
{
    return m_impl->rollBack();
}

bool Transaction::isRollBackOnly() const
{
    return m_impl->isRollBackOnly();
}

void Transaction::addFirstChangeCallback(std::function<void()> const& callback) const
{
    m_impl->addFirstChangeCallback(callback);
}

void Transaction::eventEmitted(std::unique_ptr<meta::AbstractDeferredInvocation> invocation) const
{
    m_impl->eventEmitted(std::move(invocation));
}
}  // namespace tarn::kiln
