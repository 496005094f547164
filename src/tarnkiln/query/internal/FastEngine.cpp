#include "tarnkiln/query/internal/FastEngine.h"

#include "tarnkiln/query/internal/CandidateScan.h"
#include "tarnkiln/query/internal/GroupJoin.h"
#include "tarnkiln/query/internal/PartialRows.h"
#include "tarnkiln/query/internal/prefetch.h"

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

    bool isAll() const { return begin == 0 && size == ALL; }
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
    {}

    /// The rows that are wanted.
    std::size_t count()
    {
        if (isOfOneInstance())
        {
            scan(CandidateScan::Keeps::Number);
            return m_window.cut(m_scan.getNumber());
        }
        findSets();
        return countRows();
    }

    NativeResultSet rows(std::vector<std::size_t> const& columns)
    {
        NativeResultSet result(m_query.instances.size(), columns.size());
        if (isOfOneInstance() && columns.size() == 1 && m_window.isAll())
        {
            m_query.checkInstance(columns.front());
            scan(CandidateScan::Keeps::Handles);
            result.setCells(m_scan.takeHandles());
            return result;
        }
        findSets();
        std::size_t const wanted = countRows();
        result.reserve(wanted);
        std::vector<Wheel> wheels = makeWheels(columns);
        for (std::size_t row = 0; row < wanted; ++row)
        {
            for (Wheel& wheel : wheels)
                result.addCell(wheel.next());
        }
        return result;
    }

private:
    /// A column of the result, which comes from the combinations of all sets: the first set's rows
    /// count fastest.
    class Wheel
    {
    public:
        /// \param divisor  how many combinations there are before the row of the set changes.
        Wheel(PartialRows const& set, std::size_t column, std::size_t divisor, std::size_t begin)
            : m_set(set),
              m_column(column),
              m_rows(set.size()),
              m_divisor(divisor),
              m_row(m_rows == 0 ? 0 : begin / divisor % m_rows),
              m_left(divisor - begin % divisor)
        {}

        /// The element in the present row of the result, which then is the next one.
        ModelElement::Impl* next()
        {
            ModelElement::Impl* const element = m_set.at(m_row, m_column);
            if (--m_left == 0)
                turn();
            return element;
        }

    private:
        void turn()
        {
            m_left = m_divisor;
            m_row = m_row + 1 == m_rows ? 0 : m_row + 1;
            if (m_row + AHEAD < m_rows)
                prefetch(m_set.at(m_row + AHEAD, m_column));
        }

        PartialRows const& m_set;
        std::size_t m_column;
        std::size_t m_rows;
        std::size_t m_divisor;
        std::size_t m_row;
        std::size_t m_left;  ///< Before `m_row` changes.
    };

    bool isOfOneInstance() const { return m_query.instances.size() == 1 && m_query.joins.empty(); }
    void scan(CandidateScan::Keeps keeps)
    {
        m_scan.run(keeps, m_window.end() == ALL ? 0 : m_window.end());
    }
    void findSets()
    {
        scan(CandidateScan::Keeps::Elements);
        for (std::size_t id = 0; id < m_query.instances.size(); ++id)
            m_sets.push_back(m_scan.takeCandidates(id));
        for (auto const& [ids, constraints] : m_query.joins)
            join(ids, constraints);
    }

    /// The rows that are wanted; those of sets that nothing ties together are all combinations.
    std::size_t countRows() const
    {
        std::size_t rows = 1;
        for (PartialRows const& set : m_sets)
        {
            bool const isTooMany = set.size() != 0 && rows > ALL / set.size();
            rows = isTooMany ? ALL : rows * set.size();
        }
        return m_window.cut(hasEmptySet() ? 0 : rows);
    }

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
                    wheels.emplace_back(set, column, divisor, m_window.begin);
                    break;
                }
                std::size_t const rows = std::max(set.size(), std::size_t{1});
                divisor = divisor > ALL / rows ? ALL : divisor * rows;
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
    JoinContext context()
    {
        return {m_query.model, m_regexes, [this] { holdElements(); }};
    }
    void holdElements()
    {
        if (m_holdsElements || m_scan.holdsAll())
            return;
        for (PartialRows& set : m_sets)
        {
            for (ModelElement::Impl* const element : set.cells)
                m_held.emplace_back(element);
            set.references.clear();
        }
        m_holdsElements = true;
    }

    NativeQueryState const& m_query;
    Window const m_window;
    RegexCache m_regexes;
    CandidateScan m_scan;
    std::list<PartialRows> m_sets;  ///< One for each group of instances that are not joined yet.
    std::vector<ModelElement> m_held;
    bool m_holdsElements = false;
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
