#include "NameTable.h"

#include "AvailableModel.h"
#include "model/AlternativeImpl.h"
#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
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

model::Package NameTable::define(std::string const& name)
{
    Entry& entry = m_entries[name];
    if (entry.package)
        return entry.package;

    entry.package = model::Package::create(m_index->getModel(), uuidOf(name));
    entry.package->setName(to_ustring(name));
    entry.package->setIndex(m_index);
    for (model::Alternative const& alternative : entry.waiting)
        alternative->setTarget(entry.package);
    entry.waiting = {};
    return entry.package;
}

void NameTable::refer(model::Alternative const& alternative, std::string const& name)
{
    Entry& entry = m_entries[name];
    if (entry.package)
        alternative->setTarget(entry.package);
    else
        entry.waiting.push_back(alternative);
}

std::vector<std::string> NameTable::createProxies()
{
    std::vector<std::string> names;
    for (auto& [name, entry] : m_entries)
    {
        if (entry.package)
            continue;
        ProxyId const id(ElementId::UUID_TYPE, to_ustring(boost::uuids::to_string(uuidOf(name))),
                         ustring(AVAILABLE_URI));
        auto const proxy = model::Package::cast(
            ModelElement::createProxy(m_index->getModel(), model::Package::metaClass(), id));
        for (model::Alternative const& alternative : entry.waiting)
            alternative->setTarget(proxy);
        entry.waiting = {};
        names.push_back(name);
    }
    std::sort(names.begin(), names.end());
    return names;
}

}  // namespace debian
