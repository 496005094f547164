// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of an attribute that holds a text.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Attribute.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// An `Attribute` whose value is a text.
///
/// The handle is shared: copies refer to the same string attribute; it is false when empty or when
/// the string attribute was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT StringAttribute : public Attribute
{
public:
    class Impl;            // StringAttributeImpl.h
    class Builder;         // StringAttributeBuilder.h
    class Constrainables;  // StringAttributeConstrainables.h

    StringAttribute() = default;
    explicit StringAttribute(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The string attribute behind `element`; empty if that is empty or something else.
    static StringAttribute cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static StringAttribute create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
