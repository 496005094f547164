#include "AvailableModel.h"

#include "reader/NameBasedUuid.h"

#include "sill/i18n/StringConversion.h"

#include <boost/uuid/uuid_io.hpp>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_ustring;

UUID uuidOfPackage(std::string const& name)
{
    return nameBasedUuid("package", name, "", "");
}

ProxyId idOfAvailablePackage(std::string const& name)
{
    return ProxyId(ElementId::UUID_TYPE, to_ustring(boost::uuids::to_string(uuidOfPackage(name))),
                   ustring(AVAILABLE_URI));
}

}  // namespace debian
