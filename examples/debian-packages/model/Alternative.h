/// \file
/// The handle of one way to satisfy a dependency.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace debian::model {

using namespace tarn::kiln;

/// A package that satisfies a dependency, if its version is right.
///
/// A package that the index does not hold is a proxy into the model "packages:available".
///
/// Threads: as all elements.
class Alternative : public ModelElement
{
public:
    class Impl;  // AlternativeImpl.h

    Alternative() = default;
    explicit Alternative(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The element as a Alternative; empty if that is empty or something else.
    static Alternative cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Alternative create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace debian::model
