/// \file
/// Something that a transaction runs once it is committed.
#pragma once
#include "tarnkiln/Export.h"

namespace tarn::kiln::meta {

/// What `Transaction::eventEmitted` takes: something that waits for the end of the transaction.
///
/// It runs if the transaction is committed, in the order of emission and after all listeners. A
/// rollback drops it. Reports of the transaction keep it in memory.
///
/// Threads: as the model of the transaction.
class TARNKILN_EXPORT AbstractDeferredInvocation
{
public:
    virtual ~AbstractDeferredInvocation();
    /// Runs on the committing thread. No transaction of the model is open any more; one may be
    /// begun. Exceptions are swallowed.
    virtual void invoke() = 0;
};
}  // namespace tarn::kiln::meta
