#include "tarnkiln/query/ReflectiveQuery.h"

#include "tarnkiln/kernel/ModelElementImpl.h"

namespace tarn::kiln::query {

internal::ReflectionPrivateTag const& ReflectiveQuery::privilegedTag =
    ModelElement::Impl::PRIVILEGED_ACCESS;

ReflectiveQuery::~ReflectiveQuery() = default;

ReflectiveQuery::ResultIterator::~ResultIterator() = default;
}  // namespace tarn::kiln::query
