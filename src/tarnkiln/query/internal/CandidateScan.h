/// \file
/// The one pass over a model that finds the candidates of all search instances.
#pragma once
#include "tarnkiln/query/internal/ElementKinds.h"
#include "tarnkiln/query/internal/ElementList.h"
#include "tarnkiln/query/internal/NativeQueryState.h"
#include "tarnkiln/query/internal/PartialRows.h"
#include "tarnkiln/query/internal/RegexCache.h"

#include <cstddef>
#include <utility>
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

    /// What becomes of candidates. Where it is not `Elements` there is one instance only.
    enum class Keeps
    {
        Elements,
        Handles,
        Number
    };

    /// \param enough  how many candidates of the only instance will do, if nothing but its class
    ///     and its place is tested: what else is tested may fail, and so must be. 0 for all.
    void run(Keeps keeps, std::size_t enough);

    /// The candidates of an instance, and their references that are followed first; leaves none
    /// behind.
    PartialRows takeCandidates(std::size_t instance);
    std::vector<ModelElement> takeHandles() { return std::move(m_handles); }
    std::size_t getNumber() const { return m_number; }
    /// Whether no element can die any more as long as the scan lives.
    bool holdsAll() const { return m_holdsAll; }

private:
    /// The references that a join follows, read as the candidates are found.
    struct Followed
    {
        ElementList entries;     ///< By candidate.
        bool isComplete = true;  ///< No candidate must be asked.
    };

    /// Elements that are tested before the lists of candidates are looked after.
    static constexpr std::size_t BLOCK = 64;

    bool mayStopEarly() const;
    void reserve();
    void scanBlock(std::size_t begin, std::size_t end);
    std::size_t scanRun(ElementKind const& kind, std::size_t begin, std::size_t end);
    void testElement(InstanceTests const& instance, ModelElement::Impl& element);
    void prefetchElement(std::size_t number) const;
    bool passesAll(std::vector<ElementTest> const& tests, ModelElement::Impl& element);
    bool passes(ElementTest const& test, ModelElement::Impl& element);
    bool passesSlowly(ElementTest const& test, ModelElement::Impl& element);
    bool ask(ElementTest const& test, ModelElement::Impl& element);
    void follow(InstanceTests const& instance, ModelElement::Impl const& element);
    void keepCandidates(Keeps keeps);

    NativeQueryState const& m_query;
    RegexCache& m_regexes;
    ElementKinds m_kinds;
    std::vector<ModelElement::Impl*> m_elements;
    std::vector<ElementList> m_candidates;
    std::vector<Followed> m_followed;  ///< As `ElementKinds` numbers them.
    std::vector<ModelElement> m_handles;
    std::size_t m_number = 0;
    std::vector<ModelElement> m_held;
    bool m_holdsAll = false;
    ElementKind const* m_usualKind = nullptr;  ///< Of the last element that was tested.
};
}  // namespace tarn::kiln::internal
