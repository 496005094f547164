#include "tarnkiln/query/internal/GroupJoin.h"

#include "tarnkiln/query/internal/ComparisonTest.h"
#include "tarnkiln/query/internal/ReferenceTest.h"

#include <algorithm>
#include <span>

namespace tarn::kiln::internal {
namespace {

using Tests = std::vector<std::unique_ptr<PairTest>>;

/// The elements of one instance, row by row.
class Column
{
public:
    Column(PartialRows const& rows, std::size_t id)
    {
        if (rows.width() == 1)
        {
            m_elements = rows.cells;
            return;
        }
        m_copy = rows.column(rows.columnOf(id));
        m_elements = m_copy;
    }
    Column(Column const&) = delete;
    Column& operator=(Column const&) = delete;

    std::span<ModelElement::Impl* const> elements() const { return m_elements; }

private:
    std::vector<ModelElement::Impl*> m_copy;
    std::span<ModelElement::Impl* const> m_elements;
};

Tests makeTests(JoinConstraints const& constraints, JoinSides const& sides,
                JoinContext const& context)
{
    Tests tests;
    for (auto const& constraint : constraints)
    {
        if (auto const* const reference =
                dynamic_cast<AssociatedObjectConstraint const*>(constraint.get()))
            tests.push_back(std::make_unique<ReferenceTest>(*reference, sides, context));
        else
            tests.push_back(std::make_unique<ComparisonTest>(
                static_cast<PropertyRelationPropertyJoinConstraint const&>(*constraint), sides,
                context));
    }
    return tests;
}

bool matchAll(Tests::iterator begin, Tests::iterator end, std::size_t first, std::size_t second)
{
    return std::all_of(begin, end, [&](auto const& test) { return test->matches(first, second); });
}

/// Nothing if all pairs must be tried.
std::optional<RowPairs> findMatches(PairTest& test)
{
    try
    {
        return test.findMatches();
    }
    catch (...)
    {
        // Pairs have an order in which something fails, and this was not it.
        return std::nullopt;
    }
}
}  // namespace

PartialRows joinRows(PartialRows const& first, PartialRows const& second,
                     std::vector<std::size_t> const& ids, JoinConstraints const& constraints,
                     JoinContext const& context)
{
    PartialRows result{first.columns, {}, {}};
    result.columns.insert(result.columns.end(), second.columns.begin(), second.columns.end());
    if (first.size() == 0 || second.size() == 0)
        return result;

    Column const firstColumn(first, ids[0]);
    Column const secondColumn(second, ids[1]);
    JoinSides const sides{
        {ids[0], ids[1]}, {&first, &second}, {firstColumn.elements(), secondColumn.elements()}};
    Tests tests = makeTests(constraints, sides, context);
    auto const append = [&](std::size_t firstRow, std::size_t secondRow) {
        result.append(first, firstRow);
        result.append(second, secondRow);
    };
    if (std::optional<RowPairs> const pairs = findMatches(*tests.front()))
    {
        for (auto const& [firstRow, secondRow] : *pairs)
        {
            if (matchAll(tests.begin() + 1, tests.end(), firstRow, secondRow))
                append(firstRow, secondRow);
        }
        return result;
    }
    for (std::size_t secondRow = 0; secondRow < second.size(); ++secondRow)
    {
        for (std::size_t firstRow = 0; firstRow < first.size(); ++firstRow)
        {
            if (matchAll(tests.begin(), tests.end(), firstRow, secondRow))
                append(firstRow, secondRow);
        }
    }
    return result;
}

PartialRows filterRows(PartialRows const& rows, std::vector<std::size_t> const& ids,
                       JoinConstraints const& constraints, JoinContext const& context)
{
    PartialRows result{rows.columns, {}, {}};
    if (rows.size() == 0)
        return result;
    Column const firstColumn(rows, ids[0]);
    Column const secondColumn(rows, ids[1]);
    JoinSides const sides{
        {ids[0], ids[1]}, {&rows, &rows}, {firstColumn.elements(), secondColumn.elements()}};
    Tests tests = makeTests(constraints, sides, context);
    for (std::size_t row = 0; row < rows.size(); ++row)
    {
        if (matchAll(tests.begin(), tests.end(), row, row))
            result.append(rows, row);
    }
    return result;
}
}  // namespace tarn::kiln::internal
