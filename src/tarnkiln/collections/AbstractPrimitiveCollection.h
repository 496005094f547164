/// \file
/// The base of all collections of plain values.
#pragma once
#include "tarnkiln/collections/AbstractOwnedCollection.h"

#include <cstddef>
#include <vector>

namespace tarn::kiln {

/// A collection of values that are no elements, as code that does not know their type sees it.
///
/// Values of a wrong type are refused with `CannotCastIncompatibleTypes`, before anything else.
///
/// Threads: as the element's model.
class TARNKILN_EXPORT AbstractPrimitiveCollection : public AbstractOwnedCollection
{
public:
    /// \name What `getKind` answers
    /// @{
    static constexpr int SET = 0;
    static constexpr int SEQUENCE = 1;
    static constexpr int ASSOCIATIVE = 2;
    /// @}

    ~AbstractPrimitiveCollection() override;

    virtual void clear() = 0;
    virtual std::size_t size() const = 0;
    /// A value for each entry, in the order of the container; none while there is no type.
    virtual std::vector<Value> getAllValues() const = 0;
    virtual void genericAdd(Value const& value) = 0;
    /// Takes the first entry that equals `value` out.
    virtual void genericRemove(Value const& value) = 0;
    /// The view with positions or keys; belongs to this collection. Null for a set.
    virtual GenericPrimitiveInterface* getGenericInterface() const;
    virtual int getKind() const = 0;

protected:
    using AbstractOwnedCollection::AbstractOwnedCollection;

    /// The type that the property declares; empty while there is no property.
    meta::Type getPropertyType() const;
};
}  // namespace tarn::kiln
