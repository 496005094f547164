// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of the extensions that one model declares on a class.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// The extensions that one model declares on one `Class`.
///
/// The class owns these by the model's id, and each owns its extensions by name.
///
/// The handle is shared: copies refer to the same dynamic extensions; it is false when empty or
/// when the dynamic extensions was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT DynamicExtensions : public ModelElement
{
public:
    class Impl;            // DynamicExtensionsImpl.h
    class Builder;         // DynamicExtensionsBuilder.h
    class Constrainables;  // DynamicExtensionsConstrainables.h

    DynamicExtensions() = default;
    explicit DynamicExtensions(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The dynamic extensions behind `element`; empty if that is empty or something else.
    static DynamicExtensions cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static DynamicExtensions create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
