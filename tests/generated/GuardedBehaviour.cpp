#include "shapes/GuardedImpl.h"

#include "shapes/NodeImpl.h"

namespace testkit::shapes {

ustring Guarded::Impl::getSummary() const
{
    return u"once: " + getOnce();
}

ustring Guarded::Impl::tell()
{
    return u"guarded";
}

Node Guarded::Impl::pick(Node const& from, boost::optional<int> const& at)
{
    return at ? from->getOwned()[static_cast<unsigned long>(*at)] : from;
}

std::vector<ustring> Guarded::Impl::pick(std::vector<ustring> const& words)
{
    return {words.rbegin(), words.rend()};
}

void Guarded::Impl::adjust(int fixed)
{
    setFixed(fixed);
}
}  // namespace testkit::shapes
