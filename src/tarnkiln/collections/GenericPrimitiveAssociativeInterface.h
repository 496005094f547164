/// \file
/// A keyed collection of values as code that knows neither their type nor the keys' sees it.
#pragma once
#include "tarnkiln/collections/GenericPrimitiveInterface.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Fwd.h"

#include <vector>

namespace tarn::kiln {

/// The look-up by key.
class TARNKILN_EXPORT GenericPrimitiveAssociativeInterface : public GenericPrimitiveInterface
{
public:
    ~GenericPrimitiveAssociativeInterface() override;

    /// The values filed under `key`, in the order in which they came.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `key` is of another type.
    virtual std::vector<Value> genericFind(Value const& key) = 0;
    /// Each distinct key once, ascending.
    virtual std::vector<Value> genericKeys() const = 0;
    /// The type of the qualifying property.
    virtual meta::Type getKeyType() const = 0;
};
}  // namespace tarn::kiln
