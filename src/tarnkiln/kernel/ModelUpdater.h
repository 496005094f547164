/// \file
/// Who brings a model up to date with another one.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

namespace tarn::kiln {

/// For clients that update models from others; the library itself neither has nor calls any.
class TARNKILN_EXPORT ModelUpdater
{
public:
    ModelUpdater(ModelUpdater const&) = delete;
    ModelUpdater& operator=(ModelUpdater const&) = delete;
    virtual ~ModelUpdater();

    /// Makes `target` say what `source` says.
    virtual void updateModel(Model const& target, Model const& source) = 0;

protected:
    ModelUpdater() = default;
};
}  // namespace tarn::kiln
