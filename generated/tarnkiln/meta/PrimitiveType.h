// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a type that the library knows by itself.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::meta {

/// A type of plain values without inner structure, such as integers and texts.
///
/// The handle is shared: copies refer to the same primitive type; it is false when empty or when
/// the primitive type was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT PrimitiveType : public Type
{
public:
    class Impl;            // PrimitiveTypeImpl.h
    class Builder;         // PrimitiveTypeBuilder.h
    class Constrainables;  // PrimitiveTypeConstrainables.h

    PrimitiveType() = default;
    explicit PrimitiveType(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The primitive type behind `element`; empty if that is empty or something else.
    static PrimitiveType cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static PrimitiveType create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
