#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"

#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <algorithm>

namespace tarn::kiln::internal {
namespace {

/// Whether an entry is `target`, or stands in for what has its UUID.
bool isMeant(ModelElement const& target, ModelElement const& entry)
{
    if (!entry || !entry->isProxy())
        return entry == target;
    UUID const* const named = entry->getStandIn()->getUuid();
    return named && *named == target->getUuid();
}
}  // namespace

JoinConstraint::~JoinConstraint() = default;

AssociatedObjectConstraint::AssociatedObjectConstraint(meta::Property const& property,
                                                       std::size_t source, std::size_t target,
                                                       ReflectionPrivateTag const& tag)
    : m_property(property),
      m_source(source),
      m_target(target),
      m_tag(tag)
{}

std::vector<std::size_t> AssociatedObjectConstraint::getInstanceIds() const
{
    return {m_source, m_target};
}

bool AssociatedObjectConstraint::isOfSingleReference() const
{
    if (!m_property || m_property->getUpper() != 1)
        return false;
    auto const* const type = classImpl(m_property->getType());
    return type && type->isLive() && type->isA(ModelElement::metaClass());
}

std::vector<ModelElement>
AssociatedObjectConstraint::readReferences(ModelElement const& source) const
{
    Value const value = source->getPropertyValue(m_property, m_tag);
    if (m_property->getUpper() == 1)
        return {value.getValue<ModelElement>()};
    return value.getValue<ReferenceCollection&>().getAllValuesAndProxies();
}

bool AssociatedObjectConstraint::matches(std::vector<ModelElement> const& row,
                                         std::vector<std::size_t> const& ids) const
{
    ModelElement const& target = elementOf(m_target, row, ids);
    std::vector<ModelElement> const entries = readReferences(elementOf(m_source, row, ids));
    return std::any_of(entries.begin(), entries.end(),
                       [&](ModelElement const& entry) { return isMeant(target, entry); });
}

void AssociatedObjectConstraint::retarget(RetargetableQuery& target) const
{
    target.addAssociatedObjectConstraint(m_property, m_source, m_target);
}
}  // namespace tarn::kiln::internal
