#include "tarnkiln/support/Unbuilt.h"

#include "tarnkiln/meta/Class.h"

namespace tarn::kiln::support {

meta::Class const& unbuiltClass()
{
    static meta::Class const none;
    return none;
}
}  // namespace tarn::kiln::support
