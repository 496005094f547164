/// \file
/// How the packages are called that an index asks for and does not hold.
#pragma once
#include "AvailableModel.h"

#include <map>
#include <string>
#include <vector>

namespace debian {

/// The names behind the proxies of missing packages, which themselves know an identifier only.
class MissingNames
{
public:
    MissingNames() = default;
    /// \param names  as `LoadResult::missing`.
    explicit MissingNames(std::vector<std::string> const& names);

    /// \throws std::out_of_range  if no missing package has that identifier.
    std::string const& nameOf(tarn::kiln::ProxyId const& id) const { return m_names.at(id); }

    /// Whether a missing package is called so.
    bool contains(std::string const& name) const
    {
        return m_names.count(idOfAvailablePackage(name)) != 0;
    }

private:
    std::map<tarn::kiln::ProxyId, std::string> m_names;
};

}  // namespace debian
