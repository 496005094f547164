#include "EssentialNeeds.h"

#include "Dependencies.h"

#include <algorithm>
#include <unordered_map>

namespace debian {
namespace {

/// The essential releases and all that can satisfy what they need, directly or not.
template <ElementForm Form> class NeedGraph
{
public:
    explicit NeedGraph(PackageIndex<Form> const& index)
    {
        forEachRelease<Form>(index, [&](Release<Form> const& release) {
            if (release->isEssential())
                nodeOf(release);
        });
        m_essentialCount = m_nodes.size();
        for (std::size_t node = 0; node < m_nodes.size(); ++node)
            expand(node);
        while (dropThoseThatLack())
        {}
    }

    std::vector<DependencyGroup<Form>> lacking() const
    {
        std::vector<DependencyGroup<Form>> unsatisfied;
        std::vector<DependencyGroup<Form>> unusable;
        std::vector<bool> seen(m_nodes.size());
        std::vector<std::size_t> blamed;
        auto const blame = [&](std::size_t node) {
            if (!m_nodes[node].works && !seen[node])
            {
                seen[node] = true;
                blamed.push_back(node);
            }
        };
        for (std::size_t node = 0; node < m_essentialCount; ++node)
            blame(node);
        for (std::size_t next = 0; next < blamed.size(); ++next)
        {
            for (Need const& need : m_nodes[blamed[next]].needs)
            {
                if (isMet(need))
                    continue;
                (need.satisfiers.empty() ? unsatisfied : unusable).push_back(need.group);
                std::for_each(need.satisfiers.begin(), need.satisfiers.end(), blame);
            }
        }
        unsatisfied.insert(unsatisfied.end(), unusable.begin(), unusable.end());
        return unsatisfied;
    }

private:
    struct Need
    {
        DependencyGroup<Form> group;
        std::vector<std::size_t> satisfiers;
    };
    struct Node
    {
        Release<Form> release;
        std::vector<Need> needs;
        bool works = true;  // until a need turns out not to be met
    };

    std::size_t nodeOf(Release<Form> const& release)
    {
        auto const [place, isNew] = m_places.emplace(release.getImpl(), m_nodes.size());
        if (isNew)
            m_nodes.push_back({release, {}});
        return place->second;
    }

    void expand(std::size_t node)
    {
        for (DependencyGroup<Form> const& group : strictGroupsOf<Form>(m_nodes[node].release))
        {
            Need need{group, {}};
            for (Release<Form> const& satisfier : satisfiersOf<Form>(group))
                need.satisfiers.push_back(nodeOf(satisfier));
            m_nodes[node].needs.push_back(std::move(need));
        }
    }

    bool isMet(Need const& need) const
    {
        return std::any_of(need.satisfiers.begin(), need.satisfiers.end(),
                           [&](std::size_t satisfier) { return m_nodes[satisfier].works; });
    }

    /// Whether there were any. The last round leaves the largest set of releases that work.
    bool dropThoseThatLack()
    {
        bool dropped = false;
        for (Node& node : m_nodes)
        {
            bool const lacks = std::any_of(node.needs.begin(), node.needs.end(),
                                           [&](Need const& need) { return !isMet(need); });
            dropped |= node.works && lacks;
            node.works = node.works && !lacks;
        }
        return dropped;
    }

    std::vector<Node> m_nodes;  // the essential ones first
    std::size_t m_essentialCount = 0;
    std::unordered_map<tarn::kiln::ModelElement::Impl*, std::size_t> m_places;
};

}  // namespace

template <ElementForm Form>
std::vector<DependencyGroup<Form>> lackingDependencies(PackageIndex<Form> const& index)
{
    return NeedGraph<Form>(index).lacking();
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template std::vector<DependencyGroup<Form>> lackingDependencies<Form>(                         \
        PackageIndex<Form> const&);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
