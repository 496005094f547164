// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of an operation of a type.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/TypedElement.h"

namespace tarn::kiln::meta {

/// An operation that elements or values of a `StructuredType` offer.
///
/// The type owns its operations; several may share a name. The operation owns its arguments; its
/// own type, bounds and order describe the result.
///
/// The handle is shared: copies refer to the same operation; it is false when empty or when the
/// operation was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Operation : public TypedElement
{
public:
    class Impl;            // OperationImpl.h
    class Builder;         // OperationBuilder.h
    class Constrainables;  // OperationConstrainables.h

    Operation() = default;
    explicit Operation(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The operation behind `element`; empty if that is empty or something else.
    static Operation cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Operation create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
