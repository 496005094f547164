/// \file
/// The type that stands for a C++ type.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// The type whose values are carried as a `T`. Starts the registry.
///
/// Defined for the value types of `StandardTypes`, and for `TransactionOrigin`,
/// `ExtensionPrototype`, `Language` and `Model`, whose types come with the metamodel's own classes
/// and are empty until those are there.
///
/// Threads: any.
template <class T> TARNKILN_EXPORT Type const& standardTypeOf();
}  // namespace tarn::kiln::meta
