/// \file
/// The handle of the packages of one index.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace debian::model {

using namespace tarn::kiln;

/// All packages that an index names, each under its name.
///
/// Threads: as all elements.
class PackageIndex : public ModelElement
{
public:
    class Impl;  // PackageIndexImpl.h

    PackageIndex() = default;
    explicit PackageIndex(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The element as a PackageIndex; empty if that is empty or something else.
    static PackageIndex cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static PackageIndex create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace debian::model
