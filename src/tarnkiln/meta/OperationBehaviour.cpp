#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/OperationImpl.h"

namespace tarn::kiln::meta {

void Operation::Impl::setInvoker(std::unique_ptr<AbstractMethodInvoker> invoker)
{
    if (invoker)
        invoker->m_operation = this;
    m_invoker = std::move(invoker);
}
}  // namespace tarn::kiln::meta
