/// \file
/// Properties of two elements compared.
#pragma once
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/internal/JoinConstraint.h"
#include "tarnkiln/query/internal/findComparator.h"

namespace tarn::kiln::internal {

/// The left element's property has the relation to the right element's property.
///
/// Collections are compared like other values: they are equal if they are the same object.
class PropertyRelationPropertyJoinConstraint final : public JoinConstraint
{
public:
    PropertyRelationPropertyJoinConstraint(meta::Property const& left, std::size_t leftInstance,
                                           ValueMatchRelation relation, meta::Property const& right,
                                           std::size_t rightInstance, Comparator const& comparator,
                                           ReflectionPrivateTag const& tag);

    std::vector<std::size_t> getInstanceIds() const override;
    bool matches(std::vector<ModelElement> const& row,
                 std::vector<std::size_t> const& ids) const override;
    void retarget(RetargetableQuery& target) const override;

    ValueMatchRelation getRelation() const { return m_relation; }
    std::size_t getLeftInstance() const { return m_leftInstance; }
    std::size_t getRightInstance() const { return m_rightInstance; }
    meta::Property const& getLeft() const { return m_left; }
    meta::Property const& getRight() const { return m_right; }
    Value readLeft(ModelElement const& element) const;
    Value readRight(ModelElement const& element) const;
    Comparator const& getComparator() const { return m_comparator; }

private:
    meta::Property const m_left;
    std::size_t const m_leftInstance;
    ValueMatchRelation const m_relation;
    meta::Property const m_right;
    std::size_t const m_rightInstance;
    Comparator const& m_comparator;  ///< The registry's.
    ReflectionPrivateTag const& m_tag;
};
}  // namespace tarn::kiln::internal
