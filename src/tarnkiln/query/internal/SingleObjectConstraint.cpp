#include "tarnkiln/query/internal/SingleObjectConstraint.h"

#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/meta/ClassImpl.h"

namespace tarn::kiln::internal {

SingleObjectConstraint::~SingleObjectConstraint() = default;

IsAConstraint::IsAConstraint(meta::Class const& searchClass, SearchClassMatchMode mode)
    : m_class(searchClass),
      m_mode(mode)
{}

bool IsAConstraint::matches(ModelElement const& element) const
{
    return matchesClass(element->getMetaClass());
}

bool IsAConstraint::matchesClass(meta::Class const& metaClass) const
{
    if (m_mode == SearchClassMatchMode::MatchExactClass)
        return metaClass == m_class;
    return metaClass.getElementImpl() && metaClass->isA(m_class);
}

void IsAConstraint::retarget(std::size_t /*instance*/, RetargetableQuery& /*target*/) const {}

bool IsTopLevelElementConstraint::matches(ModelElement const& element) const
{
    return element->isTopLevel();
}

void IsTopLevelElementConstraint::retarget(std::size_t instance, RetargetableQuery& target) const
{
    target.addTopLevelConstraint(instance);
}
}  // namespace tarn::kiln::internal
