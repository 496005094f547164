#include "tarnkiln/collections/GenericPrimitiveAssociativeInterface.h"

namespace tarn::kiln {

GenericPrimitiveAssociativeInterface::~GenericPrimitiveAssociativeInterface() = default;
}  // namespace tarn::kiln
