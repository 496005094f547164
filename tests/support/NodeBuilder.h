/// \file
/// What describes a new `Node` and makes it.
#pragma once
#include "tarnkiln/support/Builder.h"
#include "tests/support/NodeImpl.h"

#include <initializer_list>
#include <memory>
#include <utility>
#include <vector>

namespace testkit {

/// The values of a `Node` to be.
class Node::Impl::BuilderImpl : public support::BuilderValues<Node::Impl, support::BuilderRoot>
{
public:
    using BuilderValues::BuilderValues;

    void doSetName(ustring const& name) { m_name = name; }
    void doSetCount(int count) { m_count = count; }
    void doSetWeight(double weight) { m_weight = weight; }
    void doSetIsOpen(bool open) { m_isOpen = open; }
    void doSetTag(string const& tag) { m_tag = tag; }
    void doSetToken(UUID const& token) { m_token = token; }
    void doSetRank(boost::optional<int> const& rank) { m_rank = rank; }
    void doSetNote(boost::optional<ustring> const& note) { m_note = note; }
    void doSetBuddy(Node const& buddy) { m_buddy = buddy; }
    void doSetLeft(Node const& left) { m_left = left; }
    void doSetRight(Node const& right) { m_right = right; }
    void doAddOwned(Node const& owned) { m_owned.push_back(owned); }
    void doClearOwned() { m_owned.clear(); }
    void doSetOwner(Node const& owner) { m_owner = owner; }
    void doAddLinks(Node const& links) { m_links.push_back(links); }
    void doClearLinks() { m_links.clear(); }
    void doAddBacklinks(Node const& backlinks) { m_backlinks.push_back(backlinks); }
    void doClearBacklinks() { m_backlinks.clear(); }
    void doAddChildren(std::unique_ptr<ModelElement::Builder> children)
    {
        support::addNested(m_children, std::move(children));
    }
    void doClearChildren() { m_children.clear(); }
    void doSetParent(Node const& parent) { m_parent = parent; }
    void doAddParts(std::unique_ptr<ModelElement::Builder> parts)
    {
        support::addNested(m_parts, std::move(parts));
    }
    void doClearParts() { m_parts.clear(); }
    void doSetCore(Node const& core) { m_core = core; }
    void doAddCore(std::unique_ptr<ModelElement::Builder> core) { m_core = std::move(core); }
    void doSetBody(Node const& body) { m_body = body; }
    void doAddBody(std::unique_ptr<ModelElement::Builder> body) { m_body = std::move(body); }
    void doSetHost(Node const& host) { m_host = host; }
    void doAddByName(std::unique_ptr<ModelElement::Builder> byName)
    {
        support::addNested(m_byName, std::move(byName));
    }
    void doClearByName() { m_byName.clear(); }
    void doSetScope(Node const& scope) { m_scope = scope; }
    void doAddGrouped(Node const& grouped) { m_grouped.push_back(grouped); }
    void doClearGrouped() { m_grouped.clear(); }
    void doSetGroup(Node const& group) { m_group = group; }
    void doAddMarks(Node const& marks) { m_marks.push_back(marks); }
    void doClearMarks() { m_marks.clear(); }
    void doAddMarkedBy(Node const& markedBy) { m_markedBy.push_back(markedBy); }
    void doClearMarkedBy() { m_markedBy.clear(); }
    void doAddNumbers(int numbers) { m_numbers.push_back(numbers); }
    void doClearNumbers() { m_numbers.clear(); }
    void doAddLabels(ustring const& labels) { m_labels.push_back(labels); }
    void doClearLabels() { m_labels.clear(); }
    void doAddWords(ustring const& words) { m_words.push_back(words); }
    void doClearWords() { m_words.clear(); }

private:
    ustring m_name;
    int m_count = 0;
    double m_weight = 0;
    bool m_isOpen = true;
    string m_tag;
    UUID m_token{};
    boost::optional<int> m_rank;
    boost::optional<ustring> m_note;
    Node m_buddy;
    Node m_left;
    Node m_right;
    std::vector<Node> m_owned;
    Node m_owner;
    std::vector<Node> m_links;
    std::vector<Node> m_backlinks;
    support::NestedBuilders m_children;
    Node m_parent;
    support::NestedBuilders m_parts;
    support::NestedElement<Node> m_core;
    support::NestedElement<Node> m_body;
    Node m_host;
    support::NestedBuilders m_byName;
    Node m_scope;
    std::vector<Node> m_grouped;
    Node m_group;
    std::vector<Node> m_marks;
    std::vector<Node> m_markedBy;
    std::vector<int> m_numbers;
    std::vector<ustring> m_labels;
    std::vector<ustring> m_words;

public:
    using Fields = support::BuilderFields<
        &BuilderImpl::m_name, &BuilderImpl::m_count, &BuilderImpl::m_weight, &BuilderImpl::m_isOpen,
        &BuilderImpl::m_tag, &BuilderImpl::m_token, &BuilderImpl::m_rank, &BuilderImpl::m_note,
        &BuilderImpl::m_buddy, &BuilderImpl::m_left, &BuilderImpl::m_right, &BuilderImpl::m_owned,
        &BuilderImpl::m_owner, &BuilderImpl::m_links, &BuilderImpl::m_backlinks,
        &BuilderImpl::m_children, &BuilderImpl::m_parent, &BuilderImpl::m_parts,
        &BuilderImpl::m_core, &BuilderImpl::m_body, &BuilderImpl::m_host, &BuilderImpl::m_byName,
        &BuilderImpl::m_scope, &BuilderImpl::m_grouped, &BuilderImpl::m_group,
        &BuilderImpl::m_marks, &BuilderImpl::m_markedBy, &BuilderImpl::m_numbers,
        &BuilderImpl::m_labels, &BuilderImpl::m_words>;
};

/// The setters of what a `Node` and all that extends it have.
///
/// Each returns the builder. A single value takes the place of the one given before.
template <class Final> class Node::Impl::BuilderBase : public support::BuilderTop<Final>
{
    using Above = support::BuilderTop<Final>;

public:
    using Above::Above;

    /// The key of `byName` and `grouped`.
    Final& setName(ustring const& name) { return this->give(NAME, &BuilderImpl::doSetName, name); }

    /// A number.
    Final& setCount(int count) { return this->give(COUNT, &BuilderImpl::doSetCount, count); }

    /// A number.
    Final& setWeight(double weight)
    {
        return this->give(WEIGHT, &BuilderImpl::doSetWeight, weight);
    }

    /// True at first.
    Final& setIsOpen(bool open) { return this->give(IS_OPEN, &BuilderImpl::doSetIsOpen, open); }

    /// A text.
    Final& setTag(string const& tag) { return this->give(TAG, &BuilderImpl::doSetTag, tag); }

    /// A UUID.
    Final& setToken(UUID const& token)
    {
        return this->give(TOKEN, &BuilderImpl::doSetToken, token);
    }

    /// A number, or none.
    Final& setRank(boost::optional<int> const& rank)
    {
        return this->give(RANK, &BuilderImpl::doSetRank, rank);
    }
    Final& setRank(int rank) { return this->give(RANK, &BuilderImpl::doSetRank, rank); }

    /// A text, or none.
    Final& setNote(boost::optional<ustring> const& note)
    {
        return this->give(NOTE, &BuilderImpl::doSetNote, note);
    }
    Final& setNote(ustring const& note) { return this->give(NOTE, &BuilderImpl::doSetNote, note); }

    /// A reference without an opposite.
    Final& setBuddy(Node const& buddy)
    {
        return this->give(BUDDY, &BuilderImpl::doSetBuddy, buddy);
    }

    /// One end of an association of one to one.
    Final& setLeft(Node const& left) { return this->give(LEFT, &BuilderImpl::doSetLeft, left); }

    /// The other end.
    Final& setRight(Node const& right)
    {
        return this->give(RIGHT, &BuilderImpl::doSetRight, right);
    }

    /// Many of one, not contained.
    Final& addOwned(Node const& owned)
    {
        return this->give(OWNED, &BuilderImpl::doAddOwned, owned);
    }
    Final& addOwned(std::initializer_list<Node> owned)
    {
        return this->giveEach(OWNED, &BuilderImpl::doAddOwned, owned);
    }
    Final& clearOwned() { return this->give(OWNED, &BuilderImpl::doClearOwned); }

    /// The one of `owned`.
    Final& setOwner(Node const& owner)
    {
        return this->give(OWNER, &BuilderImpl::doSetOwner, owner);
    }

    /// One end of an association of many to many.
    Final& addLinks(Node const& links)
    {
        return this->give(LINKS, &BuilderImpl::doAddLinks, links);
    }
    Final& addLinks(std::initializer_list<Node> links)
    {
        return this->giveEach(LINKS, &BuilderImpl::doAddLinks, links);
    }
    Final& clearLinks() { return this->give(LINKS, &BuilderImpl::doClearLinks); }

    /// The other end.
    Final& addBacklinks(Node const& backlinks)
    {
        return this->give(BACKLINKS, &BuilderImpl::doAddBacklinks, backlinks);
    }
    Final& addBacklinks(std::initializer_list<Node> backlinks)
    {
        return this->giveEach(BACKLINKS, &BuilderImpl::doAddBacklinks, backlinks);
    }
    Final& clearBacklinks() { return this->give(BACKLINKS, &BuilderImpl::doClearBacklinks); }

    /// Contained, with a way back.
    Final& addChildren(std::unique_ptr<ModelElement::Builder> children)
    {
        return this->give(CHILDREN, &BuilderImpl::doAddChildren, std::move(children));
    }
    Final& clearChildren() { return this->give(CHILDREN, &BuilderImpl::doClearChildren); }

    /// The container of `children`.
    Final& setParent(Node const& parent)
    {
        return this->give(PARENT, &BuilderImpl::doSetParent, parent);
    }

    /// Contained, without a way back.
    Final& addParts(std::unique_ptr<ModelElement::Builder> parts)
    {
        return this->give(PARTS, &BuilderImpl::doAddParts, std::move(parts));
    }
    Final& clearParts() { return this->give(PARTS, &BuilderImpl::doClearParts); }

    /// Contained, one, without a way back.
    Final& setCore(Node const& core) { return this->give(CORE, &BuilderImpl::doSetCore, core); }
    Final& setCore(std::unique_ptr<ModelElement::Builder> core)
    {
        return this->give(CORE, &BuilderImpl::doAddCore, std::move(core));
    }

    /// Contained, one, with a way back.
    Final& setBody(Node const& body) { return this->give(BODY, &BuilderImpl::doSetBody, body); }
    Final& setBody(std::unique_ptr<ModelElement::Builder> body)
    {
        return this->give(BODY, &BuilderImpl::doAddBody, std::move(body));
    }

    /// The container of `body`.
    Final& setHost(Node const& host) { return this->give(HOST, &BuilderImpl::doSetHost, host); }

    /// Contained, one a name.
    Final& addByName(std::unique_ptr<ModelElement::Builder> byName)
    {
        return this->give(BY_NAME, &BuilderImpl::doAddByName, std::move(byName));
    }
    Final& clearByName() { return this->give(BY_NAME, &BuilderImpl::doClearByName); }

    /// The container of `byName`.
    Final& setScope(Node const& scope)
    {
        return this->give(SCOPE, &BuilderImpl::doSetScope, scope);
    }

    /// Not contained, several a name.
    Final& addGrouped(Node const& grouped)
    {
        return this->give(GROUPED, &BuilderImpl::doAddGrouped, grouped);
    }
    Final& addGrouped(std::initializer_list<Node> grouped)
    {
        return this->giveEach(GROUPED, &BuilderImpl::doAddGrouped, grouped);
    }
    Final& clearGrouped() { return this->give(GROUPED, &BuilderImpl::doClearGrouped); }

    /// The one of `grouped`.
    Final& setGroup(Node const& group)
    {
        return this->give(GROUP, &BuilderImpl::doSetGroup, group);
    }

    /// One end of many to many, unordered.
    Final& addMarks(Node const& marks)
    {
        return this->give(MARKS, &BuilderImpl::doAddMarks, marks);
    }
    Final& addMarks(std::initializer_list<Node> marks)
    {
        return this->giveEach(MARKS, &BuilderImpl::doAddMarks, marks);
    }
    Final& clearMarks() { return this->give(MARKS, &BuilderImpl::doClearMarks); }

    /// The other end.
    Final& addMarkedBy(Node const& markedBy)
    {
        return this->give(MARKED_BY, &BuilderImpl::doAddMarkedBy, markedBy);
    }
    Final& addMarkedBy(std::initializer_list<Node> markedBy)
    {
        return this->giveEach(MARKED_BY, &BuilderImpl::doAddMarkedBy, markedBy);
    }
    Final& clearMarkedBy() { return this->give(MARKED_BY, &BuilderImpl::doClearMarkedBy); }

    /// Numbers in order, with repetitions.
    Final& addNumbers(int numbers)
    {
        return this->give(NUMBERS, &BuilderImpl::doAddNumbers, numbers);
    }
    Final& addNumbers(std::initializer_list<int> numbers)
    {
        return this->giveEach(NUMBERS, &BuilderImpl::doAddNumbers, numbers);
    }
    Final& clearNumbers() { return this->give(NUMBERS, &BuilderImpl::doClearNumbers); }

    /// Texts in order, each once.
    Final& addLabels(ustring const& labels)
    {
        return this->give(LABELS, &BuilderImpl::doAddLabels, labels);
    }
    Final& addLabels(std::initializer_list<ustring> labels)
    {
        return this->giveEach(LABELS, &BuilderImpl::doAddLabels, labels);
    }
    Final& clearLabels() { return this->give(LABELS, &BuilderImpl::doClearLabels); }

    /// Texts, each once.
    Final& addWords(ustring const& words)
    {
        return this->give(WORDS, &BuilderImpl::doAddWords, words);
    }
    Final& addWords(std::initializer_list<ustring> words)
    {
        return this->giveEach(WORDS, &BuilderImpl::doAddWords, words);
    }
    Final& clearWords() { return this->give(WORDS, &BuilderImpl::doClearWords); }
};

/// Describes a `Node` and makes it, with all that it is to contain.
///
/// Threads: used by one thread, that of the model.
class Node::Builder final : public Node::Impl::BuilderBase<Node::Builder>
{
public:
    using Handle = Node;

    /// For a builder inside another one, whose model it takes.
    Builder();
    explicit Builder(Model const& model);
    ~Builder() override;

private:
    friend class support::BuilderTop<Builder>;

    Impl::BuilderImpl m_values{*this};
};
}  // namespace testkit

extern template class tarn::kiln::support::BuilderValues<testkit::Node::Impl,
                                                         tarn::kiln::support::BuilderRoot>;
extern template class tarn::kiln::support::BuilderTop<testkit::Node::Builder>;
