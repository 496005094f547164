/// \file
/// A map of elements as code that knows neither key type nor element class sees it.
#pragma once
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

#include <vector>

namespace tarn::kiln {

/// Adds the look-up by key; one element a key.
class TARNKILN_EXPORT GenericMapInterface : public GenericCollectionInterface
{
public:
    ~GenericMapInterface() override;

    /// The element filed under `key`, alive or dead; empty if there is none.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `key` is of another type.
    virtual ModelElement genericFind(Value const& key) = 0;
    /// The type of the qualifying property; empty if that is not known.
    virtual meta::Type getKeyType() const = 0;
    /// Each key once, ascending.
    virtual std::vector<Value> genericKeys() const = 0;

    bool isMapInterface() const override { return true; }
};
}  // namespace tarn::kiln
