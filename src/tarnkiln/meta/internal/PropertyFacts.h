/// \file
/// All that the storage of a property in reflective elements depends on.
#pragma once
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln::internal {

/// What a property and those that it refers to say, at one moment. As long as the facts of all
/// properties of a class stay the same, its elements can share a layout.
///
/// The pointers own nothing and resolve nothing; they are null where nothing live is referred to.
struct PropertyFacts
{
    explicit PropertyFacts(meta::Property::Impl const& property);
    bool operator==(PropertyFacts const& other) const = default;

    meta::Property::Impl const* property;
    meta::Type::Impl const* type;
    meta::Property::Impl const* opposite;
    meta::Property::Impl const* oppositeQualifier = nullptr;
    meta::Property::Impl const* qualifier;
    meta::Type::Impl const* qualifierType = nullptr;
    int index;
    bool isSingle;    ///< The upper bound is 1.
    bool isRequired;  ///< The lower bound is 1.
    bool isDerived;
    bool isOrdered;
    bool isUnique;
    bool isQualificationUnique;
    bool isContainer;  ///< The opposite is composite.
    bool hasDefault;
};
}  // namespace tarn::kiln::internal
