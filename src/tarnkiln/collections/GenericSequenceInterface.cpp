#include "tarnkiln/collections/GenericSequenceInterface.h"

namespace tarn::kiln {

GenericSequenceInterface::~GenericSequenceInterface() = default;
}  // namespace tarn::kiln
