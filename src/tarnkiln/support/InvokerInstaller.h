/// \file
/// What the rows of a metamodel name to make an operation callable by reflection.
#pragma once
#include "tarnkiln/meta/InvokerImpl.h"

#include <memory>

namespace tarn::kiln::support {

/// Makes an invoker of `METHOD`, a pointer to a member function, whatever the operation is.
template <auto METHOD>
std::unique_ptr<meta::AbstractMethodInvoker> makeInvokerOf(meta::Operation const& /*operation*/)
{
    return meta::makeInvoker(METHOD);
}
}  // namespace tarn::kiln::support
