/// \file
/// The event of any operation, by reflection.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractDeferredInvocation.h"
#include "tarnkiln/meta/AbstractEvent.h"

#include <vector>

namespace tarn::kiln::meta {

/// Calls an operation through its invoker, once the transaction in which it was emitted is
/// committed. A result is dropped, and a failure disturbs nobody.
///
///     meta::DeferredInvocation::emit(lend, book, {Value(readerClass, reader)});
///
/// Threads: runs on the committing thread, after all listeners.
class TARNKILN_EXPORT DeferredInvocation final : public AbstractEvent,
                                                 public AbstractDeferredInvocation
{
public:
    DeferredInvocation(Operation const& operation, ModelElement const& owner,
                       std::vector<Value> arguments);
    ~DeferredInvocation() override;

    /// Hands a new one to the open transaction of the owner's model, or to one of its own, which is
    /// committed at once.
    ///
    /// \param owner  not empty, and in a live model.
    /// \throws tarnkiln::messages::ChangesProhibited  while the transaction is validated or rolled
    ///     back.
    static void emit(Operation const& operation, ModelElement const& owner,
                     std::vector<Value> arguments);

    std::vector<Value> const& getArguments() const { return m_arguments; }

    // AbstractDeferredInvocation
    /// Does nothing if the owner was destroyed meanwhile.
    void invoke() override;

private:
    std::vector<Value> const m_arguments;
};
}  // namespace tarn::kiln::meta
