#include "tarnkiln/query/internal/PropertyRelationPropertySingleObjectConstraint.h"

#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/Value.h"

namespace tarn::kiln::internal {

PropertyRelationPropertySingleObjectConstraint::PropertyRelationPropertySingleObjectConstraint(
    meta::Property const& left, ValueMatchRelation relation, meta::Property const& right,
    Comparator const& comparator, ReflectionPrivateTag const& tag)
    : m_left(left),
      m_relation(relation),
      m_right(right),
      m_comparator(comparator),
      m_tag(tag)
{}

bool PropertyRelationPropertySingleObjectConstraint::matches(ModelElement const& element) const
{
    Value const left = element->getPropertyValue(m_left, m_tag);
    Value const right = element->getPropertyValue(m_right, m_tag);
    if (left.getFlags() > ValueFlags::Single || right.getFlags() > ValueFlags::Single)
        reportException(tarnkiln::query::PropertyRelationValueNotPrimitive());
    return m_comparator(left, right);
}

void PropertyRelationPropertySingleObjectConstraint::retarget(std::size_t instance,
                                                              RetargetableQuery& target) const
{
    target.addPropertyRelation(m_left, m_relation, m_right, instance, instance);
}
}  // namespace tarn::kiln::internal
