#include "PackageGraph.h"

#include "Dependencies.h"

#include <algorithm>
#include <unordered_set>

namespace debian {
namespace {

constexpr std::size_t LEAVES_TO_TRY = 200;

void addOnce(std::vector<std::size_t>& nodes, std::size_t node)
{
    if (std::find(nodes.begin(), nodes.end(), node) == nodes.end())
        nodes.push_back(node);
}

}  // namespace

template <ElementForm Form> PackageGraph<Form>::PackageGraph(PackageIndex<Form> const& index)
{
    for (Package<Form> const& package : members(index->getPackages()))
    {
        if (!package->hasReleases() || package->getReleases().empty())
            continue;
        m_places.emplace(package.getImpl(), m_nodes.size());
        m_nodes.push_back({package, isEssential<Form>(package), {}, {}});
    }
    for (std::size_t node = 0; node < m_nodes.size(); ++node)
        addEdges(node);
}

template <ElementForm Form> void PackageGraph<Form>::addEdges(std::size_t user)
{
    forEachRelease<Form>(m_nodes[user].package, [&](Release<Form> const& release) {
        forEachGroup<Form>(release, [&](DependencyGroup<Form> const& group) {
            if (isSuggestion<Form>(group))
                return;
            bool const strict = isStrict<Form>(group);
            forEachAlternative<Form>(group, [&](Alternative<Form> const& alternative) {
                Package<Form> const target = installedTarget<Form>(alternative);
                if (!target)
                    return;
                addEdge(user, target, strict);
                forEachProvider<Form>(target, [&](Release<Form> const& provider) {
                    addEdge(user, provider->getPackage(), strict);
                });
            });
        });
    });
}

template <ElementForm Form>
void PackageGraph<Form>::addEdge(std::size_t user, Package<Form> const& used, bool strict)
{
    auto const place = m_places.find(used.getImpl());
    if (place == m_places.end() || place->second == user)
        return;
    // All edges of one user come together, so that a repeated one is the last one.
    std::vector<std::size_t>& users = m_nodes[place->second].users;
    if (users.empty() || users.back() != user)
        users.push_back(user);
    if (strict)
        addOnce(m_nodes[user].needs, place->second);
}

template <ElementForm Form>
std::vector<Package<Form>> PackageGraph<Form>::removableWith(Package<Form> const& leaf) const
{
    std::vector<Package<Form>> result;
    for (std::size_t const node : removableWith(m_places.at(leaf.getImpl())))
        result.push_back(m_nodes[node].package);
    return result;
}

template <ElementForm Form>
std::vector<std::size_t> PackageGraph<Form>::removableWith(std::size_t leaf) const
{
    std::vector<std::size_t> reached{leaf};
    std::unordered_set<std::size_t> removable{leaf};
    for (std::size_t next = 0; next < reached.size(); ++next)
    {
        for (std::size_t const needed : m_nodes[reached[next]].needs)
        {
            if (!m_nodes[needed].essential && removable.insert(needed).second)
                reached.push_back(needed);
        }
    }

    // Who is used from outside stays, and so does all that it uses.
    auto const stays = [&](std::size_t node) {
        auto const& users = m_nodes[node].users;
        return node != leaf && removable.contains(node) &&
               std::any_of(users.begin(), users.end(),
                           [&](std::size_t user) { return !removable.contains(user); });
    };
    std::vector<std::size_t> staying;
    std::copy_if(reached.begin(), reached.end(), std::back_inserter(staying), stays);
    while (!staying.empty())
    {
        std::size_t const node = staying.back();
        staying.pop_back();
        if (removable.erase(node) == 0)
            continue;
        std::copy_if(m_nodes[node].needs.begin(), m_nodes[node].needs.end(),
                     std::back_inserter(staying), stays);
    }
    std::erase_if(reached, [&](std::size_t node) { return !removable.contains(node); });
    return reached;
}

template <ElementForm Form> Package<Form> PackageGraph<Form>::chooseLeaf() const
{
    Package<Form> best;
    std::size_t bestSize = 0;
    std::size_t tried = 0;
    for (std::size_t node = 0; node < m_nodes.size() && tried < LEAVES_TO_TRY; ++node)
    {
        if (!isLeaf(m_nodes[node]))
            continue;
        ++tried;
        std::size_t const size = removableWith(node).size();
        if (size > bestSize)
        {
            best = m_nodes[node].package;
            bestSize = size;
        }
    }
    return best;
}

#define DEBIAN_INSTANTIATE(Form) template class PackageGraph<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
