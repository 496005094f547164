// How transactions of a model begin, and what may be done outside one.
#include "tarnkiln/kernel/Listener.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/LocalTransactionFactoryImpl.h"
#include "tarnkiln/kernel/internal/NestedTransaction.h"
#include "tarnkiln/kernel/internal/TransactionGroup.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/meta/internal/buildCatalogueFor.h"

#include <algorithm>

namespace tarn::kiln {

AbstractTransactionFactoryImpl::~AbstractTransactionFactoryImpl() = default;

AbstractTransactionFactoryImpl& Model::Impl::getDefaultTransactionFactory() const
{
    return *m_transactionFactory;
}

void Model::Impl::setTransactionFactory(std::unique_ptr<AbstractTransactionFactoryImpl> factory)
{
    m_isFactoryLocal = !factory;
    if (!factory)
        factory = std::make_unique<internal::LocalTransactionFactoryImpl>(*this);
    m_transactionFactory = std::move(factory);
}

Transaction Model::Impl::beginTransaction(bool revertible)
{
    return revertible ? m_transactionFactory->beginRevertibleTransaction()
                      : m_transactionFactory->beginTransaction();
}

Transaction Model::Impl::innerBeginTransaction(PrivateTag const&,
                                               meta::TransactionOrigin const& origin, bool deep)
{
    if (m_validity == ElementValidity::Invalid)
        reportException(tarnkiln::messages::ModelFrozen());
    // Built later, it would be part of this transaction and could be taken back with it.
    if (!m_currentTransaction && isRegistryModel())
        internal::buildCatalogueFor(*this);
    if (m_currentTransaction)
        return Transaction(new internal::NestedTransaction(m_currentTransaction));
    if (!deep)
    {
        if (m_transactionDepth == 0)
        {
            bool const anyDeep =
                std::any_of(m_listeners.begin(), m_listeners.end(),
                            [](auto const& holder) { return !holder->isShallow(); });
            m_transactionDepth = anyDeep ? 2 : 1;
        }
        deep = m_transactionDepth == 2;
    }
    if (!m_constellation)
    {
        Transaction const transaction(
            new internal::TransactionImpl(getModel(), nullptr, origin, deep));
        m_currentTransaction = static_cast<internal::TransactionImpl*>(transaction.getImpl());
        m_anchor.get()->transactionBegan();
        return transaction;
    }
    m_constellation->createTransactionGroup(deep, origin);
    try
    {
        return Transaction(new internal::NestedTransaction(m_currentTransaction));
    }
    catch (...)
    {
        m_constellation->getTransactionGroup()->rollBack();
        throw;
    }
}

void Model::Impl::doBeginTransaction(internal::TransactionGroup* group,
                                     meta::TransactionOrigin const& origin)
{
    m_currentTransaction =
        new internal::TransactionImpl(getModel(), group, origin, group->isDeep());
    m_anchor.get()->transactionBegan();
}

bool Model::Impl::isUnwatched() const
{
    return !m_currentTransaction && m_isFactoryLocal && m_listeners.empty() &&
           m_validity == ElementValidity::Valid && !isRegistryModel() && !isMultiModel();
}

void Model::Impl::unwatchedChangeEnded()
{
    ++m_endedTransactions;
    checkInvariantsAtEnd();
}

void Model::Impl::refuseInvalidChange() const
{
    if (m_validity == ElementValidity::ModelDestroying)
        return;
    if (m_currentTransaction && m_currentTransaction->isRolledBack())
        return;  // what undo restores is no change
    if (m_freezeCount != 0)
        reportException(tarnkiln::messages::ModelFrozen());
    if (!m_currentTransaction && (isMultiModel() || hasListeners()))
        reportException(tarnkiln::messages::NoOpenTransaction());
}

bool Model::Impl::isChangedInSilence() const
{
    return internal::isChangedInSilence(*this);
}

void Model::Impl::transactionEnded()
{
    m_currentTransaction = nullptr;
    m_anchor.get()->transactionEnded();
    ++m_endedTransactions;
    m_elements.forgetReturns();
    m_topLevelElements.forgetReturns();
}
}  // namespace tarn::kiln
