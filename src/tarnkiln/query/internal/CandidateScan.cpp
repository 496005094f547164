#include "tarnkiln/query/internal/CandidateScan.h"

#include "tarnkiln/kernel/ModelImpl.h"

#include <algorithm>
#include <typeinfo>

namespace tarn::kiln::internal {
namespace {

// How far ahead memory is asked for: the elements of a model lie anywhere.
constexpr std::size_t FAR_AHEAD = 16;
constexpr std::size_t NEAR_AHEAD = 8;

}  // namespace

CandidateScan::CandidateScan(NativeQueryState const& query, RegexCache& regexes)
    : m_query(query),
      m_regexes(regexes),
      m_kinds(query, regexes)
{}

bool CandidateScan::mayStopEarly() const
{
    auto const& constraints = m_query.instances.front()->constraints;
    return m_query.instances.size() == 1 && m_query.joins.empty() &&
           std::all_of(constraints.begin() + 1, constraints.end(), [](auto const& constraint) {
               return dynamic_cast<IsTopLevelElementConstraint const*>(constraint.get());
           });
}

void CandidateScan::run(std::size_t enough)
{
    m_candidates.resize(m_query.instances.size());
    m_elements = m_query.model->getAllElementImpls();
    constexpr std::size_t ALL = ~std::size_t{0};
    std::size_t const most = enough != 0 && mayStopEarly() ? enough : ALL;
    for (std::size_t number = 0; number < m_elements.size(); ++number)
    {
        prefetch(number);
        ModelElement::Impl& element = *m_elements[number];
        ElementKind const& kind = m_kinds.kindOf(element);
        for (InstanceTests const& instance : kind.instances)
        {
            m_usualKind = &kind;
            if (!std::all_of(instance.tests.begin(), instance.tests.end(),
                             [&](ElementTest const& test) { return passes(test, element); }))
                continue;
            m_candidates[instance.instance].push_back(&element);
            if (m_candidates[instance.instance].size() >= most)
                return;
        }
    }
}

/// Asks for what will be read soon, on the guess that most elements are of the kind of the last one
/// that was tested.
void CandidateScan::prefetch(std::size_t number) const
{
    if (number + FAR_AHEAD >= m_elements.size())
        return;
    ModelElement::Impl const& later = *m_elements[number + FAR_AHEAD];
    __builtin_prefetch(&later);
    if (!m_usualKind)
        return;
    if (!m_usualKind->isReflective)
    {
        __builtin_prefetch(reinterpret_cast<char const*>(&later) + m_usualKind->touched);
        return;
    }
    __builtin_prefetch(&later + 1);
    ModelElement::Impl const& sooner = *m_elements[number + NEAR_AHEAD];
    if (typeid(sooner) == typeid(ReflectiveModelElementImpl))
        __builtin_prefetch(&cellsOf(sooner));
}

bool CandidateScan::passes(ElementTest const& test, ModelElement::Impl& element)
{
    KeptValue const kept = test.place.read(element);
    switch (test.test.answerFor(kept.shape))
    {
    case ValueTest::Answer::No:
        return false;
    case ValueTest::Answer::Yes:
        return true;
    case ValueTest::Answer::Compare:
        return test.test.compare(kept.payload, test.test.other);
    case ValueTest::Answer::Ask:
        break;
    }
    return test.isTopLevel ? element.isTopLevel() : ask(test, element);
}

bool CandidateScan::ask(ElementTest const& test, ModelElement::Impl& element)
{
    if (!m_holdsAll)
    {
        m_held.reserve(m_elements.size());
        for (ModelElement::Impl* const each : m_elements)
            m_held.emplace_back(each);
        m_holdsAll = true;
    }
    ModelElement const handle(&element);
    if (!test.valueConstraint)
        return test.constraint->matches(handle);
    return test.valueConstraint->matches(
        handle, m_regexes.withCache(test.valueConstraint->getComparator()));
}

void CandidateScan::holdCandidates()
{
    if (m_holdsAll)
        return;
    for (auto const& candidates : m_candidates)
    {
        for (ModelElement::Impl* const candidate : candidates)
            m_held.emplace_back(candidate);
    }
}
}  // namespace tarn::kiln::internal
