/// \file
/// The handle of one version of a package for one architecture.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace debian::model {

using namespace tarn::kiln;

/// One version of a package, built for one architecture.
///
/// Threads: as all elements.
class Release : public ModelElement
{
public:
    class Impl;  // ReleaseImpl.h

    Release() = default;
    explicit Release(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The element as a Release; empty if that is empty or something else.
    static Release cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Release create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace debian::model
