#include "NameTable.h"

#include "AvailableModel.h"
#include "reader/NameBasedUuid.h"
#include "tarnkiln/kernel/ProxyId.h"

#include "sill/i18n/StringConversion.h"

#include <boost/uuid/uuid_io.hpp>

#include <algorithm>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_ustring;

namespace {

UUID uuidOf(std::string const& packageName)
{
    return nameBasedUuid("package", packageName, "", "");
}

}  // namespace

template <ElementForm Form> Package<Form> NameTable<Form>::define(std::string const& name)
{
    Entry& entry = m_entries[name];
    if (entry.package)
        return entry.package;

    entry.package = Package<Form>::create(m_index->getModel(), uuidOf(name));
    entry.package->setName(to_ustring(name));
    entry.package->setIndex(m_index);
    for (Alternative<Form> const& alternative : entry.waiting)
        alternative->setTarget(entry.package);
    entry.waiting = {};
    return entry.package;
}

template <ElementForm Form>
void NameTable<Form>::refer(Alternative<Form> const& alternative, std::string const& name)
{
    Entry& entry = m_entries[name];
    if (entry.package)
        alternative->setTarget(entry.package);
    else
        entry.waiting.push_back(alternative);
}

template <ElementForm Form> std::vector<std::string> NameTable<Form>::createProxies()
{
    std::vector<std::string> names;
    for (auto& [name, entry] : m_entries)
    {
        if (entry.package)
            continue;
        ProxyId const id(ElementId::UUID_TYPE, to_ustring(boost::uuids::to_string(uuidOf(name))),
                         ustring(AVAILABLE_URI));
        auto const proxy = Package<Form>::cast(
            ModelElement::createProxy(m_index->getModel(), Package<Form>::metaClass(), id));
        for (Alternative<Form> const& alternative : entry.waiting)
            alternative->setTarget(proxy);
        entry.waiting = {};
        names.push_back(name);
    }
    std::sort(names.begin(), names.end());
    return names;
}

#define DEBIAN_INSTANTIATE(Form) template class NameTable<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
