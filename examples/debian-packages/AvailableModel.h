/// \file
/// What names the packages that an index asks for and does not hold.
#pragma once
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/Types.h"

#include <string>

namespace debian {

/// The URI of the model of available packages, to which the proxies of missing packages lead.
inline constexpr char16_t const* AVAILABLE_URI = u"packages:available";

/// The UUID of the package of that name, in every model.
tarn::kiln::UUID uuidOfPackage(std::string const& name);
/// Names that package in the model of available packages.
tarn::kiln::ProxyId idOfAvailablePackage(std::string const& name);

}  // namespace debian
