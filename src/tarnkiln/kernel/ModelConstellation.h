/// \file
/// The handle of a constellation of models.
#pragma once
#include "tarnkiln/kernel/ElementHandle.h"

namespace tarn::kiln {

/// The models that may refer to each other and that change together.
///
/// A constellation and its models live for as long as anyone holds a handle to any of them.
///
/// Threads: belongs to the thread of its models.
class TARNKILN_EXPORT ModelConstellation : public ElementHandle
{
public:
    class Impl;  // ModelConstellationImpl.h

    ModelConstellation() = default;
    explicit ModelConstellation(Impl* impl);

    static ModelConstellation create();

    /// The class by which values that hold constellations are typed.
    static meta::Class const& metaClass();
    /// Creates that class; called once, when the registry starts.
    static void initializeType(meta::MetaRegistry& registry);

    Impl* getImpl() const;
    Impl* operator->() const;
};
}  // namespace tarn::kiln
