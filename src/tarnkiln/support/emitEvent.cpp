#include "tarnkiln/support/emitEvent.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/AbstractDeferredInvocation.h"

namespace tarn::kiln::support {

void emitInvocation(ModelElement const& owner,
                    std::unique_ptr<meta::AbstractDeferredInvocation> invocation)
{
    TARNKILN_ASSERT(owner, "only a live element has events");
    Transaction const transaction = owner->getModel()->beginTransaction(/*revertible=*/false);
    transaction.eventEmitted(std::move(invocation));
    transaction.commit();
}
}  // namespace tarn::kiln::support
