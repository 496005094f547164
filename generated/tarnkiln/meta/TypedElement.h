// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of an element with a type and a multiplicity.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/NamedElement.h"

namespace tarn::kiln::meta {

/// An element that has a type, a lower and an upper bound.
///
/// An upper bound of 0xFFFFFFFF means unbounded.
///
/// The handle is shared: copies refer to the same typed element; it is false when empty or when the
/// typed element was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT TypedElement : public NamedElement
{
public:
    class Impl;            // TypedElementImpl.h
    class Builder;         // TypedElementBuilder.h
    class Constrainables;  // TypedElementConstrainables.h

    TypedElement() = default;
    explicit TypedElement(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The typed element behind `element`; empty if that is empty or something else.
    static TypedElement cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static TypedElement create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
