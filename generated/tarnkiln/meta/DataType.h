// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a type of plain values with fields.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/StructuredType.h"

namespace tarn::kiln::meta {

/// A structured type whose values have no identity and belong to whoever holds them.
///
/// Data types do not inherit; their properties are fields of the value and have no slot.
///
/// The handle is shared: copies refer to the same data type; it is false when empty or when the
/// data type was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT DataType : public StructuredType
{
public:
    class Impl;            // DataTypeImpl.h
    class Builder;         // DataTypeBuilder.h
    class Constrainables;  // DataTypeConstrainables.h

    DataType() = default;
    explicit DataType(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The data type behind `element`; empty if that is empty or something else.
    static DataType cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static DataType create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
