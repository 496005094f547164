// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a class of model elements.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/StructuredType.h"

namespace tarn::kiln::meta {

/// A class: what the elements that are instances of it have and can do.
///
/// A class inherits the properties and operations of its superclass, and a property hides those of
/// the same name above. It owns its attributes, its operations and the extensions that models
/// declare on it.
///
/// The handle is shared: copies refer to the same class; it is false when empty or when the class
/// was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Class : public StructuredType
{
public:
    class Impl;            // ClassImpl.h
    class Builder;         // ClassBuilder.h
    class Constrainables;  // ClassConstrainables.h

    Class() = default;
    explicit Class(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The class behind `element`; empty if that is empty or something else.
    static Class cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Class create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
