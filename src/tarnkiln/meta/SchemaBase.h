/// \file
/// Where the URIs of all metamodels begin.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"

namespace tarn::kiln::meta {

/// "http://tarnkiln.invalid/tarnkiln/". A family, "/" and a version follow it in the URI of a root
/// package: see `MetaRegistry::parseUri`. Can be read while static objects are constructed.
extern TARNKILN_EXPORT ustring const SchemaBase;
}  // namespace tarn::kiln::meta
