/// \file
/// What the bodies of all handle classes share.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"

namespace tarn::kiln::support {

/// Makes an element and enters it in its model.
template <class Handle> Handle create(Model const& model, UUID const& id)
{
    Handle const handle(new typename Handle::Impl(model, id));
    handle.getImpl()->notifyCreated();
    return handle;
}

/// `element` as a `Handle`; empty if it is empty or of another class.
template <class Handle> Handle cast(ModelElement const& element)
{
    return Handle(dynamic_cast<typename Handle::Impl*>(element.getImpl()));
}
}  // namespace tarn::kiln::support
