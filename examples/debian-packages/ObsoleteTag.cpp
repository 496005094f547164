#include "ObsoleteTag.h"

#include "ElementText.h"
#include "SearchInstances.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/StandardTypes.h"

#include "sill/i18n/StringConversion.h"

#include <set>
#include <vector>

namespace debian {

using namespace tarn::kiln;
using meta::StandardTypes;
using sill::i18n::to_ustring;

template <ElementForm Form> ObsoleteTag<Form>::ObsoleteTag(Model const& model) : m_model(model)
{
    meta::ExtensionPrototype prototype;
    prototype.setName(NAME);
    prototype.setTypeName(u"Boolean");
    model->extendMetaclass(Package<Form>::metaClass(), prototype,
                           Value(StandardTypes::booleanMeta, false));
    m_tag = model->getDeclaredExtension(Package<Form>::metaClass(), NAME);
}

template <ElementForm Form> ObsoleteTag<Form>::~ObsoleteTag()
{
    m_model->unextendMetaclass(Package<Form>::metaClass(), NAME);
}

template <ElementForm Form>
std::size_t ObsoleteTag<Form>::setOnMatching(std::string const& pattern) const
{
    query::AbstractQuery query(m_model);
    Packages<Form> packages({query, EXACT});
    packages.name.regexp(to_ustring(pattern));

    std::size_t count = 0;
    for (auto const& [package] : query.results(packages))
    {
        ModelElement const& element = package;
        element->setExtension(m_tag, Value(StandardTypes::booleanMeta, true));
        ++count;
    }
    return count;
}

template <ElementForm Form> Table ObsoleteTag<Form>::packagesWithTag() const
{
    query::AbstractQuery query(m_model);
    Packages<Form> packages({query, EXACT});
    packages.constrain(m_tag, query::ValueMatchRelation::equal,
                       Value(StandardTypes::booleanMeta, true));

    std::set<Table::Row> rows;
    for (auto const& [package] : query.results(packages))
        rows.insert({textOf<Form>(package), std::to_string(package->getReleases().size())});

    Table table({{"package"}, {"releases", Table::Alignment::Right}});
    for (Table::Row const& row : rows)
        table.addRow(row);
    return table;
}

#define DEBIAN_INSTANTIATE(Form) template class ObsoleteTag<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
