// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The handle of a `Bed`.
#pragma once
#include "acme/garden/Fwd.h"
#include "tarnkiln/kernel/ModelElement.h"

namespace acme::garden {

/// A piece of ground.
///
/// It owns its plants and knows them by their names.
///
/// The handle is shared: copies refer to the same bed; it is false when empty or when the bed was
/// destroyed.
///
/// Threads: handles may be copied and dropped anywhere; all else happens on the thread that uses
/// the model.
class Bed : public ModelElement
{
public:
    class Impl;            // BedImpl.h
    class Builder;         // BedBuilder.h
    class Constrainables;  // BedConstrainables.h

    Bed() = default;
    explicit Bed(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The bed behind `element`; empty if that is empty or something else.
    static Bed cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Bed create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace acme::garden
