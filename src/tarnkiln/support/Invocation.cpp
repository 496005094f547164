#include "tarnkiln/support/Invocation.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/meta/OperationImpl.h"

namespace tarn::kiln::support {

using tarnkiln::messages::InvalidValue;

void requireArguments(std::vector<Value> const& arguments, std::size_t expected)
{
    if (arguments.size() != expected)
        reportException(InvalidValue());
}

void requireInstance(bool isInstance)
{
    if (!isInstance)
        reportException(InvalidValue());
}

meta::Type resultTypeOf(meta::Operation const& operation)
{
    return operation.getElementImpl() ? operation->getType() : meta::Type();
}
}  // namespace tarn::kiln::support
