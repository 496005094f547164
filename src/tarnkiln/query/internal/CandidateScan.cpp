#include "tarnkiln/query/internal/CandidateScan.h"

#include "tarnkiln/kernel/ModelImpl.h"

#include <algorithm>
#include <typeinfo>

namespace tarn::kiln::internal {
namespace {

void touch(void const* place)
{
    static_cast<void>(*static_cast<char const volatile*>(place));
}

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

inline bool CandidateScan::passesAll(std::vector<ElementTest> const& tests,
                                     ModelElement::Impl& element)
{
    for (ElementTest const& test : tests)
    {
        bool const isPassed =
            test.isOfField
                ? test.test.compare({KeptValue::Shape::Single, test.place.field(element)},
                                    test.test.other)
                : passes(test, element);
        if (!isPassed)
            return false;
    }
    return true;
}

void CandidateScan::run(std::size_t enough)
{
    m_candidates.resize(m_query.instances.size());
    m_elements = m_query.model->getAllElementImpls();
    constexpr std::size_t ALL = ~std::size_t{0};
    std::size_t const most = enough != 0 && mayStopEarly() ? enough : ALL;
    Block block;
    for (std::size_t begin = 0; begin < m_elements.size(); begin += BLOCK)
    {
        std::size_t const end = std::min(begin + BLOCK, m_elements.size());
        touchBlock({m_elements.data() + begin, end - begin}, block);
        for (std::size_t number = begin; number < end; ++number)
        {
            ModelElement::Impl& element = *m_elements[number];
            ElementKind const& kind = m_kinds.kindOf(*block.types[number - begin], element);
            for (InstanceTests const& instance : kind.instances)
            {
                m_usualKind = &kind;
                if (!passesAll(instance.tests, element))
                    continue;
                m_candidates[instance.instance].push_back(&element);
                if (m_candidates[instance.instance].size() >= most)
                    return;
            }
        }
    }
}

/// Reads of each element what will be read of it, one step for all after the other. The elements of
/// a model lie anywhere, and only so does the processor wait for many of them at a time. Guesses
/// that most are of the kind of the last one that was tested.
void CandidateScan::touchBlock(std::span<ModelElement::Impl* const> elements, Block& block) const
{
    for (std::size_t at = 0; at < elements.size(); ++at)
        block.types[at] = &typeid(*elements[at]);
    if (!m_usualKind)
        return;
    for (std::size_t at = 0; at < elements.size(); ++at)
    {
        if (block.types[at] == m_usualKind->type)
            touch(m_usualKind->touched(*elements[at]));
    }
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
