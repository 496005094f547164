/// \file
/// What the generic views of primitive collections have in common.
#pragma once
#include "tarnkiln/Export.h"

namespace tarn::kiln {

/// The base of `GenericPrimitiveSequenceInterface` and `GenericPrimitiveAssociativeInterface`; it
/// belongs to its collection. A set has none: `AbstractPrimitiveCollection` itself is enough there.
///
/// Threads: as the collection.
class TARNKILN_EXPORT GenericPrimitiveInterface
{
public:
    GenericPrimitiveInterface() = default;
    GenericPrimitiveInterface(GenericPrimitiveInterface const&) = delete;
    GenericPrimitiveInterface& operator=(GenericPrimitiveInterface const&) = delete;
    virtual ~GenericPrimitiveInterface();
};
}  // namespace tarn::kiln
