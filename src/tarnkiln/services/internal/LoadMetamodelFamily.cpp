#include "tarnkiln/services/internal/LoadMetamodelFamily.h"

namespace tarn::kiln::internal {

void loadMetamodelFamily(ustring const&) {}
}  // namespace tarn::kiln::internal
