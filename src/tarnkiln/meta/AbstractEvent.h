/// \file
/// The call of an operation that waits for the end of a transaction.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Operation.h"

namespace tarn::kiln::meta {

/// Which operation was called on which element. The events of metamodels derive from this, each
/// with the arguments of its operation.
///
/// Holds both elements in memory; either may be destroyed by the time the event is delivered.
///
/// Threads: as the owner.
class TARNKILN_EXPORT AbstractEvent
{
public:
    AbstractEvent(AbstractEvent const&) = delete;
    AbstractEvent& operator=(AbstractEvent const&) = delete;
    virtual ~AbstractEvent();

    Operation const& getOperation() const { return m_operation; }
    /// The element on which it was called.
    ModelElement const& getOwner() const { return m_owner; }

protected:
    AbstractEvent(Operation const& operation, ModelElement const& owner);

private:
    Operation const m_operation;
    ModelElement const m_owner;
};
}  // namespace tarn::kiln::meta
