/// \file
/// A join constraint that is asked about the same elements again and again.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/query/internal/PartialRows.h"
#include "tarnkiln/query/internal/RegexCache.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <span>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {

/// What the joins of a run share.
struct JoinContext
{
    Model const& model;
    RegexCache const& regexes;
    /// Keeps all elements of the rows alive from now on. To be called before an element is asked,
    /// which may run code of clients.
    std::function<void()> holdElements;
};

/// The two columns of elements that a group of joins ties together.
struct JoinSides
{
    std::size_t ids[2];          ///< The instances, ascending.
    PartialRows const* rows[2];  ///< Where the columns come from.
    std::span<ModelElement::Impl* const> elements[2];
};

/// Pairs of rows, the second ascending and slow, the first ascending and fast.
using RowPairs = std::vector<std::pair<std::size_t, std::size_t>>;

/// Brings pairs that are sorted by the first row into the order of `RowPairs`.
///
/// \param rows  how many rows the second side has.
inline void sortBySecond(RowPairs& pairs, std::size_t rows)
{
    std::vector<std::size_t> places(rows + 1, 0);
    for (auto const& [first, second] : pairs)
        ++places[second + 1];
    for (std::size_t row = 0; row < rows; ++row)
        places[row + 1] += places[row];
    RowPairs sorted(pairs.size());
    for (auto const& pair : pairs)
        sorted[places[pair.second]++] = pair;
    pairs.swap(sorted);
}

/// Answers for rows of the two sides what the constraint answers for the elements there.
///
/// A value is read when it is first needed and then kept, so that what fails does so at the same
/// pair as if values were read for each pair.
class PairTest
{
public:
    PairTest(PairTest const&) = delete;
    PairTest& operator=(PairTest const&) = delete;
    virtual ~PairTest() = default;

    virtual bool matches(std::size_t first, std::size_t second) = 0;
    /// All pairs that match, or nothing if all pairs must be tried. Reads each value of both sides,
    /// in an order of its own: if one fails, the pairs must be tried to see which fails first.
    virtual std::optional<RowPairs> findMatches() = 0;

protected:
    /// Both must outlive the test.
    PairTest(JoinSides const& sides, JoinContext const& context)
        : m_sides(sides),
          m_context(context)
    {}

    JoinSides const& m_sides;
    JoinContext const& m_context;
};
}  // namespace tarn::kiln::internal
