/// \file
/// What stands behind a `Node`.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/PrimitiveSet.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/support/Dispatch.h"
#include "tests/support/Node.h"

#include <boost/optional.hpp>

#include <memory>

namespace testkit {

/// The properties of a `Node`.
///
/// Written as generated classes are.
class Node::Impl : public support::Dispatched<Node::Impl, ModelElement::Impl>
{
public:
    class BuilderImpl;                         // NodeBuilder.h
    template <class Final> class BuilderBase;  // NodeBuilder.h

    using Handle = Node;
    using Storage = support::Record<Impl, ModelElement::Impl::Storage>;

    static constexpr unsigned long SLOTS = 31;
    static Slot const NAME;
    static Slot const COUNT;
    static Slot const WEIGHT;
    static Slot const IS_OPEN;
    static Slot const TAG;
    static Slot const TOKEN;
    static Slot const RANK;
    static Slot const NOTE;
    static Slot const BUDDY;
    static Slot const LEFT;
    static Slot const RIGHT;
    static Slot const OWNED;
    static Slot const OWNER;
    static Slot const LINKS;
    static Slot const BACKLINKS;
    static Slot const CHILDREN;
    static Slot const PARENT;
    static Slot const PARTS;
    static Slot const CORE;
    static Slot const BODY;
    static Slot const HOST;
    static Slot const BY_NAME;
    static Slot const SCOPE;
    static Slot const GROUPED;
    static Slot const GROUP;
    static Slot const MARKS;
    static Slot const MARKED_BY;
    static Slot const NUMBERS;
    static Slot const LABELS;
    static Slot const WORDS;

    Impl(Model const& model, UUID const& id);
    /// With what a builder was given.
    Impl(BuilderImpl& values, UUID const& id);
    ~Impl() override;

    /// Makes what the builder holds builders for, after this element itself.
    void cascadeCreation(BuilderImpl& values);

    /// The key of `byName` and `grouped`.
    ustring const& getName() const { return m_name; }
    void setName(ustring const& name);

    /// A number.
    int getCount() const { return m_count; }
    void setCount(int count);

    /// A number.
    double getWeight() const { return m_weight; }
    void setWeight(double weight);

    /// True at first.
    bool isOpen() const { return m_isOpen; }
    void setIsOpen(bool open);

    /// A text.
    string const& getTag() const { return m_tag; }
    void setTag(string const& tag);

    /// A UUID.
    UUID const& getToken() const { return m_token; }
    void setToken(UUID const& token);

    /// A number, or none.
    boost::optional<int> const& getRank() const { return m_rank; }
    void setRank(boost::optional<int> const& rank);

    /// A text, or none.
    boost::optional<ustring> const& getNote() const { return m_note; }
    void setNote(boost::optional<ustring> const& note);

    /// A reference without an opposite.
    Node getBuddy() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getBuddyImpl() const { return m_buddy.get(); }
    /// Whether there is one and it is live.
    bool hasBuddy() const;
    void setBuddy(Node const& buddy);

    /// One end of an association of one to one.
    Node getLeft() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getLeftImpl() const { return m_left.get(); }
    /// Whether there is one and it is live.
    bool hasLeft() const;
    void setLeft(Node const& left);

    /// The other end.
    Node getRight() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getRightImpl() const { return m_right.get(); }
    /// Whether there is one and it is live.
    bool hasRight() const;
    void setRight(Node const& right);

    /// Many of one, not contained.
    ElementSequence<Node>& getOwned() const;
    /// Whether the collection was made, as its getter does.
    bool hasOwned() const { return m_owned.get(); }

    /// The one of `owned`.
    Node getOwner() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getOwnerImpl() const { return m_owner.get(); }
    /// Whether there is one and it is live.
    bool hasOwner() const;
    void setOwner(Node const& owner);

    /// One end of an association of many to many.
    ElementSequence<Node>& getLinks() const;
    /// Whether the collection was made, as its getter does.
    bool hasLinks() const { return m_links.get(); }

    /// The other end.
    ElementSequence<Node>& getBacklinks() const;
    /// Whether the collection was made, as its getter does.
    bool hasBacklinks() const { return m_backlinks.get(); }

    /// Contained, with a way back.
    ElementSequence<Node>& getChildren() const;
    /// Whether the collection was made, as its getter does.
    bool hasChildren() const { return m_children.get(); }

    /// The container of `children`.
    Node getParent() const;
    Node::Impl* getParentImpl() const;
    /// Whether there is one and it is live.
    bool hasParent() const;
    void setParent(Node const& parent);

    /// Contained, without a way back.
    ElementSequence<Node>& getParts() const;
    /// Whether the collection was made, as its getter does.
    bool hasParts() const { return m_parts.get(); }

    /// Contained, one, without a way back.
    Node getCore() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getCoreImpl() const { return m_core.get(); }
    /// Whether there is one and it is live.
    bool hasCore() const;
    void setCore(Node const& core);

    /// Contained, one, with a way back.
    Node getBody() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getBodyImpl() const { return m_body.get(); }
    /// Whether there is one and it is live.
    bool hasBody() const;
    void setBody(Node const& body);

    /// The container of `body`.
    Node getHost() const;
    Node::Impl* getHostImpl() const;
    /// Whether there is one and it is live.
    bool hasHost() const;
    void setHost(Node const& host);

    /// Contained, one a name.
    ElementMap<ustring, Node>& getByName() const;
    /// Whether the collection was made, as its getter does.
    bool hasByName() const { return m_byName.get(); }

    /// The container of `byName`.
    Node getScope() const;
    Node::Impl* getScopeImpl() const;
    /// Whether there is one and it is live.
    bool hasScope() const;
    void setScope(Node const& scope);

    /// Not contained, several a name.
    ElementMultimap<ustring, Node>& getGrouped() const;
    /// Whether the collection was made, as its getter does.
    bool hasGrouped() const { return m_grouped.get(); }

    /// The one of `grouped`.
    Node getGroup() const;
    /// Null if there is none; a proxy stays one.
    Node::Impl* getGroupImpl() const { return m_group.get(); }
    /// Whether there is one and it is live.
    bool hasGroup() const;
    void setGroup(Node const& group);

    /// One end of many to many, unordered.
    UnorderedElementSet<Node>& getMarks() const;
    /// Whether the collection was made, as its getter does.
    bool hasMarks() const { return m_marks.get(); }

    /// The other end.
    UnorderedElementSet<Node>& getMarkedBy() const;
    /// Whether the collection was made, as its getter does.
    bool hasMarkedBy() const { return m_markedBy.get(); }

    /// Numbers in order, with repetitions.
    PrimitiveSequence<int>& getNumbers() const;
    /// Whether the collection was made, as its getter does.
    bool hasNumbers() const { return m_numbers.get(); }

    /// Texts in order, each once.
    PrimitiveSequence<ustring>& getLabels() const;
    /// Whether the collection was made, as its getter does.
    bool hasLabels() const { return m_labels.get(); }

    /// Texts, each once.
    PrimitiveSet<ustring>& getWords() const;
    /// Whether the collection was made, as its getter does.
    bool hasWords() const { return m_words.get(); }

private:
    static std::unique_ptr<ElementSequence<Node>> makeOwned(Impl* owner);
    static std::unique_ptr<ElementSequence<Node>> makeLinks(Impl* owner);
    static std::unique_ptr<ElementSequence<Node>> makeBacklinks(Impl* owner);
    static std::unique_ptr<ElementSequence<Node>> makeChildren(Impl* owner);
    static std::unique_ptr<ElementSequence<Node>> makeParts(Impl* owner);
    static std::unique_ptr<ElementMap<ustring, Node>> makeByName(Impl* owner);
    static std::unique_ptr<ElementMultimap<ustring, Node>> makeGrouped(Impl* owner);
    static std::unique_ptr<UnorderedElementSet<Node>> makeMarks(Impl* owner);
    static std::unique_ptr<UnorderedElementSet<Node>> makeMarkedBy(Impl* owner);
    static std::unique_ptr<PrimitiveSequence<int>> makeNumbers(Impl* owner);
    static std::unique_ptr<PrimitiveSequence<ustring>> makeLabels(Impl* owner);
    static std::unique_ptr<PrimitiveSet<ustring>> makeWords(Impl* owner);

    ustring m_name;
    int m_count = 0;
    double m_weight = 0;
    bool m_isOpen = true;
    string m_tag;
    UUID m_token{};
    boost::optional<int> m_rank;
    boost::optional<ustring> m_note;
    mutable support::CountedPointer<Node::Impl> m_buddy;
    mutable support::CountedPointer<Node::Impl> m_left;
    mutable support::CountedPointer<Node::Impl> m_right;
    mutable support::LazyCollection<ElementSequence<Node>> m_owned;
    mutable support::CountedPointer<Node::Impl> m_owner;
    mutable support::LazyCollection<ElementSequence<Node>> m_links;
    mutable support::LazyCollection<ElementSequence<Node>> m_backlinks;
    mutable support::LazyCollection<ElementSequence<Node>> m_children;
    mutable support::LazyCollection<ElementSequence<Node>> m_parts;
    mutable support::CountedPointer<Node::Impl> m_core;
    mutable support::CountedPointer<Node::Impl> m_body;
    mutable support::LazyCollection<ElementMap<ustring, Node>> m_byName;
    mutable support::LazyCollection<ElementMultimap<ustring, Node>> m_grouped;
    mutable support::CountedPointer<Node::Impl> m_group;
    mutable support::LazyCollection<UnorderedElementSet<Node>> m_marks;
    mutable support::LazyCollection<UnorderedElementSet<Node>> m_markedBy;
    mutable support::LazyCollection<PrimitiveSequence<int>> m_numbers;
    mutable support::LazyCollection<PrimitiveSequence<ustring>> m_labels;
    mutable support::LazyCollection<PrimitiveSet<ustring>> m_words;

public:
    using Rows = support::RowList<
        support::Scalar<&Impl::m_name, NAME, &Impl::setName>,
        support::Scalar<&Impl::m_count, COUNT, &Impl::setCount>,
        support::Scalar<&Impl::m_weight, WEIGHT, &Impl::setWeight>,
        support::Scalar<&Impl::m_isOpen, IS_OPEN, &Impl::setIsOpen>,
        support::Scalar<&Impl::m_tag, TAG, &Impl::setTag>,
        support::Scalar<&Impl::m_token, TOKEN, &Impl::setToken>,
        support::Optional<&Impl::m_rank, RANK, &Impl::setRank>,
        support::Optional<&Impl::m_note, NOTE, &Impl::setNote>,
        support::Reference<Node, &Impl::m_buddy, BUDDY, &Impl::setBuddy>,
        support::Reference<Node, &Impl::m_left, LEFT, &Impl::setLeft>,
        support::Reference<Node, &Impl::m_right, RIGHT, &Impl::setRight>,
        support::References<&Impl::m_owned, OWNED, &Impl::makeOwned, &Impl::getOwned>,
        support::Reference<Node, &Impl::m_owner, OWNER, &Impl::setOwner>,
        support::References<&Impl::m_links, LINKS, &Impl::makeLinks, &Impl::getLinks>,
        support::References<&Impl::m_backlinks, BACKLINKS, &Impl::makeBacklinks,
                            &Impl::getBacklinks>,
        support::References<&Impl::m_children, CHILDREN, &Impl::makeChildren, &Impl::getChildren>,
        support::Container<Node, PARENT, &Impl::setParent>,
        support::References<&Impl::m_parts, PARTS, &Impl::makeParts, &Impl::getParts>,
        support::CompositeReference<Node, &Impl::m_core, CORE, &Impl::setCore>,
        support::CompositeReference<Node, &Impl::m_body, BODY, &Impl::setBody>,
        support::Container<Node, HOST, &Impl::setHost>,
        support::References<&Impl::m_byName, BY_NAME, &Impl::makeByName, &Impl::getByName>,
        support::Container<Node, SCOPE, &Impl::setScope>,
        support::References<&Impl::m_grouped, GROUPED, &Impl::makeGrouped, &Impl::getGrouped>,
        support::Reference<Node, &Impl::m_group, GROUP, &Impl::setGroup>,
        support::References<&Impl::m_marks, MARKS, &Impl::makeMarks, &Impl::getMarks>,
        support::References<&Impl::m_markedBy, MARKED_BY, &Impl::makeMarkedBy, &Impl::getMarkedBy>,
        support::Values<&Impl::m_numbers, NUMBERS, &Impl::makeNumbers, &Impl::getNumbers>,
        support::Values<&Impl::m_labels, LABELS, &Impl::makeLabels, &Impl::getLabels>,
        support::Values<&Impl::m_words, WORDS, &Impl::makeWords, &Impl::getWords>>;
};

inline Node::Node(Impl* impl) : ModelElement(impl) {}
inline Node::Impl* Node::getImpl() const
{
    return static_cast<Impl*>(m_impl);
}
inline Node::Impl* Node::operator->() const
{
    return static_cast<Impl*>(m_impl);
}
}  // namespace testkit

extern template class tarn::kiln::support::Record<testkit::Node::Impl,
                                                  tarn::kiln::ModelElement::Impl::Storage>;
extern template class tarn::kiln::support::Dispatched<testkit::Node::Impl,
                                                      tarn::kiln::ModelElement::Impl>;
