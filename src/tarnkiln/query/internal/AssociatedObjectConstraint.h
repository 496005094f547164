/// \file
/// One element refers to another.
#pragma once
#include "tarnkiln/kernel/ReflectionPrivateTag.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/internal/JoinConstraint.h"

namespace tarn::kiln::internal {

/// A property of the source refers to the target, or to a stand-in with the target's UUID.
///
/// Nothing is resolved: stand-ins are compared as they are.
class AssociatedObjectConstraint final : public JoinConstraint
{
public:
    AssociatedObjectConstraint(meta::Property const& property, std::size_t source,
                               std::size_t target, ReflectionPrivateTag const& tag);

    std::vector<std::size_t> getInstanceIds() const override;
    bool matches(std::vector<ModelElement> const& row,
                 std::vector<std::size_t> const& ids) const override;
    void retarget(RetargetableQuery& target) const override;

    meta::Property const& getProperty() const { return m_property; }
    std::size_t getSource() const { return m_source; }
    std::size_t getTarget() const { return m_target; }
    /// Whether the property has one value, and that certainly is an element.
    bool isOfSingleReference() const;
    /// What the property of `source` refers to; stand-ins, empty and dead handles too.
    std::vector<ModelElement> readReferences(ModelElement const& source) const;

private:
    meta::Property const m_property;
    std::size_t const m_source;
    std::size_t const m_target;
    ReflectionPrivateTag const& m_tag;
};
}  // namespace tarn::kiln::internal
