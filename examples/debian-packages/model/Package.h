/// \file
/// The handle of a package, real or virtual.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace debian::model {

using namespace tarn::kiln;

/// A name that dependencies can ask for.
///
/// A package that the index holds has releases; one that only exists because others provide it
/// has none.
///
/// Threads: as all elements.
class Package : public ModelElement
{
public:
    class Impl;  // PackageImpl.h

    Package() = default;
    explicit Package(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The element as a Package; empty if that is empty or something else.
    static Package cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Package create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace debian::model
