#include "MissingNames.h"

namespace debian {

MissingNames::MissingNames(std::vector<std::string> const& names)
{
    for (std::string const& name : names)
        m_names.emplace(idOfAvailablePackage(name), name);
}

}  // namespace debian
