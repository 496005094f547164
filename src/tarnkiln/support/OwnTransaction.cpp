#include "tarnkiln/support/OwnTransaction.h"

#include "tarnkiln/kernel/ModelImpl.h"

namespace tarn::kiln::support {

OwnTransaction::OwnTransaction(Model::Impl* model)
{
    if (!model || model->getCurrentTransaction())
        return;
    if (model->isUnwatched())
        m_skipped = model;
    else
        m_transaction = model->beginTransaction(/*revertible=*/false);
}

TransactionResult OwnTransaction::commit()
{
    if (m_transaction)
        return m_transaction.commit();
    if (!m_skipped)
        return TransactionResult::NotCompleted;
    m_skipped->unwatchedChangeEnded();
    return TransactionResult::Committed;
}
}  // namespace tarn::kiln::support
