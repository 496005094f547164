// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of one argument of an operation.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/TypedElement.h"

namespace tarn::kiln::meta {

/// One argument of an `Operation`.
///
/// The operation owns its arguments and keeps them in the order of the call.
///
/// The handle is shared: copies refer to the same argument; it is false when empty or when the
/// argument was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Argument : public TypedElement
{
public:
    class Impl;            // ArgumentImpl.h
    class Builder;         // ArgumentBuilder.h
    class Constrainables;  // ArgumentConstrainables.h

    Argument() = default;
    explicit Argument(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The argument behind `element`; empty if that is empty or something else.
    static Argument cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Argument create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
