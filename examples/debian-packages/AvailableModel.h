/// \file
/// What names the model that proxies of missing packages lead to.
#pragma once

namespace debian {

/// The URI of the model of available packages.
inline constexpr char16_t const* AVAILABLE_URI = u"packages:available";

}  // namespace debian
