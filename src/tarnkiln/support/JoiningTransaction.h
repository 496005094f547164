/// \file
/// The bracket around a change that a setter makes.
#pragma once
#include "tarnkiln/support/OpenStep.h"
#include "tarnkiln/support/OwnTransaction.h"

namespace tarn::kiln::support {

/// Joins the open transaction of an element's model, or opens one for this change alone.
///
/// Dropped uncommitted, it takes the change back, and with it the transaction that it joined.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT JoiningTransaction
{
public:
    explicit JoiningTransaction(ModelElement::Impl const& element);
    JoiningTransaction(JoiningTransaction const&) = delete;
    JoiningTransaction& operator=(JoiningTransaction const&) = delete;
    ~JoiningTransaction();

    void commit();

private:
    Transaction m_outer;  ///< The open transaction, or a nested one from a client's factory.
    bool m_isNested;      ///< This object counts as a nested one of `m_outer`.
    bool m_isCommitted = false;
    OwnTransaction m_own;
    OpenStep m_step;
};
}  // namespace tarn::kiln::support
