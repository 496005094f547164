/// \file
/// Which packages use which, seen from the package that is used.
#pragma once
#include "Forms.h"

#include <cstddef>
#include <unordered_map>
#include <vector>

namespace debian {

/// The packages of an index that have releases, with who needs and who uses whom.
///
/// A package *needs* those that a strict dependency names, and *uses* those that it needs or
/// recommends; versions do not matter, and a name stands for all packages that provide it. It is a
/// picture of the index when it was made.
///
/// Threads: as the model.
template <ElementForm Form> class PackageGraph
{
public:
    explicit PackageGraph(PackageIndex<Form> const& index);

    /// A package that no other uses and that is not essential, with those that it needs, directly
    /// or not, and that nobody else uses; itself first. Essential packages are never among them.
    std::vector<Package<Form>> removableWith(Package<Form> const& leaf) const;

    /// Of the first leaves by name, the one with which most can be removed; empty if there is none.
    Package<Form> chooseLeaf() const;

private:
    struct Node
    {
        Package<Form> package;
        bool essential;
        std::vector<std::size_t> needs;
        std::vector<std::size_t> users;  // without the package itself
    };

    void addEdges(std::size_t user);
    void addEdge(std::size_t user, Package<Form> const& used, bool strict);
    bool isLeaf(Node const& node) const { return !node.essential && node.users.empty(); }
    std::vector<std::size_t> removableWith(std::size_t leaf) const;

    std::vector<Node> m_nodes;  // by name
    std::unordered_map<tarn::kiln::ModelElement::Impl*, std::size_t> m_places;
};

}  // namespace debian
