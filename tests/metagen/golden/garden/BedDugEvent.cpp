// Made from garden.json by `metagen.py`; do not edit.
#include "acme/garden/BedDugEvent.h"

#include "acme/garden/BedImpl.h"
#include "acme/garden/GardenMetaPackage.h"
#include "tarnkiln/support/emitEvent.h"

namespace acme::garden {

BedDugEvent::BedDugEvent(
    Bed const& owner, int depth, Plant const& moved, std::vector<ustring> const& tools,
    Season season)
    : AbstractEvent(GardenMetaPackage::getInstance().getOperation(rows::operations::BedDug), owner),
      m_depth(depth),
      m_moved(moved),
      m_tools(tools),
      m_season(season)
{}

BedDugEvent::~BedDugEvent() = default;

void BedDugEvent::invoke()
{
    if (Bed const owner = Bed::cast(getOwner()))
        owner->doDug(m_depth, m_moved, m_tools, m_season);
}

void Bed::Impl::dug(int depth, Plant const& moved, std::vector<ustring> const& tools, Season season)
{
    support::emitEvent(std::make_unique<BedDugEvent>(Bed(this), depth, moved, tools, season));
}
}  // namespace acme::garden
