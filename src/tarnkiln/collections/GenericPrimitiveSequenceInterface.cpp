#include "tarnkiln/collections/GenericPrimitiveSequenceInterface.h"

namespace tarn::kiln {

GenericPrimitiveSequenceInterface::~GenericPrimitiveSequenceInterface() = default;
}  // namespace tarn::kiln
