// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a map from names to values of mixed types.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// A map from names to values, each of a type of its own.
///
/// The map owns its attributes. It holds what a metamodel does not foresee; what is foreseen is
/// better declared as a property.
///
/// The handle is shared: copies refer to the same attribute map; it is false when empty or when the
/// attribute map was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT AttributeMap : public ModelElement
{
public:
    class Impl;            // AttributeMapImpl.h
    class Builder;         // AttributeMapBuilder.h
    class Constrainables;  // AttributeMapConstrainables.h

    AttributeMap() = default;
    explicit AttributeMap(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The attribute map behind `element`; empty if that is empty or something else.
    static AttributeMap cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static AttributeMap create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
