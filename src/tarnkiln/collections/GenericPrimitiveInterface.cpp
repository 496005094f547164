#include "tarnkiln/collections/GenericPrimitiveInterface.h"

namespace tarn::kiln {

GenericPrimitiveInterface::~GenericPrimitiveInterface() = default;
}  // namespace tarn::kiln
