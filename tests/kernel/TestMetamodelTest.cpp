// What each shape of property does in the element class that other tests are written on.
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/SpecialNodeImpl.h"

#include <boost/optional/optional_io.hpp>
#include <gmock/gmock.h>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

class NodeShapes : public ::testing::Test
{
protected:
    Node make(ustring const& name = {})
    {
        Node const node = Node::create(m_model);
        node->setName(name);
        return node;
    }

    static std::vector<Node> nodes(ReferenceCollection const& collection)
    {
        std::vector<Node> result;
        for (ModelElement const& element : collection.getAllValues())
            result.push_back(Node::cast(element));
        return result;
    }

    void expectConsistent() { EXPECT_THAT(m_model->checkInvariants(), IsEmpty()); }

    Model m_model = Model::create(ModelConstellation());
};

TEST_F(NodeShapes, StartWithTheirInitialValues)
{
    Node const node = Node::create(m_model);

    EXPECT_EQ(node->getName(), u"");
    EXPECT_EQ(node->getCount(), 0);
    EXPECT_EQ(node->getWeight(), 0.0);
    EXPECT_TRUE(node->isOpen());
    EXPECT_EQ(node->getRank(), boost::none);
    EXPECT_FALSE(node->hasBuddy());
    EXPECT_FALSE(node->getParent());
    EXPECT_FALSE(node->hasChildren());
    EXPECT_EQ(node->getChildren().size(), 0u);
    EXPECT_TRUE(node->isTopLevel());
}

TEST_F(NodeShapes, KeepPlainValues)
{
    Node const node = make(u"a");
    UUID const token = ElementImpl::generateNewUuid();

    node->setCount(-7);
    node->setWeight(1.5);
    node->setIsOpen(false);
    node->setTag("red");
    node->setToken(token);
    node->setRank(3);
    node->setNote(ustring(u"seen"));

    EXPECT_EQ(node->getName(), u"a");
    EXPECT_EQ(node->getCount(), -7);
    EXPECT_EQ(node->getWeight(), 1.5);
    EXPECT_FALSE(node->isOpen());
    EXPECT_EQ(node->getTag(), "red");
    EXPECT_EQ(node->getToken(), token);
    EXPECT_EQ(node->getRank(), boost::optional<int>(3));
    EXPECT_EQ(node->getNote().value(), u"seen");

    node->setRank(boost::none);
    EXPECT_EQ(node->getRank(), boost::none);
}

TEST_F(NodeShapes, KeepAReferenceWithoutAnOppositeAfterItsTargetDied)
{
    Node const node = make();
    Node const buddy = make();
    node->setBuddy(buddy);

    buddy->destroy();

    EXPECT_EQ(node->getBuddyImpl(), buddy.getImpl());
    EXPECT_FALSE(node->hasBuddy());
}

TEST_F(NodeShapes, LeaveTheFormerPartnersOfAnAssociationOfOneToOne)
{
    Node const a = make();
    Node const b = make();
    Node const c = make();
    Node const d = make();
    a->setLeft(b);
    d->setLeft(c);

    a->setLeft(c);

    EXPECT_EQ(a->getLeft(), c);
    EXPECT_EQ(c->getRight(), a);
    EXPECT_FALSE(b->getRight());
    EXPECT_FALSE(d->getLeft());
    expectConsistent();
}

TEST_F(NodeShapes, MoveAMemberOfOneToManyFromEitherEnd)
{
    Node const p1 = make();
    Node const p2 = make();
    Node const x = make();
    p1->getOwned().push_back(x);

    p2->getOwned().push_back(x);

    EXPECT_EQ(x->getOwner(), p2);
    EXPECT_THAT(nodes(p1->getOwned()), IsEmpty());

    x->setOwner(p1);

    EXPECT_THAT(nodes(p1->getOwned()), ElementsAre(x));
    EXPECT_THAT(nodes(p2->getOwned()), IsEmpty());
    EXPECT_TRUE(x->isTopLevel());
    expectConsistent();
}

TEST_F(NodeShapes, KeepBothEndsOfManyToManyInStep)
{
    Node const a = make();
    Node const b = make();
    Node const c = make();

    a->getLinks().push_back(b);
    c->getBacklinks().push_back(a);
    a->getMarks().insert(b);

    EXPECT_THAT(nodes(a->getLinks()), ElementsAre(b, c));
    EXPECT_THAT(nodes(b->getBacklinks()), ElementsAre(a));
    EXPECT_THAT(nodes(b->getMarkedBy()), UnorderedElementsAre(a));

    b->destroy();

    EXPECT_THAT(nodes(a->getLinks()), ElementsAre(c));
    EXPECT_THAT(nodes(a->getMarks()), IsEmpty());
    expectConsistent();
}

TEST_F(NodeShapes, MoveAChildFromEitherEnd)
{
    Node const p1 = make();
    Node const p2 = make();
    Node const x = make();
    p1->getChildren().push_back(x);
    EXPECT_FALSE(x->isTopLevel());
    EXPECT_EQ(x->getParent(), p1);

    x->setParent(p2);

    EXPECT_THAT(nodes(p1->getChildren()), IsEmpty());
    EXPECT_THAT(nodes(p2->getChildren()), ElementsAre(x));
    expectConsistent();

    p1->getChildren().push_back(x);

    EXPECT_EQ(x->getParent(), p1);
    EXPECT_THAT(nodes(p2->getChildren()), IsEmpty());

    x->setParent(Node());

    EXPECT_TRUE(x->isTopLevel());
    EXPECT_THAT(nodes(p1->getChildren()), IsEmpty());
    expectConsistent();
}

TEST_F(NodeShapes, RefuseToContainThemselves)
{
    Node const top = make();
    Node const middle = make();
    middle->setParent(top);

    EXPECT_RAISES(messages::CircularContainment, top->setParent(middle));
    EXPECT_RAISES(messages::CircularContainment, middle->getChildren().push_back(top));
    EXPECT_RAISES(messages::CircularContainment, middle->setCore(top));

    EXPECT_TRUE(top->isTopLevel());
    expectConsistent();
}

TEST_F(NodeShapes, RefuseAContainerInAnotherModel)
{
    Node const x = make();
    Node const elsewhere = Node::create(Model::create(ModelConstellation()));

    EXPECT_RAISES(messages::CannotChangeModel, x->setParent(elsewhere));

    EXPECT_TRUE(x->isTopLevel());
}

TEST_F(NodeShapes, HoldPartsThatDoNotKnowTheirContainer)
{
    Node const p1 = make();
    Node const p2 = make();
    Node const x = make();
    p1->getParts().push_back(x);
    EXPECT_EQ(x->container(), p1);

    p2->getParts().push_back(x);

    EXPECT_EQ(x->container(), p2);
    EXPECT_THAT(nodes(p1->getParts()), IsEmpty());

    p2->getParts().remove(x);

    EXPECT_TRUE(x->isTopLevel());
    expectConsistent();
}

TEST_F(NodeShapes, ReleaseTheFormerTargetOfASingleComposite)
{
    Node const p = make();
    Node const first = make();
    Node const second = make();
    p->setCore(first);

    p->setCore(second);

    EXPECT_TRUE(first->isTopLevel());
    EXPECT_EQ(second->container(), p);
    expectConsistent();

    Node const other = make();
    other->setCore(second);

    EXPECT_FALSE(p->getCore());
    EXPECT_EQ(second->container(), other);
    expectConsistent();
}

TEST_F(NodeShapes, KeepASingleCompositeAndItsOppositeInStep)
{
    Node const p = make();
    Node const q = make();
    Node const first = make();
    Node const second = make();
    p->setBody(first);
    EXPECT_EQ(first->getHost(), p);

    second->setHost(p);

    EXPECT_EQ(p->getBody(), second);
    EXPECT_TRUE(first->isTopLevel());
    expectConsistent();

    q->setBody(second);

    EXPECT_FALSE(p->getBody());
    EXPECT_EQ(second->getHost(), q);
    expectConsistent();
}

TEST_F(NodeShapes, KeepAMapByNameWhenAMemberIsRenamed)
{
    Node const scope = make();
    Node const a = make(u"a");
    Node const b = make(u"b");
    a->setScope(scope);
    scope->getByName().insert(b);

    a->setName(u"c");

    EXPECT_FALSE(scope->getByName().find(u"a"));
    EXPECT_EQ(scope->getByName().find(u"c"), a);
    EXPECT_EQ(a->getScope(), scope);
    EXPECT_RAISES(messages::UniquenessConstraint, a->setName(u"b"));
    EXPECT_RAISES(messages::UniquenessConstraint, make(u"b")->setScope(scope));
    EXPECT_EQ(a->getName(), u"c");
    expectConsistent();
}

TEST_F(NodeShapes, KeepAMultimapWithSeveralMembersOfAName)
{
    Node const group = make();
    Node const a = make(u"a");
    Node const b = make(u"b");
    a->setGroup(group);
    b->setGroup(group);

    b->setName(u"a");

    EXPECT_THAT(group->getGrouped().find(u"a"), ElementsAre(a, b));
    EXPECT_THAT(group->getGrouped().find(u"b"), IsEmpty());
    expectConsistent();
}

TEST_F(NodeShapes, KeepManyPlainValues)
{
    Node const node = make();

    node->getNumbers().push_back(2);
    node->getNumbers().push_back(2);
    node->getLabels().push_back(u"x");
    node->getLabels().push_back(u"x");
    node->getWords().genericAdd(Value(meta::StandardTypes::stringMeta, ustring(u"w")));

    EXPECT_EQ(node->getNumbers().size(), 2u);
    EXPECT_EQ(node->getLabels().size(), 1u);
    EXPECT_EQ(node->getWords().size(), 1u);
}

TEST_F(NodeShapes, BelongToASubclassToo)
{
    SpecialNode const special = SpecialNode::create(m_model);
    special->setName(u"s");
    special->setLevel(4);
    special->setMentor(special);
    Node const node = special;

    EXPECT_EQ(node->getName(), u"s");
    EXPECT_EQ(SpecialNode::cast(node), special);
    EXPECT_FALSE(SpecialNode::cast(make()));
    EXPECT_TRUE(special->getMetaClass()->isA(Node::metaClass()));
    EXPECT_FALSE(Node::metaClass()->isA(SpecialNode::metaClass()));
}

TEST_F(NodeShapes, AllComeBackWithARollback)
{
    Node const p = make(u"p");
    Node const x = make(u"x");
    Node const y = make(u"y");
    x->setCount(1);
    x->setRank(1);
    x->setBuddy(p);
    x->setLeft(y);
    x->setOwner(p);
    p->getLinks().push_back(x);
    x->setParent(p);
    p->setCore(y);
    p->getMarks().insert(x);
    x->setGroup(p);
    p->getNumbers().push_back(1);

    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    x->setCount(2);
    x->setRank(boost::none);
    x->setBuddy(Node());
    x->setLeft(Node());
    x->setOwner(Node());
    p->getLinks().clear();
    x->setName(u"z");
    x->setScope(p);
    p->setCore(Node());
    p->getMarks().clear();
    p->getNumbers().clear();
    p->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(p);
    EXPECT_EQ(x->getCount(), 1);
    EXPECT_EQ(x->getRank(), boost::optional<int>(1));
    EXPECT_EQ(x->getBuddy(), p);
    EXPECT_EQ(x->getLeft(), y);
    EXPECT_EQ(y->getRight(), x);
    EXPECT_EQ(x->getOwner(), p);
    EXPECT_THAT(nodes(p->getOwned()), ElementsAre(x));
    EXPECT_THAT(nodes(x->getBacklinks()), ElementsAre(p));
    EXPECT_EQ(x->getParent(), p);
    EXPECT_THAT(nodes(p->getChildren()), ElementsAre(x));
    EXPECT_EQ(p->getCore(), y);
    EXPECT_EQ(y->container(), p);
    EXPECT_THAT(nodes(x->getMarkedBy()), ElementsAre(p));
    EXPECT_EQ(x->getName(), u"x");
    EXPECT_THAT(p->getGrouped().find(u"x"), ElementsAre(x));
    EXPECT_THAT(nodes(p->getByName()), IsEmpty());
    EXPECT_EQ(p->getNumbers().size(), 1u);
    expectConsistent();
}

TEST_F(NodeShapes, AreReadAndSetByReflection)
{
    auto const& tag = ModelElement::Impl::PUBLIC_ACCESS;
    auto const& properties = NodeMetamodel::get().properties;
    Node const node = make();
    Node const buddy = make();
    meta::Property const count = properties[Node::Impl::COUNT.index];
    meta::Property const rank = properties[Node::Impl::RANK.index];
    meta::Property const toBuddy = properties[Node::Impl::BUDDY.index];
    meta::Property const children = properties[Node::Impl::CHILDREN.index];

    node->setPropertyValue(count, Value(meta::StandardTypes::integerMeta, 5), tag);
    node->setPropertyValue(rank, Value::createPrimitiveValue(rank, boost::optional<int>(2)), tag);
    node->setPropertyValue(toBuddy, Value::createElementValue(toBuddy, buddy), tag);
    node->getChildren().push_back(make());

    EXPECT_EQ(node->getCount(), 5);
    EXPECT_EQ(node->getPropertyValue(count, tag).getValue<int>(), 5);
    EXPECT_EQ(node->getPropertyValue(rank, tag).getValue<boost::optional<int>>(), 2);
    EXPECT_EQ(node->getPropertyValue(toBuddy, tag).getValue<Node>(), buddy);
    EXPECT_EQ(&node->getPropertyValue(children, tag).getValue<ReferenceCollection&>(),
              &node->getChildren());
    EXPECT_TRUE(node->hasPropertyValue(children, tag));
    EXPECT_FALSE(buddy->hasPropertyValue(toBuddy, tag));
    EXPECT_EQ(node->getPropertyByIndex(Node::Impl::COUNT.index), count);
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       node->getPropertyValue(properties[SpecialNode::Impl::LEVEL.index], tag),
                       u"level", u"testkit.Node");
}

TEST_F(NodeShapes, LeaveNothingInMemory)
{
    long const before = Node::liveCount();
    {
        Model const model = Model::create(ModelConstellation());
        Node const a = Node::create(model);
        Node const b = Node::create(model);
        a->setBuddy(b);
        b->setBuddy(a);
        b->setParent(a);
        a->getLinks().push_back(b);
        a->getMarks().insert(a);
        EXPECT_EQ(Node::liveCount(), before + 2);
    }

    EXPECT_EQ(Node::liveCount(), before);
}
}  // namespace testkit
