#include "tarnkiln/support/OwnTransaction.h"

namespace tarn::kiln::support {

void OwnTransaction::open(Model::Impl& model)
{
    if (model.isUnwatched())
        m_skipped = &model;
    else
        m_transaction = model.beginTransaction(/*revertible=*/false);
}

TransactionResult OwnTransaction::end()
{
    if (m_transaction)
        return m_transaction.commit();
    m_skipped->unwatchedChangeEnded();
    return TransactionResult::Committed;
}
}  // namespace tarn::kiln::support
