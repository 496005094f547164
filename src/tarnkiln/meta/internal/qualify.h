/// \file
/// How the names of metamodel elements are put together.
#pragma once
#include "tarnkiln/kernel/Types.h"

namespace tarn::kiln::internal {

/// `name` behind `path` and a dot; alone if the path is empty, as that of the root package is.
inline ustring qualify(ustring const& path, ustring const& name)
{
    return path.empty() ? name : path + u"." + name;
}
}  // namespace tarn::kiln::internal
