#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StructuredTypeImpl.h"

namespace tarn::kiln::meta {

Property StructuredType::Impl::getPropertyByName(ustring const& name) const
{
    return getOwnedAttributes().find(name);
}

std::vector<Operation> StructuredType::Impl::getOperationsByName(ustring const& name) const
{
    std::vector<Operation> operations = getOwnedOperations().find(name);
    std::erase_if(operations, [](Operation const& operation) { return !operation; });
    return operations;
}

bool StructuredType::Impl::isATypeOf(Property const& property) const
{
    return property && property->getOwningTypeImpl() == this;
}
}  // namespace tarn::kiln::meta
