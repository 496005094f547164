#include "tarnkiln/services/datasource/LoadingTransaction.h"

namespace tarn::kiln::datasource {

LoadingTransaction::LoadingTransaction(Model::Impl* model)
    : m_loading(model->startDataSourceLoading()),
      m_transaction(model->beginTransaction(/*revertible=*/false))
{}

void LoadingTransaction::commit()
{
    m_transaction.commit();
}
}  // namespace tarn::kiln::datasource
