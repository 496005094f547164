/// \file
/// How values of a type are kept and let go by the elements that store them.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"

namespace tarn::kiln::meta {

/// Makes values fit to be kept by an element, for a type whose payload needs more than a copy.
///
/// Reflective elements pass each primitive value that they store through the converter of its type:
/// see `MetaRegistry::registerOwnershipConverter`.
///
/// Threads: must be callable from all threads at once.
class TARNKILN_EXPORT ValueOwnershipConverter
{
public:
    virtual ~ValueOwnershipConverter();
    /// The copy of `value` that an element is going to own.
    virtual Value convert(Value const& value) = 0;
    /// Lets a value go that `convert` made and that its element no longer stores.
    virtual void release(Value const& value) = 0;
};
}  // namespace tarn::kiln::meta
