/// \file
/// Which elements have values that compare.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/PairTest.h"
#include "tarnkiln/query/internal/PropertyRelationPropertyJoinConstraint.h"

#include <optional>
#include <vector>

namespace tarn::kiln::internal {

/// A `PropertyRelationPropertyJoinConstraint` for many pairs: hashes what must be equal.
class ComparisonTest final : public PairTest
{
public:
    ComparisonTest(PropertyRelationPropertyJoinConstraint const& constraint, JoinSides const& sides,
                   JoinContext const& context);

    bool matches(std::size_t first, std::size_t second) override;
    std::optional<RowPairs> findMatches() override;

private:
    /// Reads one property of elements of any kind.
    class Reader
    {
    public:
        explicit Reader(meta::Property const& property) : m_property(property) {}

        KeptValue read(ModelElement::Impl const& element, SlotKind kind);
        /// Guesses that it is of the kind of the last one.
        void prefetch(ModelElement::Impl const& element) const;

    private:
        meta::Property const& m_property;
        KindKeys m_kinds;
        void const* m_lastKind = nullptr;
        PlainPlace m_place;  ///< In elements of that kind.
    };

    Value const& valueOf(int side, std::size_t row);
    Value read(int side, ModelElement::Impl& element) const;
    template <class T, class Hash, class Equal>
    std::optional<RowPairs> findEqual(SlotKind kind, bool onlySingle, Hash const& hash,
                                      Equal const& equal);
    std::optional<RowPairs> findEqualLiterals(meta::Type const& type);
    template <class T>
    KeptValue keptValueOf(int side, std::size_t row, Reader& reader, SlotKind kind);

    PropertyRelationPropertyJoinConstraint const& m_constraint;
    Comparator const& m_comparator;
    int const m_leftSide;
    std::vector<std::optional<Value>> m_values[2];  ///< By row; empty before first use.
};
}  // namespace tarn::kiln::internal
