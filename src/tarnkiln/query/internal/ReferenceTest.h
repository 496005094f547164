/// \file
/// Which elements refer to which others.
#pragma once
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"
#include "tarnkiln/query/internal/PairTest.h"
#include "tarnkiln/query/internal/ReferencePlace.h"

#include <optional>
#include <span>
#include <vector>

namespace tarn::kiln::internal {

/// An `AssociatedObjectConstraint` for many pairs: follows references instead of trying targets.
class ReferenceTest final : public PairTest
{
public:
    ReferenceTest(AssociatedObjectConstraint const& constraint, JoinSides const& sides,
                  JoinContext const& context);

    bool matches(std::size_t first, std::size_t second) override;
    std::optional<RowPairs> findMatches() override;

private:
    using Targets = std::vector<ModelElement::Impl*>;

    /// What the source in that row refers to, sorted, each once.
    Targets const& targetsOf(std::size_t row);
    void readTargets(ModelElement::Impl& source, Targets& targets);
    /// False if the source must be asked.
    bool findPlace(ModelElement::Impl const& source);
    void prefetchSource(ModelElement::Impl const& source) const;
    /// What an entry of the property means: itself, or what it stands in for; null for nothing.
    ModelElement::Impl* meaningOf(ModelElement::Impl* entry) const;

    AssociatedObjectConstraint const& m_constraint;
    int const m_sourceSide;
    int const m_targetSide;
    bool const m_isSimple;  ///< A property with one value, and that certainly an element.
    std::span<ModelElement::Impl* const> const m_entries;  ///< By row of the source, if known.
    KindKeys m_kinds;
    void const* m_lastKind = nullptr;
    ReferencePlace m_place;  ///< In elements of that kind.
    std::vector<std::optional<Targets>>
        m_targets;  ///< By row of the source; empty before first use.
};
}  // namespace tarn::kiln::internal
