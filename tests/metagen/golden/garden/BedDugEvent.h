// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The event `dug` of a `Bed`.
#pragma once
#include "acme/garden/Bed.h"
#include "acme/garden/Fwd.h"
#include "acme/garden/Plant.h"
#include "acme/garden/Season.h"
#include "tarnkiln/meta/AbstractDeferredInvocation.h"
#include "tarnkiln/meta/AbstractEvent.h"

#include <vector>

namespace acme::garden {

/// Somebody dug the bed over.
///
/// Made by `Bed::Impl::dug`. It keeps its arguments, and holds the elements among them and its
/// owner in memory.
///
/// Threads: as the owner.
class BedDugEvent final : public meta::AbstractEvent, public meta::AbstractDeferredInvocation
{
public:
    BedDugEvent(
        Bed const& owner, int depth, Plant const& moved, std::vector<ustring> const& tools,
        Season season);
    ~BedDugEvent() override;

    int getDepth() const { return m_depth; }
    Plant const& getMoved() const { return m_moved; }
    std::vector<ustring> const& getTools() const { return m_tools; }
    Season getSeason() const { return m_season; }

    // meta::AbstractDeferredInvocation
    /// Calls `Bed::Impl::doDug`, unless the owner was destroyed meanwhile.
    void invoke() override;

private:
    int const m_depth;
    Plant const m_moved;
    std::vector<ustring> const m_tools;
    Season const m_season;
};
}  // namespace acme::garden
