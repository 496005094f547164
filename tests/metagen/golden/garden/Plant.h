// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The handle of a `Plant`.
#pragma once
#include "acme/garden/Fwd.h"
#include "tarnkiln/kernel/ModelElement.h"

namespace acme::garden {

/// Something that grows in a bed.
///
/// The handle is shared: copies refer to the same plant; it is false when empty or when the plant
/// was destroyed.
///
/// Threads: handles may be copied and dropped anywhere; all else happens on the thread that uses
/// the model.
class Plant : public ModelElement
{
public:
    class Impl;            // PlantImpl.h
    class Builder;         // PlantBuilder.h
    class Constrainables;  // PlantConstrainables.h

    Plant() = default;
    explicit Plant(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The plant behind `element`; empty if that is empty or something else.
    static Plant cast(ModelElement const& element);
    static meta::Class const& metaClass();

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace acme::garden
