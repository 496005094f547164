/// \file
/// What operations on extension values ought to do, on plain numbers.
#pragma once
#include <map>
#include <string>
#include <vector>

namespace testkit {

/// Plays the values that the elements of one model have of three extensions, under the numbers of
/// their creation. Copied to be restored at a rollback.
class ExtensionMirror
{
public:
    static constexpr int NONE = -1;

    struct State
    {
        int shelf = 0;
        int friendNumber = NONE;
        std::vector<int> pages;
    };

    bool isAlive(int node) const { return m_nodes.count(node) != 0; }
    /// A line for each node: its number, shelf, friend and pages.
    std::vector<std::string> picture() const;

    void create(int node) { m_nodes[node]; }
    void destroy(int node) { m_nodes.erase(node); }
    void setShelf(int node, int shelf) { m_nodes.at(node).shelf = shelf; }
    void setFriend(int node, int other) { m_nodes.at(node).friendNumber = other; }
    void addPage(int node, int page) { m_nodes.at(node).pages.push_back(page); }
    void removePage(int node, int page);
    void clearPages(int node) { m_nodes.at(node).pages.clear(); }
    /// The extension of shelves makes room for a new one of the same name and default.
    void redeclareShelf();

    static std::string line(int node, State const& state);

private:
    std::map<int, State> m_nodes;
};
}  // namespace testkit
