// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a keyed value of an attribute map.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// One entry of an `AttributeMap`, of any value type.
///
/// Abstract: there is one class for each value type. The map owns its attributes and keys them by
/// their key.
///
/// The handle is shared: copies refer to the same attribute; it is false when empty or when the
/// attribute was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Attribute : public ModelElement
{
public:
    class Impl;            // AttributeImpl.h
    class Builder;         // AttributeBuilder.h
    class Constrainables;  // AttributeConstrainables.h

    Attribute() = default;
    explicit Attribute(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The attribute behind `element`; empty if that is empty or something else.
    static Attribute cast(ModelElement const& element);
    static meta::Class const& metaClass();

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
