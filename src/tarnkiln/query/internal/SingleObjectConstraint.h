/// \file
/// What must hold for one element, and the two constraints that ask for no property.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/query/RetargetableQuery.h"

#include <cstddef>

namespace tarn::kiln::internal {

using query::RetargetableQuery;
using query::SearchClassMatchMode;
using query::ValueMatchRelation;

/// A constraint on the elements of one search instance.
class TARNKILN_TESTED SingleObjectConstraint
{
public:
    SingleObjectConstraint(SingleObjectConstraint const&) = delete;
    SingleObjectConstraint& operator=(SingleObjectConstraint const&) = delete;
    virtual ~SingleObjectConstraint();

    virtual bool matches(ModelElement const& element) const = 0;
    /// Adds the same constraint to an instance of `target`.
    virtual void retarget(std::size_t instance, RetargetableQuery& target) const = 0;

protected:
    SingleObjectConstraint() = default;
};

/// The element is of a class; the first constraint of each search instance.
class IsAConstraint final : public SingleObjectConstraint
{
public:
    /// \param searchClass  the handle in the search instance, which outlives the constraint.
    IsAConstraint(meta::Class const& searchClass, SearchClassMatchMode mode);

    bool matches(ModelElement const& element) const override;
    /// Adds nothing: `addSearchClass` did.
    void retarget(std::size_t instance, RetargetableQuery& target) const override;
    /// Whether elements of `metaClass`, which may be empty, match.
    bool matchesClass(meta::Class const& metaClass) const;

private:
    meta::Class const& m_class;
    SearchClassMatchMode const m_mode;
};

/// The element has no container.
class IsTopLevelElementConstraint final : public SingleObjectConstraint
{
public:
    bool matches(ModelElement const& element) const override;
    void retarget(std::size_t instance, RetargetableQuery& target) const override;
};
}  // namespace tarn::kiln::internal
