// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a property that a model declares on a foreign class.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Property.h"

namespace tarn::kiln::meta {

/// A `Property` that a model adds to a class of somebody else's metamodel.
///
/// It belongs to the `DynamicExtensions` of that class and model, not to the class itself.
///
/// The handle is shared: copies refer to the same extension; it is false when empty or when the
/// extension was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Extension : public Property
{
public:
    class Impl;            // ExtensionImpl.h
    class Builder;         // ExtensionBuilder.h
    class Constrainables;  // ExtensionConstrainables.h

    Extension() = default;
    explicit Extension(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The extension behind `element`; empty if that is empty or something else.
    static Extension cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Extension create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
