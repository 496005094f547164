/// \file
/// The bracket around a change that a setter makes.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/support/OpenStep.h"

namespace tarn::kiln::support {

/// Joins the open transaction of an element's model, or opens one for this change alone.
///
/// Dropped uncommitted, it takes the change back, and with it the transaction that it joined.
class JoiningTransaction
{
public:
    explicit JoiningTransaction(ModelElement::Impl const& element)
        : m_transaction(element.getModelImpl()->beginTransaction(/*revertible=*/false)),
          m_step(element.getModelImpl())
    {}

    void commit()
    {
        m_step.close();
        m_transaction.commit();
    }

private:
    Transaction m_transaction;
    OpenStep m_step;
};
}  // namespace tarn::kiln::support
