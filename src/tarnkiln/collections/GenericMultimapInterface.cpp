#include "tarnkiln/collections/GenericMultimapInterface.h"

namespace tarn::kiln {

GenericMultimapInterface::~GenericMultimapInterface() = default;
}  // namespace tarn::kiln
