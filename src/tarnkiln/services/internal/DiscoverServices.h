/// \file
/// How the library finds the services that vary at run time.
#pragma once
#include "tarnkiln/kernel/Types.h"

#include <memory>
#include <optional>
#include <vector>

namespace tarn::kiln::internal {

/// A service with what its registration says about it.
template <class Interface> struct DiscoveredService
{
    std::shared_ptr<Interface> service;
    std::optional<int> priority;  ///< The property "priority", where that is an `int`.
};

/// The services of `Interface` in the bundles whose manifest matches `filter`, in the order found.
///
/// No service framework is attached: there are none but those of `AttachedService`.
template <class Interface>
std::vector<DiscoveredService<Interface>> discoverServices(string const& filter);

/// `value` as it can stand in a filter, where "*", "(", ")" and "\" mean something else.
string escapeFilterValue(ustring const& value);
}  // namespace tarn::kiln::internal
