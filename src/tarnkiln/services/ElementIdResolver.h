/// \file
/// Finds the element behind an identifier of a foreign type.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Fwd.h"
#include "tarnkiln/meta/Fwd.h"

namespace tarn::kiln::services {

/// A service that knows what the identifiers of some type mean.
///
/// Threads: called on the thread of the model.
class TARNKILN_EXPORT ElementIdResolver
{
public:
    virtual ~ElementIdResolver();
    /// The element of `model` that `id` names; not live if this resolver cannot help.
    virtual ModelElement resolveElement(Model const& model, meta::Class const& metaClass,
                                        ElementId const& id) = 0;

    /// The element of `model` that `id` names; empty if there is none.
    ///
    /// A UUID is looked for in memory and then by the model's data source, and counts only if the
    /// element is of exactly the class `metaClass`. After that, and for all other types of
    /// identifiers, the services for the type are asked, until one knows.
    static ModelElement doFindElement(Model const& model, meta::Class const& metaClass,
                                      ElementId const& id);
};
}  // namespace tarn::kiln::services
