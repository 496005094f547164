#include "tarnkiln/query/internal/FastEngine.h"

#include "tarnkiln/query/internal/CandidateScan.h"
#include "tarnkiln/query/internal/GroupJoin.h"
#include "tarnkiln/query/internal/PartialRows.h"

#include <algorithm>
#include <list>
#include <numeric>

namespace tarn::kiln::internal {
namespace {

constexpr std::size_t ALL = ~std::size_t{0};

/// Which of the rows are wanted.
struct Window
{
    std::size_t begin = 0;
    std::size_t size = ALL;  ///< At most.

    /// The number of rows that must be found.
    std::size_t end() const { return size > ALL - begin ? ALL : begin + size; }
    std::size_t cut(std::size_t rows) const
    {
        return std::min(size, rows > begin ? rows - begin : 0);
    }
};

Window windowOf(NativeQueryState const& query, std::size_t most)
{
    Window window;
    window.begin = query.offset;
    for (std::size_t const limit : {query.limit, most})
    {
        if (limit != 0)
            window.size = std::min(window.size, limit);
    }
    return window;
}

class FastRun
{
public:
    FastRun(NativeQueryState const& query, Window const& window)
        : m_query(query),
          m_window(window),
          m_scan(query, m_regexes)
    {
        m_scan.run(window.end() == ALL ? 0 : window.end());
        if (!query.joins.empty())
            m_scan.holdCandidates();
        for (std::size_t id = 0; id < query.instances.size(); ++id)
            m_sets.push_back({{id}, std::move(m_scan.getCandidates()[id])});
        for (auto const& [ids, constraints] : query.joins)
            join(ids, constraints);
    }

    /// The rows that are wanted; those of sets that nothing ties together are all combinations.
    std::size_t count() const
    {
        std::size_t rows = 1;
        for (PartialRows const& set : m_sets)
        {
            bool const isTooMany = set.size() != 0 && rows > ALL / set.size();
            rows = isTooMany ? ALL : rows * set.size();
        }
        return m_window.cut(hasEmptySet() ? 0 : rows);
    }

    NativeResultSet rows(std::vector<std::size_t> const& columns) const
    {
        NativeResultSet result(m_query.instances.size(), columns.size());
        std::size_t const wanted = count();
        result.reserve(wanted);
        std::vector<Wheel> wheels = makeWheels(columns);
        for (std::size_t row = 0; row < wanted; ++row)
        {
            for (Wheel const& wheel : wheels)
            {
                std::size_t const number =
                    (m_window.begin + row) / wheel.divisor % wheel.set->size();
                result.addCell(wheel.set->at(number, wheel.column));
            }
        }
        return result;
    }

private:
    /// Where a column of the result comes from, among the combinations of all sets: the first set's
    /// rows count fastest.
    struct Wheel
    {
        PartialRows const* set;
        std::size_t column;
        std::size_t
            divisor;  ///< How many combinations there are before the row of the set changes.
    };

    bool hasEmptySet() const
    {
        return std::any_of(m_sets.begin(), m_sets.end(),
                           [](PartialRows const& set) { return set.size() == 0; });
    }

    std::vector<Wheel> makeWheels(std::vector<std::size_t> const& columns) const
    {
        std::vector<Wheel> wheels;
        for (std::size_t const id : columns)
        {
            m_query.checkInstance(id);
            std::size_t divisor = 1;
            for (PartialRows const& set : m_sets)
            {
                if (std::size_t const column = set.columnOf(id); column < set.width())
                {
                    wheels.push_back({&set, column, divisor});
                    break;
                }
                bool const isTooMany = set.size() != 0 && divisor > ALL / set.size();
                divisor = isTooMany ? ALL : divisor * set.size();
            }
        }
        return wheels;
    }

    void join(std::vector<std::size_t> const& ids,
              std::vector<std::unique_ptr<JoinConstraint>> const& constraints)
    {
        auto const setOf = [&](std::size_t id) {
            return std::find_if(m_sets.begin(), m_sets.end(), [&](PartialRows const& set) {
                return set.columnOf(id) < set.width();
            });
        };
        auto const first = setOf(ids[0]);
        auto const second = setOf(ids[1]);
        m_sets.push_back(first == second ? filterRows(*first, ids, constraints, context())
                                         : joinRows(*first, *second, ids, constraints, context()));
        m_sets.erase(first);
        if (second != first)
            m_sets.erase(second);
    }
    JoinContext context() const { return {m_query.model, m_regexes}; }

    NativeQueryState const& m_query;
    Window const m_window;
    RegexCache m_regexes;
    CandidateScan m_scan;
    std::list<PartialRows> m_sets;  ///< One for each group of instances that are not joined yet.
};
}  // namespace

NativeResultSet runFast(NativeQueryState const& query, std::vector<std::size_t> const& columns,
                        std::size_t most)
{
    std::vector<std::size_t> wanted = columns;
    if (wanted.empty())
    {
        wanted.resize(query.instances.size());
        std::iota(wanted.begin(), wanted.end(), std::size_t{0});
    }
    return FastRun(query, windowOf(query, most)).rows(wanted);
}

std::size_t countFast(NativeQueryState const& query)
{
    return FastRun(query, windowOf(query, /*most=*/0)).count();
}
}  // namespace tarn::kiln::internal
