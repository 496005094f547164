/// \file
/// The handle of one dependency of a release.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace debian::model {

using namespace tarn::kiln;

/// A dependency that any one of its alternatives satisfies.
///
/// Threads: as all elements.
class DependencyGroup : public ModelElement
{
public:
    class Impl;  // DependencyGroupImpl.h

    DependencyGroup() = default;
    explicit DependencyGroup(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The element as a DependencyGroup; empty if that is empty or something else.
    static DependencyGroup cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static DependencyGroup create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace debian::model
