/// \file
/// Two properties of one element compared.
#pragma once
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/internal/SingleObjectConstraint.h"
#include "tarnkiln/query/internal/findComparator.h"

namespace tarn::kiln::internal {

/// One property of an element has the relation to another one of the same element.
class PropertyRelationPropertySingleObjectConstraint final : public SingleObjectConstraint
{
public:
    PropertyRelationPropertySingleObjectConstraint(meta::Property const& left,
                                                   ValueMatchRelation relation,
                                                   meta::Property const& right,
                                                   Comparator const& comparator,
                                                   ReflectionPrivateTag const& tag);

    /// \throws tarnkiln::query::PropertyRelationValueNotPrimitive  if one has many values.
    bool matches(ModelElement const& element) const override;
    void retarget(std::size_t instance, RetargetableQuery& target) const override;

private:
    meta::Property const m_left;
    ValueMatchRelation const m_relation;
    meta::Property const m_right;
    Comparator const& m_comparator;  ///< The registry's.
    ReflectionPrivateTag const& m_tag;
};
}  // namespace tarn::kiln::internal
