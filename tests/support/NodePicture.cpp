#include "tests/support/NodePicture.h"

#include <algorithm>

namespace testkit {

namespace {

std::string narrow(ustring const& text)
{
    return std::string(text.begin(), text.end());
}

std::string tagOf(ModelElement const& element)
{
    Node const node = Node::cast(element);
    if (!node.getImpl())
        return "-";
    if (ProxyId const* const id = node->getProxyIdImpl())
        return "proxy " + narrow(id->getId());
    return (node ? "" : "dead ") + node->getTag();
}

/// The line of one node.
class Line
{
public:
    explicit Line(std::string text) : m_text(std::move(text)) {}

    void add(char const* name, std::string const& value)
    {
        m_text += std::string(" ") + name + "=" + value;
    }
    void add(char const* name, ModelElement const& target)
    {
        if (target.getImpl())
            add(name, tagOf(target));
    }
    void add(char const* name, std::vector<std::string> values, bool sorted = false)
    {
        if (values.empty())
            return;
        if (sorted)
            std::sort(values.begin(), values.end());
        std::string list;
        for (std::string const& value : values)
            list += (list.empty() ? "[" : ",") + value;
        add(name, list + "]");
    }
    void add(char const* name, ReferenceCollection const& collection, bool sorted = false)
    {
        std::vector<std::string> tags;
        for (ModelElement const& element : collection.getAllValuesAndProxies())
            tags.push_back(tagOf(element));
        add(name, tags, sorted);
    }

    std::string take() { return std::move(m_text); }

private:
    std::string m_text;
};

std::string lineOf(ModelElement const& element)
{
    Node const node = Node::cast(element);
    if (!node.getImpl())
        return element->isTopLevel() ? "- at top level" : "- in another element";
    Line line(node->getTag());
    line.add("name", narrow(node->getName()));
    line.add("count", std::to_string(node->getCount()));
    line.add("rank", node->getRank() ? std::to_string(*node->getRank()) : std::string("-"));
    line.add("note", node->getNote() ? narrow(*node->getNote()) : std::string("-"));
    line.add("container", node->container());
    if (!node->isTopLevel())
        line.add("in", std::to_string(node->getContainment().index()));
    line.add("buddy", ModelElement(node->getBuddyImpl()));
    line.add("left", ModelElement(node->getLeftImpl()));
    line.add("right", ModelElement(node->getRightImpl()));
    line.add("owner", ModelElement(node->getOwnerImpl()));
    line.add("group", ModelElement(node->getGroupImpl()));
    line.add("core", ModelElement(node->getCoreImpl()));
    line.add("body", ModelElement(node->getBodyImpl()));
    line.add("owned", node->getOwned());
    line.add("links", node->getLinks());
    line.add("backlinks", node->getBacklinks());
    line.add("children", node->getChildren());
    line.add("parts", node->getParts());
    line.add("byName", node->getByName(), /*sorted=*/true);
    line.add("grouped", node->getGrouped(), /*sorted=*/true);
    line.add("marks", node->getMarks(), /*sorted=*/true);
    line.add("markedBy", node->getMarkedBy(), /*sorted=*/true);
    std::vector<std::string> values;
    for (int const number : node->getNumbers())
        values.push_back(std::to_string(number));
    line.add("numbers", std::exchange(values, {}));
    for (ustring const& label : node->getLabels())
        values.push_back(narrow(label));
    line.add("labels", std::exchange(values, {}));
    for (ustring const& word : node->getWords().getEntries())
        values.push_back(narrow(word));
    line.add("words", std::exchange(values, {}), /*sorted=*/true);
    return line.take();
}

}  // namespace

std::vector<std::string> pictureOf(Model const& model)
{
    std::vector<std::string> lines;
    for (ModelElement const& element : model->getAllElements())
        lines.push_back(lineOf(element));
    std::sort(lines.begin(), lines.end());
    return lines;
}
}  // namespace testkit
