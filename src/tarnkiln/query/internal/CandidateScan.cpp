#include "tarnkiln/query/internal/CandidateScan.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/query/internal/prefetch.h"

#include <algorithm>

namespace tarn::kiln::internal {

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

void CandidateScan::run(Keeps keeps, std::size_t enough)
{
    m_elements = m_query.model->getAllElementImpls();
    m_candidates.resize(m_query.instances.size());
    m_followed.resize(m_kinds.getFollowed().size());
    if (keeps == Keeps::Elements)
        reserve();
    constexpr std::size_t ALL = ~std::size_t{0};
    std::size_t const most = enough != 0 && mayStopEarly() ? enough : ALL;
    for (std::size_t begin = 0; begin < m_elements.size(); begin += BLOCK)
    {
        for (ElementList& candidates : m_candidates)
            candidates.makeRoom(BLOCK);
        for (Followed& followed : m_followed)
            followed.entries.makeRoom(BLOCK);
        scanBlock(begin, std::min(begin + BLOCK, m_elements.size()));
        keepCandidates(keeps);
        if (m_number >= most)
            return;
    }
}

void CandidateScan::reserve()
{
    for (ElementList& candidates : m_candidates)
        candidates.reserve(m_elements.size() + BLOCK);
    for (Followed& followed : m_followed)
        followed.entries.reserve(m_elements.size() + BLOCK);
}

/// Guesses that it is of the kind of the last one that was tested.
[[gnu::always_inline]] inline void CandidateScan::prefetchElement(std::size_t number) const
{
    if (number >= m_elements.size() || !m_usualKind)
        return;
    char const* const element = reinterpret_cast<char const*>(m_elements[number]);
    prefetch(element);
    for (std::ptrdiff_t const offset : m_usualKind->places)
        prefetch(element + offset);
}

inline bool CandidateScan::passesAll(std::vector<ElementTest> const& tests,
                                     ModelElement::Impl& element)
{
    if (tests.empty())
        return true;
    for (auto test = tests.begin(); test + 1 != tests.end(); ++test)
    {
        if (!passes(*test, element))
            return false;
    }
    return passes(tests.back(), element);
}

inline bool CandidateScan::passes(ElementTest const& test, ModelElement::Impl& element)
{
    void const* const payload = test.isInPlace ? test.place.findSingle(element) : nullptr;
    return payload ? test.test.compare({KeptValue::Shape::Single, payload}, test.test.other)
                   : passesSlowly(test, element);
}

inline void CandidateScan::follow(InstanceTests const& instance, ModelElement::Impl const& element)
{
    for (auto const& [number, place] : instance.followed)
    {
        Followed& followed = m_followed[number];
        followed.isComplete = followed.isComplete && place.isKnown();
        followed.entries.addIf(true, place.isKnown() ? place.read(element) : nullptr);
    }
}

void CandidateScan::scanBlock(std::size_t begin, std::size_t end)
{
    while (begin < end)
    {
        ElementKind const& kind = m_kinds.kindOf(*m_elements[begin]);
        if (!kind.instances.empty())
            m_usualKind = &kind;
        if (kind.instances.size() == 1)
        {
            begin = scanRun(kind, begin, end);
            continue;
        }
        prefetchElement(begin + AHEAD);
        for (InstanceTests const& instance : kind.instances)
            testElement(instance, *m_elements[begin]);
        ++begin;
    }
}

/// Tests elements as long as they are of one kind, which can stand for one instance only. Returns
/// where they end.
inline std::size_t CandidateScan::scanRun(ElementKind const& kind, std::size_t begin,
                                          std::size_t end)
{
    std::size_t number = begin;
    do
    {
        prefetchElement(number + AHEAD);
        testElement(kind.instances.front(), *m_elements[number]);
        ++number;
    }
    while (number < end && kind.isOf(*m_elements[number]));
    return number;
}

inline void CandidateScan::testElement(InstanceTests const& instance, ModelElement::Impl& element)
{
    bool const isCandidate = passesAll(instance.tests, element);
    m_candidates[instance.instance].addIf(isCandidate, &element);
    if (!instance.followed.empty() && isCandidate)
        follow(instance, element);
}

bool CandidateScan::passesSlowly(ElementTest const& test, ModelElement::Impl& element)
{
    KeptValue const kept = test.place.read(element);
    switch (test.test.answerFor(kept.shape))
    {
    case ValueTest::Answer::No:
        return false;
    case ValueTest::Answer::Yes:
        return true;
    case ValueTest::Answer::Compare:
        return test.test.compare(kept, test.test.other);
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

/// Handles are made now that the new candidates have just been read.
void CandidateScan::keepCandidates(Keeps keeps)
{
    ElementList& candidates = m_candidates.front();
    if (keeps == Keeps::Elements)
    {
        m_number = candidates.size();
        return;
    }
    if (keeps == Keeps::Handles)
    {
        for (std::size_t number = 0; number < candidates.size(); ++number)
            m_handles.emplace_back(candidates[number]);
    }
    m_number += candidates.size();
    candidates.clear();
}

PartialRows CandidateScan::takeCandidates(std::size_t instance)
{
    PartialRows rows{{instance}, m_candidates[instance].take(), {}};
    for (std::size_t number = 0; number < m_followed.size(); ++number)
    {
        AssociatedObjectConstraint const* const constraint = m_kinds.getFollowed()[number];
        // Code of clients may have changed what was read before.
        if (constraint->getSource() == instance && m_followed[number].isComplete && !m_holdsAll)
            rows.references.push_back({constraint, m_followed[number].entries.take()});
    }
    return rows;
}
}  // namespace tarn::kiln::internal
