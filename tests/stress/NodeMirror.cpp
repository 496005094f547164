#include "tests/stress/NodeMirror.h"

#include <boost/uuid/uuid_io.hpp>

#include <algorithm>

namespace testkit {

namespace {

void eraseFirst(std::vector<int>& nodes, int node)
{
    auto const found = std::find(nodes.begin(), nodes.end(), node);
    if (found != nodes.end())
        nodes.erase(found);
}

bool contains(std::vector<int> const& nodes, int node)
{
    return std::find(nodes.begin(), nodes.end(), node) != nodes.end();
}

std::string listOf(std::vector<std::string> const& texts)
{
    std::string list;
    for (std::string const& text : texts)
        list += (list.empty() ? "[" : ",") + text;
    return list + "]";
}

}  // namespace

std::vector<std::string> NodeMirror::picture() const
{
    std::vector<std::string> lines;
    for (auto const& [node, state] : m_nodes)
    {
        std::string line = "n" + std::to_string(node);
        auto const tag = [&](int target) {
            if (target >= PROXY_OF_NODE)
                return "proxy " + boost::uuids::to_string(uuidOfNode(target - PROXY_OF_NODE));
            if (target >= PROXY)
                return "proxy p" + std::to_string(target - PROXY);
            return (isAlive(target) ? "n" : "dead n") + std::to_string(target);
        };
        auto const add = [&](char const* name, std::string const& value) {
            line += std::string(" ") + name + "=" + value;
        };
        auto const single = [&](char const* name, int target) {
            if (target != NONE)
                add(name, tag(target));
        };
        auto const many = [&](char const* name, auto const& targets, bool sorted) {
            std::vector<std::string> tags;
            for (int const target : targets)
                tags.push_back(tag(target));
            if (sorted)
                std::sort(tags.begin(), tags.end());
            if (!tags.empty())
                add(name, listOf(tags));
        };
        add("name", state.name);
        add("count", std::to_string(state.count));
        add("rank", "-");
        add("note", "-");
        single("container", state.container);
        if (state.place != TOP)
            add("in", std::to_string(state.place));
        single("buddy", state.buddy);
        single("left", state.left);
        single("right", state.right);
        single("owner", state.owner);
        single("group", state.group);
        single("core", state.core);
        single("body", state.body);
        many("owned", state.owned, false);
        many("links", state.links, false);
        many("backlinks", state.backlinks, false);
        many("children", state.children, false);
        many("parts", state.parts, false);
        many("byName", state.byName, true);
        many("grouped", state.grouped, true);
        many("marks", state.marks, true);
        many("markedBy", state.markedBy, true);
        std::vector<std::string> numbers;
        for (int const number : state.numbers)
            numbers.push_back(std::to_string(number));
        if (!numbers.empty())
            add("numbers", listOf(numbers));
        lines.push_back(line);
    }
    std::sort(lines.begin(), lines.end());
    return lines;
}

// ---------------------------------------------------------------------------- containment

bool NodeMirror::isInside(int node, int outer) const
{
    for (int above = node; above != NONE; above = at(above).container)
        if (above == outer)
            return true;
    return false;
}

bool NodeMirror::isKeyTaken(int scope, std::string const& key) const
{
    return std::any_of(at(scope).byName.begin(), at(scope).byName.end(),
                       [&](int member) { return member < PROXY && at(member).name == key; });
}

bool NodeMirror::isAt(int node, int container, Place place) const
{
    return at(node).container == container && at(node).place == place;
}

void NodeMirror::leave(int node)
{
    int const container = at(node).container;
    if (container == NONE)
        return;
    State& old = at(container);
    switch (at(node).place)
    {
    case CHILDREN:
        eraseFirst(old.children, node);
        break;
    case PARTS:
        eraseFirst(old.parts, node);
        break;
    case CORE:
        old.core = NONE;
        break;
    case BODY:
        old.body = NONE;
        break;
    case BY_NAME:
        old.byName.erase(node);
        break;
    case TOP:
        break;
    }
    at(node).container = NONE;
    at(node).place = TOP;
}

/// Empties a single content, a node or a proxy or none.
void NodeMirror::release(int owner, int content, int State::*slot)
{
    if (content != NONE && content < PROXY)
        leave(content);
    at(owner).*slot = NONE;
}

void NodeMirror::enter(int node, int container, Place place)
{
    leave(node);
    at(node).container = container;
    at(node).place = place;
}

NodeMirror::Failure NodeMirror::addChild(int parent, int node)
{
    if (isInside(parent, node))
        return Failure::Circular;
    if (isAt(node, parent, CHILDREN))
        return Failure::None;
    enter(node, parent, CHILDREN);
    at(parent).children.push_back(node);
    return Failure::None;
}

NodeMirror::Failure NodeMirror::setParent(int node, int parent)
{
    if (parent != NONE)
        return isAt(node, parent, CHILDREN) ? Failure::None : addChild(parent, node);
    if (at(node).place == CHILDREN)
        leave(node);
    return Failure::None;
}

NodeMirror::Failure NodeMirror::addPart(int owner, int node)
{
    if (isInside(owner, node))
        return Failure::Circular;
    at(owner).parts.push_back(node);
    enter(node, owner, PARTS);
    return Failure::None;
}

void NodeMirror::removePart(int owner, int node)
{
    if (isAt(node, owner, PARTS))
        leave(node);
}

NodeMirror::Failure NodeMirror::setCore(int owner, int node)
{
    int const old = at(owner).core;
    if (node == old)
        return Failure::None;
    if (node != NONE && isInside(owner, node))
        return Failure::Circular;
    release(owner, old, &State::core);
    if (node != NONE)
    {
        enter(node, owner, CORE);
        at(owner).core = node;
    }
    return Failure::None;
}

NodeMirror::Failure NodeMirror::setBody(int host, int node)
{
    int const old = at(host).body;
    if (node == old)
        return Failure::None;
    if (node != NONE && isInside(host, node))
        return Failure::Circular;
    release(host, old, &State::body);
    if (node != NONE)
    {
        enter(node, host, BODY);
        at(host).body = node;
    }
    return Failure::None;
}

NodeMirror::Failure NodeMirror::setHost(int node, int host)
{
    if (host != NONE)
        return setBody(host, node);
    if (at(node).place == BODY)
        leave(node);
    return Failure::None;
}

NodeMirror::Failure NodeMirror::addByName(int scope, int node)
{
    if (isInside(scope, node))
        return Failure::Circular;
    if (isAt(node, scope, BY_NAME))
        return Failure::None;
    if (isKeyTaken(scope, at(node).name))
        return Failure::KeyTaken;
    enter(node, scope, BY_NAME);
    at(scope).byName.insert(node);
    return Failure::None;
}

NodeMirror::Failure NodeMirror::setScope(int node, int scope)
{
    if (scope == NONE)
    {
        if (at(node).place == BY_NAME)
            leave(node);
        return Failure::None;
    }
    if (isAt(node, scope, BY_NAME))
        return Failure::None;
    if (isKeyTaken(scope, at(node).name))
        return Failure::KeyTaken;
    return addByName(scope, node);
}

NodeMirror::Failure NodeMirror::setName(int node, std::string const& name)
{
    if (name == at(node).name)
        return Failure::None;
    if (at(node).place == BY_NAME && isKeyTaken(at(node).container, name))
        return Failure::KeyTaken;
    at(node).name = name;
    return Failure::None;
}

// ---------------------------------------------------------------------------- references

void NodeMirror::setLeft(int node, int target)
{
    if (at(node).left == target)
        return;
    if (at(node).left != NONE)
        at(at(node).left).right = NONE;
    at(node).left = target;
    if (target == NONE)
        return;
    if (at(target).right != NONE)
        at(at(target).right).left = NONE;
    at(target).right = node;
    at(node).left = target;
}

void NodeMirror::setRight(int node, int target)
{
    if (at(node).right == target)
        return;
    if (at(node).right != NONE)
        at(at(node).right).left = NONE;
    at(node).right = target;
    if (target == NONE)
        return;
    if (at(target).left != NONE)
        at(at(target).left).right = NONE;
    at(target).left = node;
    at(node).right = target;
}

void NodeMirror::setOwner(int node, int owner)
{
    if (at(node).owner == owner)
        return;
    if (at(node).owner != NONE)
        eraseFirst(at(at(node).owner).owned, node);
    at(node).owner = owner;
    if (owner != NONE)
        at(owner).owned.push_back(node);
}

void NodeMirror::addOwned(int owner, int node)
{
    setOwner(node, owner);
}

void NodeMirror::removeOwned(int owner, int node)
{
    if (at(node).owner == owner)
        setOwner(node, NONE);
}

void NodeMirror::setGroup(int node, int group)
{
    if (at(node).group == group)
        return;
    if (at(node).group != NONE)
        at(at(node).group).grouped.erase(node);
    at(node).group = group;
    if (group != NONE)
        at(group).grouped.insert(node);
}

void NodeMirror::addGrouped(int group, int node)
{
    setGroup(node, group);
}

void NodeMirror::addLink(int node, int target)
{
    if (contains(at(node).links, target))
        return;
    at(node).links.push_back(target);
    at(target).backlinks.push_back(node);
}

void NodeMirror::insertLink(int node, int target)
{
    if (contains(at(node).links, target))
        return;
    at(node).links.insert(at(node).links.begin(), target);
    at(target).backlinks.push_back(node);
}

void NodeMirror::removeLink(int node, int target)
{
    eraseFirst(at(node).links, target);
    eraseFirst(at(target).backlinks, node);
}

void NodeMirror::removeLinkToProxy(int node, int proxy)
{
    eraseFirst(at(node).links, proxy);
}

void NodeMirror::addMark(int node, int target)
{
    at(node).marks.insert(target);
    at(target).markedBy.insert(node);
}

void NodeMirror::eraseMark(int node, int target)
{
    at(node).marks.erase(target);
    at(target).markedBy.erase(node);
}

void NodeMirror::readBuddy(int node)
{
    int const target = at(node).buddy - PROXY_OF_NODE;
    if (isAlive(target))
        at(node).buddy = target;
}

// ---------------------------------------------------------------------------- contained proxies

void NodeMirror::addContentProxy(int node, Place place, int proxy)
{
    State& state = at(node);
    switch (place)
    {
    case CHILDREN:
        state.children.push_back(proxy);
        break;
    case PARTS:
        state.parts.push_back(proxy);
        break;
    case CORE:
        release(node, state.core, &State::core);
        state.core = proxy;
        break;
    case BODY:
        release(node, state.body, &State::body);
        state.body = proxy;
        break;
    case BY_NAME:
        state.byName.insert(proxy);
        break;
    case TOP:
        break;
    }
}

int NodeMirror::removeContentProxy(int node, Place place)
{
    auto const removeFirst = [](auto& contents) {
        auto const found = std::find_if(contents.begin(), contents.end(),
                                        [](int content) { return content >= PROXY; });
        if (found == contents.end())
            return NONE;
        int const proxy = *found;
        contents.erase(found);
        return proxy;
    };
    State& state = at(node);
    return place == CHILDREN ? removeFirst(state.children)
           : place == PARTS  ? removeFirst(state.parts)
                             : removeFirst(state.byName);
}

std::vector<int> NodeMirror::contentProxies() const
{
    std::vector<int> result;
    auto const add = [&result](int content) {
        if (content >= PROXY)
            result.push_back(content);
    };
    for (auto const& [node, state] : m_nodes)
    {
        std::for_each(state.children.begin(), state.children.end(), add);
        std::for_each(state.parts.begin(), state.parts.end(), add);
        std::for_each(state.byName.begin(), state.byName.end(), add);
        add(state.core);
        add(state.body);
    }
    return result;
}

// ---------------------------------------------------------------------------- destruction

void NodeMirror::forget(int node)
{
    State const state = at(node);
    auto const forgetNode = [this](int content) {
        if (content != NONE && content < PROXY)
            forget(content);
    };
    for (std::vector<int> const& contained : {state.children, state.parts})
        for (int const each : contained)
            forgetNode(each);
    for (int const each : state.byName)
        forgetNode(each);
    for (int const each : {state.core, state.body})
        forgetNode(each);
    setLeft(node, NONE);
    setRight(node, NONE);
    setOwner(node, NONE);
    setGroup(node, NONE);
    for (int const each : state.owned)
        if (isAlive(each))
            removeOwned(node, each);
    for (int const each : state.grouped)
        if (isAlive(each) && at(each).group == node)
            setGroup(each, NONE);
    for (int const each : state.links)
        if (isAlive(each))
            removeLink(node, each);
    for (int const each : state.backlinks)
        if (isAlive(each))
            removeLink(each, node);
    for (int const each : state.marks)
        if (isAlive(each))
            eraseMark(node, each);
    for (int const each : state.markedBy)
        if (isAlive(each))
            eraseMark(each, node);
    m_nodes.erase(node);
}

void NodeMirror::destroy(int node)
{
    leave(node);
    forget(node);
}
}  // namespace testkit
