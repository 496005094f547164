// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of a package of types.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/NamedElement.h"

namespace tarn::kiln::meta {

/// A named group of types and of further packages.
///
/// The package owns both and keys them by name. Types are known by the path of package names that
/// leads to them; the root package has the empty name and is known by its URI.
///
/// The handle is shared: copies refer to the same package; it is false when empty or when the
/// package was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT Package : public NamedElement
{
public:
    class Impl;            // PackageImpl.h
    class Builder;         // PackageBuilder.h
    class Constrainables;  // PackageConstrainables.h

    Package() = default;
    explicit Package(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The package behind `element`; empty if that is empty or something else.
    static Package cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Package create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
