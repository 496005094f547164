#include "tarnkiln/meta/DeferredInvocation.h"

#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/support/emitEvent.h"

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
    support::emitInvocation(
        owner, std::make_unique<DeferredInvocation>(operation, owner, std::move(arguments)));
}

void DeferredInvocation::invoke()
{
    if (getOwner())
        getOwner()->invoke(getOperation(), m_arguments, ModelElement::Impl::PRIVILEGED_ACCESS);
}
}  // namespace tarn::kiln::meta
