#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/internal/qualify.h"

#include <memory>

namespace tarn::kiln::meta {

namespace {

/// The view in `field`, which is made at its first use. What the package holds is loaded by its own
/// collection.
template <class T>
SubsettedElementSet<T>& typesOf(Package::Impl const& package,
                                support::LazyCollection<SubsettedElementSet<T>>& field,
                                Slot const& slot)
{
    auto& all = package.getOwnedTypes();
    if (!field.get())
        field.publish(std::make_unique<SubsettedElementSet<T>>(all, slot));
    return *field.get();
}
}  // namespace

SubsettedElementSet<Enum>& Package::Impl::getEnumerations() const
{
    return typesOf(*this, m_enumerations, ENUMERATIONS);
}

SubsettedElementSet<Class>& Package::Impl::getClasses() const
{
    return typesOf(*this, m_classes, CLASSES);
}

SubsettedElementSet<DataType>& Package::Impl::getDataTypes() const
{
    return typesOf(*this, m_dataTypes, DATA_TYPES);
}

SubsettedElementSet<PrimitiveType>& Package::Impl::getPrimitiveTypes() const
{
    return typesOf(*this, m_primitiveTypes, PRIMITIVE_TYPES);
}

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
