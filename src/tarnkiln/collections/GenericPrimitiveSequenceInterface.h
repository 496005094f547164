/// \file
/// A sequence of values as code that does not know their type sees it.
#pragma once
#include "tarnkiln/collections/GenericPrimitiveInterface.h"
#include "tarnkiln/kernel/Fwd.h"

namespace tarn::kiln {

/// Positions count from 0 and are trusted: one that does not exist is undefined behaviour.
///
/// Values of a wrong type are refused with `CannotCastIncompatibleTypes`.
class TARNKILN_EXPORT GenericPrimitiveSequenceInterface : public GenericPrimitiveInterface
{
public:
    ~GenericPrimitiveSequenceInterface() override;

    virtual Value genericAt(unsigned long index) = 0;
    /// Does nothing if a unique sequence holds the value.
    virtual void genericInsert(Value const& value, unsigned long index) = 0;
    /// Does nothing if a unique sequence holds the value, be it at `index` itself.
    virtual void genericReplace(Value const& value, unsigned long index) = 0;
    virtual void genericRemoveAt(unsigned long index) = 0;
    /// The first position of the value; -1 if it is absent.
    virtual int genericIndexOf(Value const& value) const = 0;
};
}  // namespace tarn::kiln
