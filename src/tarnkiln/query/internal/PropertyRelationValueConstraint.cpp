#include "tarnkiln/query/internal/PropertyRelationValueConstraint.h"

#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/ClassImpl.h"

#include <algorithm>

namespace tarn::kiln::internal {

PropertyRelationValueConstraint::PropertyRelationValueConstraint(meta::Property const& property,
                                                                 ValueMatchRelation relation,
                                                                 Value const& value,
                                                                 Comparator const& comparator,
                                                                 ReflectionPrivateTag const& tag)
    : m_property(property),
      m_relation(relation),
      m_value(value),
      m_comparator(comparator),
      m_tag(tag)
{}

bool PropertyRelationValueConstraint::matches(ModelElement const& element) const
{
    return matches(element, m_comparator);
}

bool PropertyRelationValueConstraint::matches(ModelElement const& element,
                                              Comparator const& comparator) const
{
    Value const value = element->getPropertyValue(m_property, m_tag);
    if (m_property->getUpper() < 2)
        return comparator(value, m_value);

    auto const holds = [&](Value const& entry) { return comparator(entry, m_value); };
    meta::Type const type = m_property->getType();
    if (type->getMetaClass() == meta::Class::metaClass())
    {
        std::vector<ModelElement> const entries =
            value.getValue<ReferenceCollection&>().getAllValues();
        return std::any_of(entries.begin(), entries.end(), [&](ModelElement const& entry) {
            return holds(Value::createElementValue(m_property, entry));
        });
    }
    std::vector<Value> const entries =
        value.getValue<AbstractPrimitiveCollection&>().getAllValues();
    return std::any_of(entries.begin(), entries.end(), holds);
}

void PropertyRelationValueConstraint::retarget(std::size_t instance,
                                               RetargetableQuery& target) const
{
    target.addValueConstraint(m_property, m_relation, m_value, instance);
}
}  // namespace tarn::kiln::internal
