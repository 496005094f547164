/// \file
/// The rows that a run has found so far for some of its instances.
#pragma once
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"

#include <algorithm>
#include <cstddef>
#include <span>
#include <vector>

namespace tarn::kiln::internal {

/// What the single reference of each element of a column refers to, proxies and dead elements as
/// they are; null for nothing.
struct KnownReferences
{
    AssociatedObjectConstraint const* constraint;  ///< That asks for them.
    std::vector<ModelElement::Impl*> entries;      ///< By row.
};

/// A table of elements, which the run keeps alive; row after row in one block.
struct PartialRows
{
    std::size_t width() const { return columns.size(); }
    std::size_t size() const { return cells.size() / width(); }
    ModelElement::Impl* at(std::size_t row, std::size_t column) const
    {
        return cells[row * width() + column];
    }
    /// The number of columns if there is none for `id`.
    std::size_t columnOf(std::size_t id) const
    {
        return static_cast<std::size_t>(std::find(columns.begin(), columns.end(), id) -
                                        columns.begin());
    }
    /// All elements of a column.
    std::vector<ModelElement::Impl*> column(std::size_t number) const
    {
        std::vector<ModelElement::Impl*> result;
        result.reserve(size());
        for (std::size_t row = 0; row < size(); ++row)
            result.push_back(at(row, number));
        return result;
    }
    /// Adds the cells of a row of `other`.
    void append(PartialRows const& other, std::size_t row)
    {
        auto const first = other.cells.begin() + static_cast<std::ptrdiff_t>(row * other.width());
        cells.insert(cells.end(), first, first + static_cast<std::ptrdiff_t>(other.width()));
    }

    /// Those that were read with the elements; else empty.
    std::span<ModelElement::Impl* const>
    findReferences(AssociatedObjectConstraint const& constraint) const
    {
        for (KnownReferences const& known : references)
        {
            if (known.constraint == &constraint)
                return known.entries;
        }
        return {};
    }

    std::vector<std::size_t> columns;  ///< The instances; never none.
    std::vector<ModelElement::Impl*> cells;
    std::vector<KnownReferences> references;  ///< As long as no code of clients may have run.
};
}  // namespace tarn::kiln::internal
