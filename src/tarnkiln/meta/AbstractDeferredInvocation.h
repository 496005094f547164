/// \file
/// Something that a transaction runs once it is committed.
#pragma once
#include "tarnkiln/Export.h"

namespace tarn::kiln::meta {

/// An emitted event that waits for the end of its transaction.
class TARNKILN_EXPORT AbstractDeferredInvocation
{
public:
    virtual ~AbstractDeferredInvocation();
    /// Runs on the committing thread, after all listeners; exceptions are swallowed.
    virtual void invoke() = 0;
};
} // namespace tarn::kiln::meta
