/// \file
/// A multimap of elements as code that knows neither key type nor element class sees it.
#pragma once
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

#include <vector>

namespace tarn::kiln {

/// Adds the look-up by key; any number of elements a key.
class TARNKILN_EXPORT GenericMultimapInterface : public GenericCollectionInterface
{
public:
    ~GenericMultimapInterface() override;

    /// The elements filed under `key`, in the order in which they came.
    ///
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if `key` is of another type.
    virtual std::vector<ModelElement> genericFind(Value const& key) = 0;
    /// The type of the qualifying property; empty if that is not known.
    virtual meta::Type getKeyType() const = 0;
    /// Each distinct key once, ascending.
    virtual std::vector<Value> genericKeys() const = 0;

    bool isMultimapInterface() const override { return true; }
};
}  // namespace tarn::kiln
