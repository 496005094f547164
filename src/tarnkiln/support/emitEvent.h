/// \file
/// How an event of an element gets into a transaction.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"

#include <memory>
#include <utility>

namespace tarn::kiln::meta {
class AbstractDeferredInvocation;
}

namespace tarn::kiln::support {

/// Hands `invocation` to the open transaction of the owner's model, or to one of its own, which is
/// committed at once.
///
/// \param owner  alive.
/// \throws tarnkiln::messages::ChangesProhibited  while the transaction is validated or rolled
/// back.
TARNKILN_EXPORT void emitInvocation(ModelElement const& owner,
                                    std::unique_ptr<meta::AbstractDeferredInvocation> invocation);

/// The same with an event, which knows its owner.
template <class Event> void emitEvent(std::unique_ptr<Event> event)
{
    ModelElement const owner = event->getOwner();
    emitInvocation(owner, std::move(event));
}
}  // namespace tarn::kiln::support
