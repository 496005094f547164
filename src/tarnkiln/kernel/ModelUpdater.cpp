#include "tarnkiln/kernel/ModelUpdater.h"

namespace tarn::kiln {

ModelUpdater::~ModelUpdater() = default;
}  // namespace tarn::kiln
