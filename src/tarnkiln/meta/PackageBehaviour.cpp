#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/internal/qualify.h"

namespace tarn::kiln::meta {

ustring Package::Impl::getQualifiedName() const
{
    Package const parent = getParentPackage();
    return parent ? internal::qualify(parent->getQualifiedName(), getName()) : getName();
}

ustring Package::Impl::identifier() const
{
    return getQualifiedName();
}
}  // namespace tarn::kiln::meta
