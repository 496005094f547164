#include "tarnkiln/query/RetargetableQuery.h"

namespace tarn::kiln::query {

RetargetableQuery::~RetargetableQuery() = default;
}  // namespace tarn::kiln::query
