#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/TypeImpl.h"
#include "tarnkiln/meta/internal/qualify.h"

namespace tarn::kiln::meta {

ustring Type::Impl::getQualifiedName() const
{
    Package const package = getOwningPackage();
    return package ? internal::qualify(package->getQualifiedName(), getName()) : getName();
}

ustring Type::Impl::identifier() const
{
    return getQualifiedName();
}

bool Type::Impl::isA(Type const& other) const
{
    return other.getImpl() == this;
}
}  // namespace tarn::kiln::meta
