/// \file
/// Who is told when models join and leave a constellation.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

namespace tarn::kiln {

/// Must not keep the handles that it is given while the constellation is being deleted.
class TARNKILN_EXPORT ConstellationListener
{
public:
    virtual ~ConstellationListener();
    /// The model is in the constellation, but not yet in the open transaction.
    virtual void modelAdded(ModelConstellation const& constellation, Model const& model) = 0;
    /// Also called for a model that moves to another constellation.
    virtual void modelDestroyed(ModelConstellation const& constellation, Model const& model) = 0;
    virtual void listenerRemoved(ModelConstellation const& constellation) = 0;
};
}  // namespace tarn::kiln
