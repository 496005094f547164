/// \file
/// Which elements refer to which others.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/StoredField.h"
#include "tarnkiln/query/internal/AssociatedObjectConstraint.h"
#include "tarnkiln/query/internal/PairTest.h"

#include <optional>
#include <typeinfo>
#include <vector>

namespace tarn::kiln::internal {

/// An `AssociatedObjectConstraint` for many pairs: follows references instead of trying targets.
class ReferenceTest final : public PairTest
{
public:
    ReferenceTest(AssociatedObjectConstraint const& constraint, JoinSides const& sides,
                  Model const& model);

    bool matches(std::size_t first, std::size_t second) override;
    std::optional<RowPairs> findMatches() override;

private:
    using Targets = std::vector<ModelElement::Impl*>;

    /// What the source in that row refers to, sorted, each once.
    Targets const& targetsOf(std::size_t row);
    void readTargets(ModelElement::Impl& source, Targets& targets);
    bool readSingleTarget(ModelElement::Impl const& source, Targets& targets);
    /// What an entry of the property means: itself, or what it stands in for; null for nothing.
    ModelElement::Impl* meaningOf(ModelElement::Impl* entry) const;

    AssociatedObjectConstraint const& m_constraint;
    Model const m_model;
    int const m_sourceSide;
    int const m_targetSide;
    bool const m_isSimple;  ///< A property with one value, and that certainly an element.
    std::type_info const* m_lastType = nullptr;
    StoredField m_lastField;  ///< Where elements of `m_lastType` keep it.
    std::vector<std::optional<Targets>>
        m_targets;  ///< By row of the source; empty before first use.
};
}  // namespace tarn::kiln::internal
