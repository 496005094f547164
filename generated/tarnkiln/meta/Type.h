// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a type.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/NamedElement.h"

namespace tarn::kiln::meta {

/// Whatever a property, an argument or a result can be typed by.
///
/// A package owns its types; the primitive types belong to none.
///
/// The handle is shared: copies refer to the same type; it is false when empty or when the type was
/// destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Type : public NamedElement
{
public:
    class Impl;            // TypeImpl.h
    class Builder;         // TypeBuilder.h
    class Constrainables;  // TypeConstrainables.h

    Type() = default;
    explicit Type(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The type behind `element`; empty if that is empty or something else.
    static Type cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Type create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
