#include "tarnkiln/collections/GenericMapInterface.h"

namespace tarn::kiln {

GenericMapInterface::~GenericMapInterface() = default;
}  // namespace tarn::kiln
