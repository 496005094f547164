#include "tarnkiln/meta/AbstractMethodInvoker.h"

#include "tarnkiln/meta/OperationImpl.h"

namespace tarn::kiln::meta {

AbstractMethodInvoker::~AbstractMethodInvoker() = default;

Operation AbstractMethodInvoker::getOperation() const
{
    return Operation(m_operation);
}
}  // namespace tarn::kiln::meta
