#include "Questions.h"

#include "Dependencies.h"
#include "ElementText.h"
#include "SearchInstances.h"

#include "sill/i18n/StringConversion.h"

#include <algorithm>
#include <cstddef>
#include <map>
#include <optional>
#include <set>
#include <stdexcept>
#include <tuple>
#include <unordered_set>
#include <utility>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_string;
using sill::i18n::to_ustring;

namespace {

Table tableOf(std::vector<Table::Column> columns, std::set<Table::Row> const& rows)
{
    Table table(std::move(columns));
    for (Table::Row const& row : rows)
        table.addRow(row);
    return table;
}

/// A query for dependencies and the packages of the model that they name.
template <ElementForm Form> struct NamedPackages
{
    explicit NamedPackages(Model const& model)
        : query(model),
          groups({query, EXACT}),
          alternatives({query, EXACT}),
          targets({query, EXACT})
    {
        alternatives.group.refersTo(groups);
        alternatives.target.refersTo(targets);
    }

    query::AbstractQuery query;
    Groups<Form> groups;
    Alternatives<Form> alternatives;
    Packages<Form> targets;
};

using ElementSet = std::unordered_set<ModelElement::Impl*>;

/// Adds the dependencies that a package of the right version satisfies.
template <ElementForm Form>
void addMetByRelease(ElementSet& met, Model const& model, ustring const& kinds)
{
    NamedPackages<Form> named(model);
    named.groups.kind.regexp(kinds);
    Releases<Form> releases({named.query, EXACT});
    releases.package.refersTo(named.targets);

    for (auto const& [group, alternative, release] :
         named.query.results(named.groups, named.alternatives, releases))
    {
        if (fits<Form>(release, alternative))
            met.insert(group.getImpl());
    }
}

/// Adds the dependencies that a release of another package satisfies, by providing what is named.
template <ElementForm Form>
void addMetByProvider(ElementSet& met, Model const& model, ustring const& kinds)
{
    NamedPackages<Form> named(model);
    named.groups.kind.regexp(kinds);
    Releases<Form> providers({named.query, EXACT});
    providers.provides.refersTo(named.targets);

    for (auto const& [group] : named.query.results(named.groups))
        met.insert(group.getImpl());
}

template <ElementForm Form>
std::string targetText(Alternative<Form> const& alternative, MissingNames const& missing)
{
    return textOf<Form>(Package<Form>(alternative->getTargetImpl()), nullptr, &missing);
}

}  // namespace

template <ElementForm Form>
Questions<Form>::Questions(PackageIndex<Form> const& index, MissingNames missing)
    : m_index(index),
      m_model(index->getModel()),
      m_missing(std::move(missing))
{}

template <ElementForm Form> Table Questions<Form>::unmetDependencies(ustring const& kinds) const
{
    // Constraints say what is there; what is not there is left over when that is taken away.
    ElementSet met;
    addMetByRelease<Form>(met, m_model, kinds);
    addMetByProvider<Form>(met, m_model, kinds);

    query::AbstractQuery query(m_model);
    Groups<Form> groups({query, EXACT});
    groups.kind.regexp(kinds);
    Releases<Form> releases({query, EXACT});
    groups.release.refersTo(releases);

    std::set<Table::Row> rows;
    for (auto const& [group, release] : query.results(groups, releases))
    {
        if (met.count(group.getImpl()) == 0)
            rows.insert({textOf<Form>(release->getPackage()), to_string(release->getLabel()),
                         textOf<Form>(group, nullptr, &m_missing)});
    }
    return tableOf({{"package"}, {"release"}, {"unmet dependency"}}, rows);
}

template <ElementForm Form> Table Questions<Form>::dependenciesOfSameMaintainer() const
{
    query::AbstractQuery query(m_model);
    Groups<Form> groups({query, EXACT});
    Alternatives<Form> alternatives({query, EXACT});
    Packages<Form> targets({query, EXACT});
    Releases<Form> needing({query, EXACT});
    Releases<Form> needed({query, EXACT});

    // Stated before the references, this join is made when they have left few pairs to compare.
    needing.maintainer == needed.maintainer;
    needing.maintainer != u"";
    groups.kind.regexp(ustring(STRICT_KINDS));
    groups.release.refersTo(needing);
    alternatives.group.refersTo(groups);
    alternatives.target.refersTo(targets);
    needed.package.refersTo(targets);

    std::set<Table::Row> rows;
    for (auto const& [user, package] : query.results(needing, targets))
        rows.insert({textOf<Form>(user->getPackage()), textOf<Form>(package),
                     to_string(user->getMaintainer())});
    return tableOf({{"package"}, {"depends on"}, {"maintainer"}}, rows);
}

template <ElementForm Form> Table Questions<Form>::largestPackages(std::string const& pattern) const
{
    query::AbstractQuery query(m_model);
    Packages<Form> packages({query, EXACT});
    Releases<Form> releases({query, EXACT});
    packages.name.regexp(to_ustring(pattern));
    releases.package.refersTo(packages);
    releases.installedSize != boost::none;

    std::vector<std::tuple<long, std::string, std::string>> found;
    for (auto const& [package, release] : query.results(packages, releases))
        found.emplace_back(-*release->getInstalledSize(), textOf<Form>(package),
                           to_string(release->getLabel()));
    std::sort(found.begin(), found.end());

    Table table({{"package"}, {"release"}, {"KiB", Table::Alignment::Right}});
    for (auto const& [negativeSize, package, release] : found)
        table.addRow({package, release, std::to_string(-negativeSize)});
    return table;
}

template <ElementForm Form>
Table Questions<Form>::reverseDependencies(std::string const& name) const
{
    bool const isHere = m_index->getPackages().count(to_ustring(name)) != 0;
    if (!isHere && !m_missing.contains(name))
        throw std::runtime_error("neither a package nor a dependency is called \"" + name + '"');

    query::AbstractQuery query(m_model);
    Releases<Form> users({query, EXACT});
    Groups<Form> groups({query, EXACT});
    Alternatives<Form> alternatives({query, EXACT});
    groups.release.refersTo(users);
    alternatives.group.refersTo(groups);
    std::optional<Packages<Form>> targets;
    if (isHere)
    {
        targets.emplace(SearchSource(query, EXACT));
        targets->name == to_ustring(name);
        alternatives.target.refersTo(*targets);
    }

    std::set<Table::Row> rows;
    for (auto const& [user, group, alternative] : query.results(users, groups, alternatives))
    {
        // The model holds no element of a missing package to search for.
        if (isHere || targetText<Form>(alternative, m_missing) == name)
            rows.insert({textOf<Form>(user->getPackage()), to_string(user->getLabel()),
                         textOf<Form>(group, nullptr, &m_missing)});
    }
    return tableOf({{"package"}, {"release"}, {"dependency"}}, rows);
}

template <ElementForm Form> std::string Questions<Form>::mostNamedPackage() const
{
    NamedPackages<Form> named(m_model);
    std::map<std::string, std::size_t> counts;
    for (auto const& [target] : named.query.results(named.targets))
        ++counts[textOf<Form>(target)];
    auto const most =
        std::max_element(counts.begin(), counts.end(), [](auto const& one, auto const& other) {
            return one.second < other.second;
        });
    return most == counts.end() ? std::string() : most->first;
}

#define DEBIAN_INSTANTIATE(Form) template class Questions<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
