/// \file
/// The one pass over a model that finds the candidates of all search instances.
#pragma once
#include "tarnkiln/query/internal/ElementKinds.h"
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/RegexCache.h"

#include <array>
#include <cstddef>
#include <span>
#include <typeinfo>
#include <vector>

namespace tarn::kiln::internal {

/// Tests each element for each instance, in the order of the model and of the instances, and each
/// constraint in its order, so that what fails first is what fails.
///
/// Fields are compared where they lie. As soon as a constraint has to be asked, which may run code
/// of clients and load elements, the scan holds all elements, and does so as long as it lives.
class CandidateScan
{
public:
    CandidateScan(NativeQueryState const& query, RegexCache& regexes);

    /// \param enough  how many candidates of the only instance will do, if nothing but its class
    ///     and its place is tested: what else is tested may fail, and so must be. 0 for all.
    void run(std::size_t enough);
    /// Keeps the candidates from dying; for steps that may run code of clients.
    void holdCandidates();

    /// By instance.
    std::vector<std::vector<ModelElement::Impl*>>& getCandidates() { return m_candidates; }

private:
    static constexpr std::size_t BLOCK = 64;

    /// Elements that are looked at together.
    struct Block
    {
        std::array<std::type_info const*, BLOCK> types;
    };

    bool mayStopEarly() const;
    void touchBlock(std::span<ModelElement::Impl* const> elements, Block& block) const;
    bool passesAll(std::vector<ElementTest> const& tests, ModelElement::Impl& element);
    bool passes(ElementTest const& test, ModelElement::Impl& element);
    bool ask(ElementTest const& test, ModelElement::Impl& element);

    NativeQueryState const& m_query;
    RegexCache& m_regexes;
    ElementKinds m_kinds;
    std::vector<ModelElement::Impl*> m_elements;
    std::vector<std::vector<ModelElement::Impl*>> m_candidates;
    std::vector<ModelElement> m_held;
    bool m_holdsAll = false;
    ElementKind const* m_usualKind = nullptr;  ///< Of the last candidate.
};
}  // namespace tarn::kiln::internal
