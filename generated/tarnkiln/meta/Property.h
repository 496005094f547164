// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a property of a type.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/TypedElement.h"

namespace tarn::kiln::meta {

/// One property of a `StructuredType`: what a slot of its elements may hold and how it behaves.
///
/// The type owns its properties and keys them by name. An upper bound of 0xFFFFFFFF means
/// unbounded.
///
/// The handle is shared: copies refer to the same property; it is false when empty or when the
/// property was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Property : public TypedElement
{
public:
    class Impl;            // PropertyImpl.h
    class Builder;         // PropertyBuilder.h
    class Constrainables;  // PropertyConstrainables.h

    Property() = default;
    explicit Property(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The property behind `element`; empty if that is empty or something else.
    static Property cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Property create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
