/// \file
/// How definitions make a property.
#pragma once
#include "tarnkiln/meta/PropertyBuilder.h"
#include "tarnkiln/meta/StructuredType.h"

namespace tarn::kiln::meta::internal {

/// A new property `name` of `owner`, without bounds.
inline Property defineProperty(StructuredType const& owner, ustring const& name, Type const& type)
{
    Property::Builder builder(owner.getElementImpl()->getModel());
    builder.setName(name).setType(type).setOwningType(owner);
    return Property::cast(builder.create());
}
}  // namespace tarn::kiln::meta::internal
