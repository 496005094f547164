// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a type with properties and operations.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::meta {

/// A type that has properties and operations: a `Class` or a `DataType`.
///
/// It owns both and keys them by name; operations may share one.
///
/// The handle is shared: copies refer to the same structured type; it is false when empty or when
/// the structured type was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT StructuredType : public Type
{
public:
    class Impl;            // StructuredTypeImpl.h
    class Builder;         // StructuredTypeBuilder.h
    class Constrainables;  // StructuredTypeConstrainables.h

    StructuredType() = default;
    explicit StructuredType(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The structured type behind `element`; empty if that is empty or something else.
    static StructuredType cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static StructuredType create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
