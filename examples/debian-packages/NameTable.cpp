#include "NameTable.h"

#include "AvailableModel.h"

#include "sill/i18n/StringConversion.h"

#include <algorithm>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_ustring;

template <ElementForm Form> Package<Form> NameTable<Form>::define(std::string const& name)
{
    Entry& entry = m_entries[name];
    if (entry.package)
        return entry.package;

    entry.package = Package<Form>::create(m_index->getModel(), uuidOfPackage(name));
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
        auto const proxy = Package<Form>::cast(ModelElement::createProxy(
            m_index->getModel(), Package<Form>::metaClass(), idOfAvailablePackage(name)));
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
