#include "tests/stress/ExtensionMirror.h"

#include <algorithm>

namespace testkit {

std::vector<std::string> ExtensionMirror::picture() const
{
    std::vector<std::string> result;
    for (auto const& [node, state] : m_nodes)
        result.push_back(line(node, state));
    return result;
}

void ExtensionMirror::removePage(int node, int page)
{
    std::vector<int>& pages = m_nodes.at(node).pages;
    auto const found = std::find(pages.begin(), pages.end(), page);
    if (found != pages.end())
        pages.erase(found);
}

void ExtensionMirror::redeclareShelf()
{
    for (auto& [node, state] : m_nodes)
        state.shelf = 0;
}

std::string ExtensionMirror::line(int node, State const& state)
{
    std::string result = std::to_string(node) + " shelf " + std::to_string(state.shelf) +
                         " friend " + std::to_string(state.friendNumber) + " pages";
    for (int const page : state.pages)
        result += ' ' + std::to_string(page);
    return result;
}
}  // namespace testkit
