/// \file
/// What kind of type a type is. Asks the object itself, so that it works before its own metamodel
/// is there.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::internal {

/// Null if `type` is empty or no class; a dead class is one too.
meta::Class::Impl* classImpl(meta::Type const& type);
bool isEnumType(meta::Type const& type);
}  // namespace tarn::kiln::internal
