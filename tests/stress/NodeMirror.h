/// \file
/// What operations on nodes ought to do, on plain numbers.
#pragma once
#include "tests/support/Uuids.h"

#include <cstddef>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace testkit {

/// Plays the nodes of one model, under the numbers of their creation.
///
/// Each operation does what the one of the same name of a `Node` should do, and answers with the
/// failure that it should raise. Copied to be restored at a rollback.
class NodeMirror
{
public:
    static constexpr int NONE = -1;
    /// From here on numbers stand for proxies of targets that are nowhere. They are no nodes, only
    /// targets of `buddy`, `links`, `grouped` and `marks`, and contents.
    static constexpr int PROXY = 1000;
    /// A number from here on stands for a proxy of the node whose number is the rest. It is a
    /// target of `buddy` only.
    static constexpr int PROXY_OF_NODE = 1'000'000;

    enum class Failure
    {
        None,
        Circular,
        KeyTaken
    };

    /// The property of the container that holds a node.
    enum Place : int
    {
        TOP = 0,
        CHILDREN = 16,
        PARTS = 18,
        CORE = 19,
        BODY = 20,
        BY_NAME = 22
    };

    struct State
    {
        std::string name;
        int count = 0;
        int container = NONE;
        Place place = TOP;
        int buddy = NONE, left = NONE, right = NONE, owner = NONE, group = NONE;
        int core = NONE, body = NONE;
        std::vector<int> owned, links, backlinks, children, parts, numbers;
        std::set<int> byName, grouped, marks, markedBy;
    };

    static tarn::kiln::UUID uuidOfNode(int node)
    {
        return uuidOf(static_cast<std::uint32_t>(node) + 1);
    }

    /// The live nodes, by number.
    std::map<int, State> const& nodes() const { return m_nodes; }
    bool isAlive(int node) const { return m_nodes.count(node) != 0; }
    /// As `pictureOf` would show it; the tag of a node is "n" and its number.
    std::vector<std::string> picture() const;

    void create(int node) { m_nodes[node]; }
    void destroy(int node);
    void setCount(int node, int count) { at(node).count = count; }
    Failure setName(int node, std::string const& name);
    void addNumber(int node, int number) { at(node).numbers.push_back(number); }

    void setBuddy(int node, int target) { at(node).buddy = target; }
    void setLeft(int node, int target);
    void setRight(int node, int target);
    void setOwner(int node, int owner);
    void addOwned(int owner, int node);
    void removeOwned(int owner, int node);
    void setGroup(int node, int group);
    void addGrouped(int group, int node);
    void addLink(int node, int target);
    void insertLink(int node, int target);
    void removeLink(int node, int target);
    void addMark(int node, int target);
    void eraseMark(int node, int target);

    void addLinkToProxy(int node, int proxy) { at(node).links.push_back(proxy); }
    void removeLinkToProxy(int node, int proxy);
    void addGroupedProxy(int node, int proxy) { at(node).grouped.insert(proxy); }
    void eraseGroupedProxy(int node, int proxy) { at(node).grouped.erase(proxy); }
    void addMarkOfProxy(int node, int proxy) { at(node).marks.insert(proxy); }
    void eraseMarkOfProxy(int node, int proxy) { at(node).marks.erase(proxy); }
    /// A read of `buddy` puts a live node in the place of its proxy.
    void readBuddy(int node);

    void addContentProxy(int node, Place place, int proxy);
    /// Takes out the first proxy in `children`, `parts` or `byName`; `NONE` if there is none.
    int removeContentProxy(int node, Place place);
    /// Of all contents.
    std::vector<int> contentProxies() const;

    Failure addChild(int parent, int node);
    Failure setParent(int node, int parent);
    Failure addPart(int owner, int node);
    void removePart(int owner, int node);
    Failure setCore(int owner, int node);
    Failure setBody(int host, int node);
    Failure setHost(int node, int host);
    Failure addByName(int scope, int node);
    Failure setScope(int node, int scope);

private:
    State& at(int node) { return m_nodes.at(node); }
    State const& at(int node) const { return m_nodes.at(node); }
    bool isInside(int node, int outer) const;
    bool isKeyTaken(int scope, std::string const& key) const;
    bool isAt(int node, int container, Place place) const;
    void leave(int node);
    void release(int owner, int content, int State::*slot);
    void enter(int node, int container, Place place);
    void forget(int node);

    std::map<int, State> m_nodes;
};
}  // namespace testkit
