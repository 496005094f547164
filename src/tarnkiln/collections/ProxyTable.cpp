#include "tarnkiln/collections/ProxyTable.h"

#include <boost/container_hash/hash.hpp>

#include <functional>

namespace tarn::kiln::support {

std::size_t ProxyIdHasher::operator()(ProxyId const& id) const
{
    std::size_t seed = std::hash<ustring>()(id.getType());
    for (char16_t const unit : id.getId())
        boost::hash_combine(seed, unit);
    return seed;
}
}  // namespace tarn::kiln::support
