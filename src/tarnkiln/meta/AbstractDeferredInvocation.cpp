#include "tarnkiln/meta/AbstractDeferredInvocation.h"

namespace tarn::kiln::meta {

AbstractDeferredInvocation::~AbstractDeferredInvocation() = default;
}  // namespace tarn::kiln::meta
