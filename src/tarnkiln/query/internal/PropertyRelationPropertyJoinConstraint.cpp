#include "tarnkiln/query/internal/PropertyRelationPropertyJoinConstraint.h"

#include "tarnkiln/kernel/ModelElementImpl.h"

namespace tarn::kiln::internal {

PropertyRelationPropertyJoinConstraint::PropertyRelationPropertyJoinConstraint(
    meta::Property const& left, std::size_t leftInstance, ValueMatchRelation relation,
    meta::Property const& right, std::size_t rightInstance, Comparator const& comparator,
    ReflectionPrivateTag const& tag)
    : m_left(left),
      m_leftInstance(leftInstance),
      m_relation(relation),
      m_right(right),
      m_rightInstance(rightInstance),
      m_comparator(comparator),
      m_tag(tag)
{}

std::vector<std::size_t> PropertyRelationPropertyJoinConstraint::getInstanceIds() const
{
    return {m_leftInstance, m_rightInstance};
}

bool PropertyRelationPropertyJoinConstraint::matches(std::vector<ModelElement> const& row,
                                                     std::vector<std::size_t> const& ids) const
{
    Value const left = readLeft(elementOf(m_leftInstance, row, ids));
    Value const right = readRight(elementOf(m_rightInstance, row, ids));
    return m_comparator(left, right);
}

void PropertyRelationPropertyJoinConstraint::retarget(RetargetableQuery& target) const
{
    target.addPropertyRelation(m_left, m_relation, m_right, m_leftInstance, m_rightInstance);
}

Value PropertyRelationPropertyJoinConstraint::readLeft(ModelElement const& element) const
{
    return element->getPropertyValue(m_left, m_tag);
}

Value PropertyRelationPropertyJoinConstraint::readRight(ModelElement const& element) const
{
    return element->getPropertyValue(m_right, m_tag);
}
}  // namespace tarn::kiln::internal
