/// \file
/// Who is told when a model extends a class.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln {

class TARNKILN_EXPORT ExtensionListener
{
public:
    virtual ~ExtensionListener();
    virtual void extensionAdded(Model const& model, meta::Extension const& extension) = 0;
    /// Called just before the extension goes.
    virtual void extensionRemoved(Model const& model, meta::Extension const& extension) = 0;
    /// Called when the model dies.
    virtual void listenerRemoved();
};
}  // namespace tarn::kiln
