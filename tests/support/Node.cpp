#include "tests/support/NodeImpl.h"

#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/support/BuilderSteps.h"
#include "tarnkiln/support/DispatchSteps.h"
#include "tarnkiln/support/Handle.h"
#include "tarnkiln/support/Keyed.h"
#include "tests/support/NodeBuilder.h"
#include "tests/support/NodeMetamodel.h"

#include <atomic>

namespace testkit {

namespace {
std::atomic<long> nodesInMemory{0};
}

constinit Slot const Node::Impl::NAME{.index = 1, .property = propertyOf<1>};
constinit Slot const Node::Impl::COUNT{.index = 2, .property = propertyOf<2>};
constinit Slot const Node::Impl::WEIGHT{.index = 3, .property = propertyOf<3>};
constinit Slot const Node::Impl::IS_OPEN{.index = 4, .property = propertyOf<4>};
constinit Slot const Node::Impl::TAG{.index = 5, .property = propertyOf<5>};
constinit Slot const Node::Impl::TOKEN{.index = 6, .property = propertyOf<6>};
constinit Slot const Node::Impl::RANK{.index = 7, .property = propertyOf<7>};
constinit Slot const Node::Impl::NOTE{.index = 8, .property = propertyOf<8>};
constinit Slot const Node::Impl::BUDDY{.index = 9, .property = propertyOf<9>};
constinit Slot const Node::Impl::LEFT{
    .index = 10, .opposite = &Node::Impl::RIGHT, .property = propertyOf<10>};
constinit Slot const Node::Impl::RIGHT{
    .index = 11, .opposite = &Node::Impl::LEFT, .property = propertyOf<11>};
constinit Slot const Node::Impl::OWNED{
    .index = 12, .single = false, .opposite = &Node::Impl::OWNER, .property = propertyOf<12>};
constinit Slot const Node::Impl::OWNER{
    .index = 13, .opposite = &Node::Impl::OWNED, .property = propertyOf<13>};
constinit Slot const Node::Impl::LINKS{
    .index = 14, .single = false, .opposite = &Node::Impl::BACKLINKS, .property = propertyOf<14>};
constinit Slot const Node::Impl::BACKLINKS{
    .index = 15, .single = false, .opposite = &Node::Impl::LINKS, .property = propertyOf<15>};
constinit Slot const Node::Impl::CHILDREN{.index = 16,
                                          .composite = true,
                                          .single = false,
                                          .opposite = &Node::Impl::PARENT,
                                          .property = propertyOf<16>};
constinit Slot const Node::Impl::PARENT{
    .index = 17, .opposite = &Node::Impl::CHILDREN, .property = propertyOf<17>};
constinit Slot const Node::Impl::PARTS{
    .index = 18, .composite = true, .single = false, .property = propertyOf<18>};
constinit Slot const Node::Impl::CORE{.index = 19, .composite = true, .property = propertyOf<19>};
constinit Slot const Node::Impl::BODY{
    .index = 20, .composite = true, .opposite = &Node::Impl::HOST, .property = propertyOf<20>};
constinit Slot const Node::Impl::HOST{
    .index = 21, .opposite = &Node::Impl::BODY, .property = propertyOf<21>};
constinit Slot const Node::Impl::BY_NAME{.index = 22,
                                         .composite = true,
                                         .single = false,
                                         .keyed = true,
                                         .opposite = &Node::Impl::SCOPE,
                                         .property = propertyOf<22>};
constinit Slot const Node::Impl::SCOPE{
    .index = 23, .opposite = &Node::Impl::BY_NAME, .property = propertyOf<23>};
constinit Slot const Node::Impl::GROUPED{.index = 24,
                                         .single = false,
                                         .keyed = true,
                                         .opposite = &Node::Impl::GROUP,
                                         .property = propertyOf<24>};
constinit Slot const Node::Impl::GROUP{
    .index = 25, .opposite = &Node::Impl::GROUPED, .property = propertyOf<25>};
constinit Slot const Node::Impl::MARKS{
    .index = 26, .single = false, .opposite = &Node::Impl::MARKED_BY, .property = propertyOf<26>};
constinit Slot const Node::Impl::MARKED_BY{
    .index = 27, .single = false, .opposite = &Node::Impl::MARKS, .property = propertyOf<27>};
constinit Slot const Node::Impl::NUMBERS{.index = 28, .single = false, .property = propertyOf<28>};
constinit Slot const Node::Impl::LABELS{.index = 29, .single = false, .property = propertyOf<29>};
constinit Slot const Node::Impl::WORDS{.index = 30, .single = false, .property = propertyOf<30>};
Node Node::cast(ModelElement const& element)
{
    return support::cast<Node>(element);
}

meta::Class const& Node::metaClass()
{
    return NodeMetamodel::get().node;
}

Node Node::create(Model const& model, UUID const& id)
{
    return support::create<Node>(model, id);
}

Node Node::createProxy(Model const& model, ProxyId const& id)
{
    return cast(ModelElement::createProxy(model, metaClass(), id));
}

long Node::liveCount()
{
    return nodesInMemory;
}

Node::Impl::Impl(Model const& model, UUID const& id) : Dispatched(model, id)
{
    ++nodesInMemory;
}

Node::Impl::Impl(BuilderImpl& values, UUID const& id) : Dispatched(values.getBuilder(), id)
{
    values.construct(*this);
    ++nodesInMemory;
}

Node::Impl::~Impl()
{
    --nodesInMemory;
}

void Node::Impl::cascadeCreation(BuilderImpl& values)
{
    values.cascade(*this);
}

void Node::Impl::setName(ustring const& name)
{
    support::changeKey(
        *this, getName(), name, getScope(), SCOPE,
        [&] { support::requireFreeKey(getScope()->getByName(), name); },
        [&] {
            support::changeKey(
                *this, getName(), name, getGroup(), GROUP, [] {},
                [&] { support::setScalar(*this, m_name, NAME, name); });
        });
}

void Node::Impl::setCount(int count)
{
    support::setScalar(*this, m_count, COUNT, count);
}

void Node::Impl::setWeight(double weight)
{
    support::setScalar(*this, m_weight, WEIGHT, weight);
}

void Node::Impl::setIsOpen(bool open)
{
    support::setScalar(*this, m_isOpen, IS_OPEN, open);
}

void Node::Impl::setTag(string const& tag)
{
    support::setScalar(*this, m_tag, TAG, tag);
}

void Node::Impl::setToken(UUID const& token)
{
    support::setScalar(*this, m_token, TOKEN, token);
}

void Node::Impl::setRank(boost::optional<int> const& rank)
{
    support::setScalar(*this, m_rank, RANK, rank);
}

void Node::Impl::setNote(boost::optional<ustring> const& note)
{
    support::setScalar(*this, m_note, NOTE, note);
}

Node Node::Impl::getBuddy() const
{
    return Node(support::resolve(*this, m_buddy, BUDDY));
}

bool Node::Impl::hasBuddy() const
{
    return m_buddy && m_buddy.get()->isLive();
}

void Node::Impl::setBuddy(Node const& buddy)
{
    support::setReference(*this, m_buddy, BUDDY, buddy.getImpl());
}

Node Node::Impl::getLeft() const
{
    return Node(support::resolve(*this, m_left, LEFT));
}

bool Node::Impl::hasLeft() const
{
    return m_left && m_left.get()->isLive();
}

void Node::Impl::setLeft(Node const& left)
{
    support::setReference(*this, m_left, LEFT, left.getImpl());
}

Node Node::Impl::getRight() const
{
    return Node(support::resolve(*this, m_right, RIGHT));
}

bool Node::Impl::hasRight() const
{
    return m_right && m_right.get()->isLive();
}

void Node::Impl::setRight(Node const& right)
{
    support::setReference(*this, m_right, RIGHT, right.getImpl());
}

std::unique_ptr<ElementSequence<Node>> Node::Impl::makeOwned(Impl* owner)
{
    return std::make_unique<ElementSequence<Node>>(owner, true, OWNED);
}

ElementSequence<Node>& Node::Impl::getOwned() const
{
    return support::shownCollection(*this, m_owned, &Impl::makeOwned);
}

Node Node::Impl::getOwner() const
{
    return Node(support::resolve(*this, m_owner, OWNER));
}

bool Node::Impl::hasOwner() const
{
    return m_owner && m_owner.get()->isLive();
}

void Node::Impl::setOwner(Node const& owner)
{
    support::setReference(*this, m_owner, OWNER, owner.getImpl());
}

std::unique_ptr<ElementSequence<Node>> Node::Impl::makeLinks(Impl* owner)
{
    return std::make_unique<ElementSequence<Node>>(owner, true, LINKS);
}

ElementSequence<Node>& Node::Impl::getLinks() const
{
    return support::shownCollection(*this, m_links, &Impl::makeLinks);
}

std::unique_ptr<ElementSequence<Node>> Node::Impl::makeBacklinks(Impl* owner)
{
    return std::make_unique<ElementSequence<Node>>(owner, true, BACKLINKS);
}

ElementSequence<Node>& Node::Impl::getBacklinks() const
{
    return support::shownCollection(*this, m_backlinks, &Impl::makeBacklinks);
}

std::unique_ptr<ElementSequence<Node>> Node::Impl::makeChildren(Impl* owner)
{
    return std::make_unique<ElementSequence<Node>>(owner, true, CHILDREN);
}

ElementSequence<Node>& Node::Impl::getChildren() const
{
    return support::shownCollection(*this, m_children, &Impl::makeChildren);
}

Node Node::Impl::getParent() const
{
    return Node(getParentImpl());
}

Node::Impl* Node::Impl::getParentImpl() const
{
    return support::containerOf<Node::Impl>(*this, PARENT);
}

bool Node::Impl::hasParent() const
{
    return getParentImpl() && getParentImpl()->isLive();
}

void Node::Impl::setParent(Node const& parent)
{
    support::setContainer(*this, PARENT, parent.getImpl());
}

std::unique_ptr<ElementSequence<Node>> Node::Impl::makeParts(Impl* owner)
{
    return std::make_unique<ElementSequence<Node>>(owner, false, PARTS);
}

ElementSequence<Node>& Node::Impl::getParts() const
{
    return support::shownCollection(*this, m_parts, &Impl::makeParts);
}

Node Node::Impl::getCore() const
{
    return Node(support::resolve(*this, m_core, CORE));
}

bool Node::Impl::hasCore() const
{
    return m_core && m_core.get()->isLive();
}

void Node::Impl::setCore(Node const& core)
{
    support::setReference(*this, m_core, CORE, core.getImpl());
}

Node Node::Impl::getBody() const
{
    return Node(support::resolve(*this, m_body, BODY));
}

bool Node::Impl::hasBody() const
{
    return m_body && m_body.get()->isLive();
}

void Node::Impl::setBody(Node const& body)
{
    support::setReference(*this, m_body, BODY, body.getImpl());
}

Node Node::Impl::getHost() const
{
    return Node(getHostImpl());
}

Node::Impl* Node::Impl::getHostImpl() const
{
    return support::containerOf<Node::Impl>(*this, HOST);
}

bool Node::Impl::hasHost() const
{
    return getHostImpl() && getHostImpl()->isLive();
}

void Node::Impl::setHost(Node const& host)
{
    support::setContainer(*this, HOST, host.getImpl());
}

std::unique_ptr<ElementMap<ustring, Node>> Node::Impl::makeByName(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Node::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMap<ustring, Node>>(owner, keyOf, BY_NAME);
}

ElementMap<ustring, Node>& Node::Impl::getByName() const
{
    return support::shownCollection(*this, m_byName, &Impl::makeByName);
}

Node Node::Impl::getScope() const
{
    return Node(getScopeImpl());
}

Node::Impl* Node::Impl::getScopeImpl() const
{
    return support::containerOf<Node::Impl>(*this, SCOPE);
}

bool Node::Impl::hasScope() const
{
    return getScopeImpl() && getScopeImpl()->isLive();
}

void Node::Impl::setScope(Node const& scope)
{
    support::setContainer(*this, SCOPE, scope.getImpl(),
                          [&] { support::requireFreeKey(scope->getByName(), getName()); });
}

std::unique_ptr<ElementMultimap<ustring, Node>> Node::Impl::makeGrouped(Impl* owner)
{
    auto const keyOf = [](ModelElement::Impl* member) {
        return static_cast<Node::Impl*>(member)->getName();
    };
    return std::make_unique<ElementMultimap<ustring, Node>>(owner, keyOf, GROUPED);
}

ElementMultimap<ustring, Node>& Node::Impl::getGrouped() const
{
    return support::shownCollection(*this, m_grouped, &Impl::makeGrouped);
}

Node Node::Impl::getGroup() const
{
    return Node(support::resolve(*this, m_group, GROUP));
}

bool Node::Impl::hasGroup() const
{
    return m_group && m_group.get()->isLive();
}

void Node::Impl::setGroup(Node const& group)
{
    support::setReference(*this, m_group, GROUP, group.getImpl());
}

std::unique_ptr<UnorderedElementSet<Node>> Node::Impl::makeMarks(Impl* owner)
{
    return std::make_unique<UnorderedElementSet<Node>>(owner, MARKS);
}

UnorderedElementSet<Node>& Node::Impl::getMarks() const
{
    return support::shownCollection(*this, m_marks, &Impl::makeMarks);
}

std::unique_ptr<UnorderedElementSet<Node>> Node::Impl::makeMarkedBy(Impl* owner)
{
    return std::make_unique<UnorderedElementSet<Node>>(owner, MARKED_BY);
}

UnorderedElementSet<Node>& Node::Impl::getMarkedBy() const
{
    return support::shownCollection(*this, m_markedBy, &Impl::makeMarkedBy);
}

std::unique_ptr<PrimitiveSequence<int>> Node::Impl::makeNumbers(Impl* owner)
{
    return std::make_unique<PrimitiveSequence<int>>(owner, false, NUMBERS);
}

PrimitiveSequence<int>& Node::Impl::getNumbers() const
{
    return support::shownCollection(*this, m_numbers, &Impl::makeNumbers);
}

std::unique_ptr<PrimitiveSequence<ustring>> Node::Impl::makeLabels(Impl* owner)
{
    return std::make_unique<PrimitiveSequence<ustring>>(owner, true, LABELS);
}

PrimitiveSequence<ustring>& Node::Impl::getLabels() const
{
    return support::shownCollection(*this, m_labels, &Impl::makeLabels);
}

std::unique_ptr<PrimitiveSet<ustring>> Node::Impl::makeWords(Impl* owner)
{
    return std::make_unique<PrimitiveSet<ustring>>(owner, WORDS);
}

PrimitiveSet<ustring>& Node::Impl::getWords() const
{
    return support::shownCollection(*this, m_words, &Impl::makeWords);
}

Node::Builder::Builder() = default;

Node::Builder::Builder(Model const& model) : BuilderBase(model) {}

Node::Builder::~Builder() = default;
}  // namespace testkit

template class tarn::kiln::support::Record<testkit::Node::Impl,
                                           tarn::kiln::ModelElement::Impl::Storage>;
template class tarn::kiln::support::Dispatched<testkit::Node::Impl, tarn::kiln::ModelElement::Impl>;
template class tarn::kiln::support::BuilderValues<testkit::Node::Impl,
                                                  tarn::kiln::support::BuilderRoot>;
template class tarn::kiln::support::BuilderTop<testkit::Node::Builder>;
