/// \file
/// The proxies that stand beside a collection until they are resolved.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/ProxyId.h"

#include <cstddef>
#include <unordered_map>

namespace tarn::kiln::support {

/// Hashes type and text of an id and leaves the model out.
struct TARNKILN_EXPORT ProxyIdHasher
{
    std::size_t operator()(ProxyId const& id) const;
};

/// The proxies of one collection, each under its id.
using ProxyTable = std::unordered_map<ProxyId, ModelElement, ProxyIdHasher>;
}  // namespace tarn::kiln::support
