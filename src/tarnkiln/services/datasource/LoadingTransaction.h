/// \file
/// The bracket around what a data source loads.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tarnkiln/kernel/Transaction.h"

namespace tarn::kiln::datasource {

/// A shallow transaction in which changes are loads and are not recorded.
///
/// Dropped uncommitted it ends the transaction uncommitted, and takes an outer transaction with it.
///
/// Threads: as the model.
class TARNKILN_EXPORT LoadingTransaction
{
public:
    explicit LoadingTransaction(Model::Impl* model);

    void commit();

private:
    Model::DataSourceLoadingInProgressIndicator m_loading;
    Transaction m_transaction;
};
}  // namespace tarn::kiln::datasource
