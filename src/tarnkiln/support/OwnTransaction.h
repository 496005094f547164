/// \file
/// The transaction that a change opens when none is open.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

namespace tarn::kiln::support {

/// A transaction for one change alone; nothing if one is open.
///
/// Where nobody would hear of it and nothing could be taken back, the change goes without.
///
/// Threads: as the model.
class TARNKILN_EXPORT OwnTransaction
{
public:
    /// \param model  none for null.
    explicit OwnTransaction(Model::Impl* model)
    {
        if (model && !model->getCurrentTransaction())
            open(*model);
    }

    /// Whether the change is made without any transaction.
    bool isSkipped() const { return m_skipped != nullptr; }
    /// `NotCompleted` if there is an outer transaction or no model.
    TransactionResult commit()
    {
        return m_transaction || m_skipped ? end() : TransactionResult::NotCompleted;
    }

private:
    void open(Model::Impl& model);
    TransactionResult end();

    Transaction m_transaction;         ///< Empty unless opened here.
    Model::Impl* m_skipped = nullptr;  ///< The model of a change without one.
};
}  // namespace tarn::kiln::support
