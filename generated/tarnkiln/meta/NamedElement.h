// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of an element with a name.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::meta {

/// An element that has a name.
///
/// What a name must be unique among is the affair of the derived classes.
///
/// The handle is shared: copies refer to the same named element; it is false when empty or when the
/// named element was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT NamedElement : public ModelElement
{
public:
    class Impl;            // NamedElementImpl.h
    class Builder;         // NamedElementBuilder.h
    class Constrainables;  // NamedElementConstrainables.h

    NamedElement() = default;
    explicit NamedElement(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The named element behind `element`; empty if that is empty or something else.
    static NamedElement cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static NamedElement create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
