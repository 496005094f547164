/// \file
/// A property of an element compared with a value.
#pragma once
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/internal/SingleObjectConstraint.h"
#include "tarnkiln/query/internal/findComparator.h"

namespace tarn::kiln::internal {

/// The property's value, or one of its values, has the relation to a given one.
class PropertyRelationValueConstraint final : public SingleObjectConstraint
{
public:
    PropertyRelationValueConstraint(meta::Property const& property, ValueMatchRelation relation,
                                    Value const& value, Comparator const& comparator,
                                    ReflectionPrivateTag const& tag);

    bool matches(ModelElement const& element) const override;
    void retarget(std::size_t instance, RetargetableQuery& target) const override;
    /// The same with another comparator, one that does the same work with less effort.
    bool matches(ModelElement const& element, Comparator const& comparator) const;

    meta::Property const& getProperty() const { return m_property; }
    ValueMatchRelation getRelation() const { return m_relation; }
    Value const& getValue() const { return m_value; }
    Comparator const& getComparator() const { return m_comparator; }

private:
    meta::Property const m_property;
    ValueMatchRelation const m_relation;
    Value const m_value;
    Comparator const& m_comparator;  ///< The registry's.
    ReflectionPrivateTag const& m_tag;
};
}  // namespace tarn::kiln::internal
