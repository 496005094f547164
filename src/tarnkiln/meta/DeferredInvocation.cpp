#include "tarnkiln/meta/DeferredInvocation.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {

DeferredInvocation::DeferredInvocation(Operation const& operation, ModelElement const& owner,
                                       std::vector<Value> arguments)
    : AbstractEvent(operation, owner),
      m_arguments(std::move(arguments))
{}

DeferredInvocation::~DeferredInvocation() = default;

void DeferredInvocation::emit(Operation const& operation, ModelElement const& owner,
                              std::vector<Value> arguments)
{
    TARNKILN_ASSERT(owner, "only a live element has events");
    auto event = std::make_unique<DeferredInvocation>(operation, owner, std::move(arguments));
    Transaction const transaction = owner->getModel()->beginTransaction(/*revertible=*/false);
    transaction.eventEmitted(std::move(event));
    transaction.commit();
}

void DeferredInvocation::invoke()
{
    if (getOwner())
        getOwner()->invoke(getOperation(), m_arguments, ModelElement::Impl::PRIVILEGED_ACCESS);
}
}  // namespace tarn::kiln::meta
