#include "tarnkiln/meta/PropertyDefinition.h"

#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/defineProperty.h"

namespace tarn::kiln::meta {
namespace {

constexpr unsigned UNBOUNDED = 0xFFFFFFFF;
}

PropertyDefinition::PropertyDefinition(Property const& property) : m_property(property) {}

PropertyDefinition& PropertyDefinition::bounds(unsigned lower, unsigned upper, bool ordered)
{
    m_property->setLower(lower);
    m_property->setUpper(upper);
    m_property->setIsOrdered(ordered);
    return *this;
}

PropertyDefinition& PropertyDefinition::required()
{
    return bounds(1, 1, /*ordered=*/false);
}

PropertyDefinition& PropertyDefinition::optional()
{
    return bounds(0, 1, /*ordered=*/false);
}

PropertyDefinition& PropertyDefinition::many()
{
    return bounds(0, UNBOUNDED, /*ordered=*/false);
}

PropertyDefinition& PropertyDefinition::sequence()
{
    return bounds(0, UNBOUNDED, /*ordered=*/true);
}

PropertyDefinition& PropertyDefinition::unique()
{
    m_property->setIsUnique(true);
    return *this;
}

PropertyDefinition& PropertyDefinition::keyedBy(Property const& key)
{
    m_property->setQualifiedBy(key);
    return many();
}

PropertyDefinition& PropertyDefinition::manyPerKey()
{
    m_property->setIsQualificationUnique(false);
    return *this;
}

PropertyDefinition& PropertyDefinition::defaultValue(ustring const& text)
{
    m_property->setDefaultValue(text);
    return *this;
}

PropertyDefinition& PropertyDefinition::readOnly()
{
    m_property->setIsReadOnly(true);
    return *this;
}

PropertyDefinition& PropertyDefinition::setOnce()
{
    m_property->setIsSetOnce(true);
    return readOnly();
}

PropertyDefinition& PropertyDefinition::transient()
{
    m_property->setIsTransient(true);
    return *this;
}

PropertyDefinition& PropertyDefinition::derived()
{
    m_property->setIsDerived(true);
    return *this;
}

PropertyDefinition PropertyDefinition::opposite(ustring const& name)
{
    PropertyDefinition other(internal::defineProperty(StructuredType::cast(m_property->getType()),
                                                      name, m_property->getOwningType()));
    other.optional();
    m_property->setOpposite(other.m_property);
    other.m_property->setOpposite(m_property);
    return other;
}
}  // namespace tarn::kiln::meta
