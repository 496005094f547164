#include "tarnkiln/query/NativeTarnkilnQuery.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/query/Messages.h"
#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"
#include "tarnkiln/query/internal/FastEngine.h"
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/NativeResultIterator.h"
#include "tarnkiln/query/internal/PropertyRelationPropertyJoinConstraint.h"
#include "tarnkiln/query/internal/PropertyRelationPropertySingleObjectConstraint.h"
#include "tarnkiln/query/internal/PropertyRelationValueConstraint.h"
#include "tarnkiln/query/internal/findComparator.h"
#include "tarnkiln/query/internal/likePattern.h"

#include <utility>

namespace tarn::kiln::query {

using namespace tarnkiln::query;
using internal::NativeQueryState;

NativeTarnkilnQuery::NativeTarnkilnQuery(Model const& model)
    : m_state(std::make_unique<NativeQueryState>())
{
    m_state->model = model;
}

NativeTarnkilnQuery::~NativeTarnkilnQuery() = default;

void NativeTarnkilnQuery::reset()
{
    m_state->instances.clear();
    m_state->joins = internal::JoinMap();
    m_state->limit = 0;
    m_state->offset = 0;
}

std::size_t NativeTarnkilnQuery::addSearchClass(meta::Class const& searchClass,
                                                SearchClassMatchMode mode)
{
    if (!searchClass)
        reportException(InvalidSearchClass());
    m_state->instances.push_back(std::make_unique<internal::SearchInstance>(searchClass, mode));
    return m_state->instances.size() - 1;
}

void NativeTarnkilnQuery::addValueConstraint(meta::Property const& property,
                                             ValueMatchRelation relation, Value const& value,
                                             std::size_t instance)
{
    if (instance >= m_state->instances.size())
        reportException(NoSuchInstanceId());
    TARNKILN_ASSERT(property.getElementImpl(), "only a property can be compared");
    if (value.getFlags() > ValueFlags::Single)
        reportException(PropertyRelationValueNotPrimitive());

    bool const isLike = relation == ValueMatchRelation::like;
    ValueMatchRelation const stored = isLike ? ValueMatchRelation::regexp : relation;
    Value const compared = isLike ? internal::likePattern(property, value) : value;
    auto const* const comparator = internal::findComparator(stored, property, relation);
    m_state->instances[instance]->constraints.push_back(
        std::make_unique<internal::PropertyRelationValueConstraint>(property, stored, compared,
                                                                    *comparator, privilegedTag));
}

void NativeTarnkilnQuery::addPropertyRelation(meta::Property const& left,
                                              ValueMatchRelation relation,
                                              meta::Property const& right, std::size_t leftInstance,
                                              std::size_t rightInstance)
{
    TARNKILN_ASSERT(left.getElementImpl() && right.getElementImpl(),
                    "only properties can be compared");
    m_state->checkInstance(leftInstance);
    m_state->checkInstance(rightInstance);
    if (left->getType() != right->getType())
        reportException(PropertyRelationPropertyTypeMismatch());

    auto const* const comparator = internal::findComparator(relation, left, relation);
    if (leftInstance == rightInstance)
        m_state->instances[leftInstance]->constraints.push_back(
            std::make_unique<internal::PropertyRelationPropertySingleObjectConstraint>(
                left, relation, right, *comparator, privilegedTag));
    else
        m_state->fileJoin(std::make_unique<internal::PropertyRelationPropertyJoinConstraint>(
            left, leftInstance, relation, right, rightInstance, *comparator, privilegedTag));
}

void NativeTarnkilnQuery::addTopLevelConstraint(std::size_t instance)
{
    m_state->checkInstance(instance);
    m_state->instances[instance]->constraints.push_back(
        std::make_unique<internal::IsTopLevelElementConstraint>());
}

void NativeTarnkilnQuery::addAssociatedObjectConstraint(meta::Property const& property,
                                                        std::size_t source, std::size_t target)
{
    TARNKILN_ASSERT(property.getElementImpl(), "only a property can refer to something");
    m_state->checkInstance(source);
    m_state->checkInstance(target);
    // No other tag leaves proxies as they stand.
    m_state->fileJoin(std::make_unique<internal::AssociatedObjectConstraint>(
        property, source, target, ModelElement::Impl::NO_PROXY_RESOLVE));
}

void NativeTarnkilnQuery::setResultLimit(std::size_t limit)
{
    m_state->limit = limit;
}

void NativeTarnkilnQuery::setResultOffset(std::size_t offset)
{
    m_state->offset = offset;
}

std::vector<ModelElement>
NativeTarnkilnQuery::getFirstResult(std::vector<std::size_t> const& columns)
{
    requireRunnable();
    std::vector<ModelElement> row;
    NativeResultIterator(run(columns, /*most=*/1)).next(row);
    return row;
}

std::unique_ptr<ReflectiveQuery::ResultIterator>
NativeTarnkilnQuery::getResultIterator(std::vector<std::size_t> const& columns)
{
    requireRunnable();
    return std::make_unique<NativeResultIterator>(run(columns, /*most=*/0));
}

std::size_t NativeTarnkilnQuery::getResultCount()
{
    requireRunnable();
    return m_engine ? m_engine(*m_state, {}).getRowCount() : internal::countFast(*m_state);
}

void NativeTarnkilnQuery::setModel(Model const& model)
{
    m_state->model = model;
}

void NativeTarnkilnQuery::retargetTo(RetargetableQuery& target) const
{
    target.reset();
    for (auto const& instance : m_state->instances)
    {
        std::size_t const id = target.addSearchClass(instance->searchClass, instance->mode);
        for (auto const& constraint : instance->constraints)
            constraint->retarget(id, target);
    }
    for (auto const& [ids, constraints] : m_state->joins)
    {
        for (auto const& constraint : constraints)
            constraint->retarget(target);
    }
    target.setResultLimit(m_state->limit);
    target.setResultOffset(m_state->offset);
}

Model NativeTarnkilnQuery::getModel() const
{
    return m_state->model;
}

void NativeTarnkilnQuery::useEngine(Engine engine)
{
    m_engine = engine;
}

internal::NativeResultSet NativeTarnkilnQuery::run(std::vector<std::size_t> const& columns,
                                                   std::size_t most) const
{
    return m_engine ? m_engine(*m_state, columns) : internal::runFast(*m_state, columns, most);
}

void NativeTarnkilnQuery::requireRunnable() const
{
    if (m_state->instances.empty())
        reportException(NoSearchInstances());
    if (!m_state->model)
        reportException(NoModel());
}

std::unique_ptr<NativeTarnkilnQuery> createNativeQuery()
{
    return createNativeQuery(Model());
}

std::unique_ptr<NativeTarnkilnQuery> createNativeQuery(Model const& model)
{
    return std::make_unique<NativeTarnkilnQuery>(model);
}
}  // namespace tarn::kiln::query
