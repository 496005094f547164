#include "tarnkiln/query/ModelElementConstrainables.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/RetargetableQuery.h"

namespace tarn::kiln {

ModelElement::Constrainables::Constrainables(query::AbstractQuery& query,
                                             meta::Class const& metaClass,
                                             query::SearchClassMatchMode mode)
    : m_query(&query),
      m_instanceId(query.getReflectiveQuery().addSearchClass(metaClass, mode))
{}

void ModelElement::Constrainables::isTopLevel() const
{
    m_query->getReflectiveQuery().addTopLevelConstraint(m_instanceId);
}

void ModelElement::Constrainables::constrain(meta::Property const& property,
                                             query::ValueMatchRelation relation,
                                             Value const& value) const
{
    m_query->getReflectiveQuery().addValueConstraint(property, relation, value, m_instanceId);
}

void ModelElement::Constrainables::constrain(meta::Property const& property,
                                             query::ValueMatchRelation relation,
                                             Constrainables const& other,
                                             meta::Property const& otherProperty) const
{
    requireSameQuery(other);
    m_query->getReflectiveQuery().addPropertyRelation(property, relation, otherProperty,
                                                      m_instanceId, other.m_instanceId);
}

void ModelElement::Constrainables::constrainTarget(meta::Property const& property,
                                                   Constrainables const& target) const
{
    requireSameQuery(target);
    m_query->getReflectiveQuery().addAssociatedObjectConstraint(property, m_instanceId,
                                                                target.m_instanceId);
}

void ModelElement::Constrainables::requireSameQuery(Constrainables const& other) const
{
    if (other.m_query != m_query)
        reportException(tarnkiln::query::NoSuchInstanceId());
}
}  // namespace tarn::kiln
