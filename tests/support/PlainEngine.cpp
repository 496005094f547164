#include "tests/support/PlainEngine.h"

#include "tarnkiln/kernel/ModelImpl.h"

#include <algorithm>
#include <list>
#include <numeric>

namespace testkit {
namespace {

using namespace tarn::kiln;
using internal::JoinConstraint;
using internal::NativeQueryState;
using internal::NativeResultSet;
using internal::SearchInstance;

using Ids = std::vector<std::size_t>;
using Row = std::vector<ModelElement>;

/// The rows found so far for some instances.
struct PartialResult
{
    Ids columns;
    std::vector<Row> rows;
};

std::size_t positionOf(std::size_t id, Ids const& ids)
{
    return static_cast<std::size_t>(std::find(ids.begin(), ids.end(), id) - ids.begin());
}

/// Calls `visit(numbers)` for each choice of one row of each set, the first set's counting fastest.
template <class Visit>
void forEachCombination(std::vector<PartialResult const*> const& sets, Visit visit)
{
    for (PartialResult const* const set : sets)
    {
        if (set->rows.empty())
            return;
    }
    Ids numbers(sets.size(), 0);
    std::size_t wheel = 0;
    while (wheel < sets.size())
    {
        visit(numbers);
        for (wheel = 0; wheel < sets.size() && ++numbers[wheel] == sets[wheel]->rows.size();
             ++wheel)
            numbers[wheel] = 0;
    }
}

Row concatenate(std::vector<PartialResult const*> const& sets, Ids const& numbers)
{
    Row result;
    for (std::size_t at = 0; at < sets.size(); ++at)
    {
        Row const& row = sets[at]->rows[numbers[at]];
        result.insert(result.end(), row.begin(), row.end());
    }
    return result;
}

Ids concatenateColumns(std::vector<PartialResult const*> const& sets)
{
    Ids result;
    for (PartialResult const* const set : sets)
        result.insert(result.end(), set->columns.begin(), set->columns.end());
    return result;
}

class PlainRun
{
public:
    explicit PlainRun(NativeQueryState const& query) : m_query(query) {}

    PartialResult run()
    {
        scan();
        for (auto const& [ids, constraints] : m_query.joins)
            join(ids, constraints);
        if (m_sets.size() > 1)
            multiply();
        PartialResult& result = m_sets.front();
        cut(result.rows);
        return std::move(result);
    }

private:
    using Sets = std::list<PartialResult>;

    void scan()
    {
        for (std::size_t id = 0; id < m_query.instances.size(); ++id)
            m_sets.push_back({{id}, {}});
        // Reading may load elements, which would disturb a walk over the table itself.
        for (ModelElement const& element : m_query.model->getAllElements())
        {
            auto set = m_sets.begin();
            for (auto const& instance : m_query.instances)
            {
                if (matches(*instance, element))
                    set->rows.push_back({element});
                ++set;
            }
        }
    }

    static bool matches(SearchInstance const& instance, ModelElement const& element)
    {
        return std::all_of(instance.constraints.begin(), instance.constraints.end(),
                           [&](auto const& constraint) { return constraint->matches(element); });
    }

    void join(Ids const& ids, std::vector<std::unique_ptr<JoinConstraint>> const& constraints)
    {
        struct Place
        {
            std::size_t set;
            std::size_t column;
        };
        std::vector<Sets::iterator> group;
        std::vector<Place> places;
        for (std::size_t const id : ids)
        {
            auto const set = std::find_if(m_sets.begin(), m_sets.end(), [&](auto const& candidate) {
                return positionOf(id, candidate.columns) < candidate.columns.size();
            });
            auto const known = std::find(group.begin(), group.end(), set);
            places.push_back(
                {static_cast<std::size_t>(known - group.begin()), positionOf(id, set->columns)});
            if (known == group.end())
                group.push_back(set);
        }

        std::vector<PartialResult const*> sets;
        for (auto const& set : group)
            sets.push_back(&*set);
        PartialResult joined{concatenateColumns(sets), {}};
        forEachCombination(sets, [&](Ids const& numbers) {
            Row row;
            for (Place const& place : places)
                row.push_back(sets[place.set]->rows[numbers[place.set]][place.column]);
            if (std::all_of(constraints.begin(), constraints.end(),
                            [&](auto const& constraint) { return constraint->matches(row, ids); }))
                joined.rows.push_back(concatenate(sets, numbers));
        });
        m_sets.push_back(std::move(joined));
        for (auto const& set : group)
            m_sets.erase(set);
    }

    void multiply()
    {
        std::vector<PartialResult const*> sets;
        for (PartialResult const& set : m_sets)
            sets.push_back(&set);
        PartialResult product{concatenateColumns(sets), {}};
        forEachCombination(
            sets, [&](Ids const& numbers) { product.rows.push_back(concatenate(sets, numbers)); });
        m_sets.clear();
        m_sets.push_back(std::move(product));
    }

    void cut(std::vector<Row>& rows) const
    {
        std::size_t const skipped = std::min(m_query.offset, rows.size());
        rows.erase(rows.begin(), rows.begin() + static_cast<std::ptrdiff_t>(skipped));
        if (m_query.limit != 0 && m_query.limit < rows.size())
            rows.resize(m_query.limit);
    }

    NativeQueryState const& m_query;
    Sets m_sets;  ///< One for each group of instances that are not joined yet.
};
}  // namespace

NativeResultSet runPlainly(NativeQueryState const& query, std::vector<std::size_t> const& columns)
{
    PartialResult const found = PlainRun(query).run();
    Ids wanted = columns;
    if (wanted.empty())
    {
        wanted.resize(query.instances.size());
        std::iota(wanted.begin(), wanted.end(), std::size_t{0});
    }

    NativeResultSet result(query.instances.size(), wanted.size());
    result.reserve(found.rows.size());
    for (Row const& row : found.rows)
    {
        for (std::size_t const id : wanted)
        {
            query.checkInstance(id);
            result.addCell(row[positionOf(id, found.columns)].getImpl());
        }
    }
    return result;
}
}  // namespace testkit
