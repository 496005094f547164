#include "tarnkiln/query/internal/ReferenceTest.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/query/internal/RowIndex.h"
#include "tarnkiln/query/internal/prefetch.h"

#include <algorithm>

namespace tarn::kiln::internal {
namespace {

/// Finds the rows of elements.
class ElementIndex
{
public:
    explicit ElementIndex(std::span<ModelElement::Impl* const> elements)
        : m_elements(elements),
          m_index(elements.size())
    {
        for (std::size_t row = elements.size(); row-- > 0;)
            m_index.addBefore(row, hashOf(elements[row]));
    }

    /// Calls `visit(row)` for each, ascending.
    template <class Visit>
    void forEachRow(ModelElement::Impl const* element, Visit const& visit) const
    {
        for (std::size_t row = m_index.first(hashOf(element)); row != RowIndex::NONE;
             row = m_index.next(row))
        {
            if (m_elements[row] == element)
                visit(row);
        }
    }

private:
    static std::size_t hashOf(ModelElement::Impl const* element)
    {
        return reinterpret_cast<std::uintptr_t>(element) >> 4;
    }

    std::span<ModelElement::Impl* const> m_elements;
    RowIndex m_index;
};
}  // namespace

ReferenceTest::ReferenceTest(AssociatedObjectConstraint const& constraint, JoinSides const& sides,
                             JoinContext const& context)
    : PairTest(sides, context),
      m_constraint(constraint),
      m_sourceSide(sides.ids[0] == constraint.getSource() ? 0 : 1),
      m_targetSide(sides.ids[0] == constraint.getTarget() ? 0 : 1),
      m_isSimple(constraint.isOfSingleReference()),
      m_entries(sides.rows[m_sourceSide]->findReferences(constraint))
{}

bool ReferenceTest::matches(std::size_t first, std::size_t second)
{
    std::size_t const rows[] = {first, second};
    ModelElement::Impl* const target = m_sides.elements[m_targetSide][rows[m_targetSide]];
    Targets const& targets = targetsOf(rows[m_sourceSide]);
    return std::binary_search(targets.begin(), targets.end(), target);
}

ReferenceTest::Targets const& ReferenceTest::targetsOf(std::size_t row)
{
    if (m_targets.empty())
        m_targets.resize(m_sides.elements[m_sourceSide].size());
    std::optional<Targets>& targets = m_targets[row];
    if (!targets)
    {
        Targets found;
        readTargets(*m_sides.elements[m_sourceSide][row], found);
        targets = std::move(found);
    }
    return *targets;
}

bool ReferenceTest::findPlace(ModelElement::Impl const& source)
{
    if (!m_isSimple)
        return false;
    void const* const kind = m_kinds.of(source);
    if (kind != m_lastKind)
    {
        m_place = ReferencePlace::find(source, m_constraint.getProperty());
        m_lastKind = kind;
    }
    return m_place.isKnown();
}

void ReferenceTest::readTargets(ModelElement::Impl& source, Targets& targets)
{
    targets.clear();
    if (findPlace(source))
    {
        if (ModelElement::Impl* const target = meaningOf(m_place.read(source)))
            targets.push_back(target);
        return;
    }
    m_context.holdElements();
    for (ModelElement const& entry : m_constraint.readReferences(ModelElement(&source)))
    {
        if (ModelElement::Impl* const target = meaningOf(entry.getImpl()))
            targets.push_back(target);
    }
    std::sort(targets.begin(), targets.end());
    targets.erase(std::unique(targets.begin(), targets.end()), targets.end());
}

ModelElement::Impl* ReferenceTest::meaningOf(ModelElement::Impl* entry) const
{
    if (!entry || !entry->isLive() || !entry->isProxy())
        return entry;
    UUID const* const id = entry->getStandIn()->getUuid();
    return id ? m_context.model->findElementImpl(*id) : nullptr;
}

/// Guesses that it is of the kind of the last one.
[[gnu::always_inline]] inline void
ReferenceTest::prefetchSource(ModelElement::Impl const& source) const
{
    prefetch(&source);
    prefetch(m_place.placeIn(source));
}

std::optional<RowPairs> ReferenceTest::findMatches()
{
    auto const& sources = m_sides.elements[m_sourceSide];
    auto const& targets = m_sides.elements[m_targetSide];
    ElementIndex const index(targets);
    RowPairs pairs;
    auto const addPairs = [&](std::size_t source, ModelElement::Impl const* target) {
        if (!target)
            return;
        index.forEachRow(target, [&](std::size_t row) {
            pairs.emplace_back(m_sourceSide == 0 ? source : row, m_sourceSide == 0 ? row : source);
        });
    };
    for (std::size_t source = 0; source < m_entries.size(); ++source)
    {
        if (source + AHEAD < m_entries.size())
            prefetch(m_entries[source + AHEAD]);
        addPairs(source, meaningOf(m_entries[source]));
    }
    Targets found;
    for (std::size_t source = m_entries.size(); source < sources.size(); ++source)
    {
        if (source + AHEAD < sources.size())
            prefetchSource(*sources[source + AHEAD]);
        readTargets(*sources[source], found);
        std::size_t const begin = pairs.size();
        for (ModelElement::Impl const* const target : found)
            addPairs(source, target);
        if (found.size() > 1)
            std::sort(pairs.begin() + static_cast<std::ptrdiff_t>(begin), pairs.end());
    }
    if (m_sourceSide == 0)
        sortBySecond(pairs, targets.size());
    return pairs;
}
}  // namespace tarn::kiln::internal
