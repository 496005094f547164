// How a rollback brings elements back, and back to where they were.
#include "tests/kernel/TransactionRollbackFixture.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeImpl.h"

#include <boost/optional/optional_io.hpp>

namespace {

using namespace testkit;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

// ---------------------------------------------------------------------------- destruction

TEST_F(TransactionRollback, BringsBackElementsDestroyedInIt)
{
    Node const node = make(u"n");
    node->setCount(4);
    UUID const id = node->getUuid();
    Node::Impl* const impl = node.getImpl();
    Transaction const transaction = begin();
    node->destroy();
    EXPECT_FALSE(node);

    rollBack(transaction);

    EXPECT_TRUE(node);
    EXPECT_EQ(id, node->getUuid());
    EXPECT_EQ(impl, model->findElement(id).getImpl());
    EXPECT_EQ(4, node->getCount());
    EXPECT_TRUE(isAtTop(node));
}

TEST_F(TransactionRollback, BringsBackElementsThatNobodyHeld)
{
    UUID const id = make(u"n")->getUuid();
    Transaction const transaction = begin();
    model->findElement(id)->destroy();
    EXPECT_FALSE(model->findElement(id));

    rollBack(transaction);

    Node const back = Node::cast(model->findElement(id));
    ASSERT_TRUE(back);
    EXPECT_EQ(u"n", back->getName());
}

TEST_F(TransactionRollback, BringsBackAWholeSubtree)
{
    Node const root = make(u"root"), child = make(u"child"), part = make(u"part"),
               core = make(u"core"), body = make(u"body"), named = make(u"named"),
               above = make(u"above");
    above->getChildren().push_back(root);
    root->getChildren().push_back(child);
    child->getParts().push_back(part);
    root->setCore(core);
    core->setBody(body);
    root->getByName().insert(named);
    Transaction const transaction = begin();
    root->destroy();
    for (Node const& each : {root, child, part, core, body, named})
        EXPECT_FALSE(each);

    rollBack(transaction);

    for (Node const& each : {root, child, part, core, body, named})
    {
        EXPECT_TRUE(each);
        EXPECT_EQ(each, Node::cast(model->findElement(each->getUuid())));
        EXPECT_FALSE(isAtTop(each));
    }
    EXPECT_EQ(above, root->getParent());
    EXPECT_THAT(membersOf(above->getChildren()), ElementsAre(root));
    EXPECT_THAT(membersOf(root->getChildren()), ElementsAre(child));
    EXPECT_THAT(membersOf(child->getParts()), ElementsAre(part));
    EXPECT_EQ(core, root->getCore());
    EXPECT_EQ(body, core->getBody());
    EXPECT_EQ(named, root->getByName().find(u"named"));
}

TEST_F(TransactionRollback, BringsBackReferencesToAndFromDestroyedElements)
{
    Node const node = make(), partner = make(), owner = make(), linked = make(), marked = make(),
               looking = make(), group = make();
    node->setLeft(partner);
    node->setOwner(owner);
    node->getLinks().push_back(linked);
    linked->getLinks().push_back(node);
    node->getMarks().insert(marked);
    looking->setBuddy(node);
    node->setBuddy(partner);
    node->setGroup(group);
    Transaction const transaction = begin();
    node->destroy();
    EXPECT_FALSE(partner->getRight());
    EXPECT_EQ(node.getImpl(), looking->getBuddyImpl()) << "a one-sided reference stays, dead";

    rollBack(transaction);

    EXPECT_EQ(partner, node->getLeft());
    EXPECT_EQ(node, partner->getRight());
    EXPECT_THAT(membersOf(owner->getOwned()), ElementsAre(node));
    EXPECT_EQ(owner, node->getOwner());
    EXPECT_THAT(membersOf(linked->getBacklinks()), ElementsAre(node));
    EXPECT_THAT(membersOf(node->getBacklinks()), ElementsAre(linked));
    EXPECT_THAT(membersOf(marked->getMarkedBy()), ElementsAre(node));
    EXPECT_EQ(node, looking->getBuddy());
    EXPECT_EQ(partner, node->getBuddy());
    EXPECT_THAT(membersOf(group->getGrouped()), ElementsAre(node));
}

TEST_F(TransactionRollback, BringsBackASingleContainedElementThatWasDestroyed)
{
    Node const owner = make(), core = make(), body = make();
    owner->setCore(core);
    owner->setBody(body);
    Transaction const transaction = begin();
    core->destroy();
    body->destroy();
    EXPECT_FALSE(owner->hasCore());

    rollBack(transaction);

    EXPECT_EQ(core, owner->getCore());
    EXPECT_EQ(body, owner->getBody());
    EXPECT_EQ(owner, body->getHost());
}

TEST_F(TransactionRollback, BringsBackAllContents)
{
    Node const top = make(), parent = make(), child = make();
    parent->getChildren().push_back(child);
    Transaction const transaction = begin();
    model->destroyAllContents();
    EXPECT_EQ(0u, model->getElementCount());

    rollBack(transaction);

    EXPECT_EQ(3u, model->getElementCount());
    EXPECT_THAT(model->getTopLevelElements(), UnorderedElementsAre(top, parent));
    EXPECT_EQ(parent, child->getParent());
}

TEST_F(TransactionRollback, BringsBackAnElementThatWasChangedAndThenDestroyed)
{
    Node const node = make(), other = make();
    node->setCount(1);
    node->getLinks().push_back(other);
    Transaction const transaction = begin();
    node->setCount(2);
    node->getLinks().clear();
    node->destroy();

    rollBack(transaction);

    EXPECT_EQ(1, node->getCount());
    EXPECT_THAT(membersOf(node->getLinks()), ElementsAre(other));
}

TEST_F(TransactionRollback, IgnoresWhatWasWrittenToADeadElement)
{
    Node const node = make(), other = make();
    node->setCount(1);
    Transaction const transaction = begin();
    node->destroy();
    node->setCount(9);
    node->setBuddy(other);
    node->setParent(other);
    node->getNumbers().push_back(9);
    node->getLinks().push_back(other);
    node->getChildren().push_back(other);

    rollBack(transaction);

    EXPECT_EQ(1, node->getCount());
    EXPECT_FALSE(node->hasBuddy());
    EXPECT_TRUE(isAtTop(node));
    EXPECT_TRUE(isAtTop(other));
    EXPECT_EQ(0u, node->getNumbers().size());
    EXPECT_THAT(membersOf(node->getLinks()), IsEmpty());
}

TEST_F(TransactionRollback, BringsBackStandInsThatDiedWithTheirContainer)
{
    Node const container = make(u"container");
    Node const child = Node::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"child"));
    Node const core = Node::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"core"));
    container->getChildren().push_back(child);
    container->setCore(core);

    Transaction const transaction = begin();
    container->destroy();
    EXPECT_FALSE(child);
    EXPECT_FALSE(core);
    rollBack(transaction);

    EXPECT_TRUE(child);
    EXPECT_TRUE(core);
    EXPECT_TRUE(child->isProxy());
    EXPECT_THAT(container->getChildren().getAllValuesAndProxies(), ElementsAre(child));
    EXPECT_EQ(container->getCoreImpl(), core.getImpl());
}

TEST_F(TransactionRollback, BringsBackAStandInThatWasDestroyedAlone)
{
    Node const node = make(u"a");
    Node const proxy = Node::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"child"));
    node->setBuddy(proxy);

    Transaction const transaction = begin();
    proxy->destroy();
    node->setName(u"b");
    rollBack(transaction);

    EXPECT_TRUE(proxy);
    EXPECT_EQ(node->getBuddyImpl(), proxy.getImpl());
}

// ---------------------------------------------------------------------------- containers

TEST_F(TransactionRollback, RestoresTheContainerOfAnElementThatMoved)
{
    Node const p1 = make(), p2 = make(), child = make(), part = make(), core = make();
    p1->getChildren().push_back(child);
    p1->getParts().push_back(part);
    p1->setCore(core);
    Transaction const transaction = begin();
    p2->getChildren().push_back(child);
    p2->getParts().push_back(part);
    p2->setCore(core);

    rollBack(transaction);

    for (Node const& each : {child, part, core})
    {
        EXPECT_EQ(p1, Node::cast(each->container()));
        EXPECT_FALSE(isAtTop(each));
    }
    EXPECT_THAT(membersOf(p1->getChildren()), ElementsAre(child));
    EXPECT_THAT(membersOf(p1->getParts()), ElementsAre(part));
    EXPECT_EQ(core, p1->getCore());
    EXPECT_FALSE(p2->hasCore());
}

TEST_F(TransactionRollback, RestoresTheTopLevelOfAnElementThatWasContained)
{
    Node const parent = make(), child = make();
    Transaction const transaction = begin();
    parent->getChildren().push_back(child);
    EXPECT_FALSE(isAtTop(child));

    rollBack(transaction);

    EXPECT_TRUE(isAtTop(child));
    EXPECT_FALSE(child->getParent());
}

TEST_F(TransactionRollback, RestoresTheContainerOfAnElementThatWasReleased)
{
    Node const parent = make(), child = make(), part = make();
    parent->getChildren().push_back(child);
    parent->getParts().push_back(part);
    Transaction const transaction = begin();
    child->setParent(Node());
    parent->getParts().clear();
    EXPECT_TRUE(isAtTop(child));
    EXPECT_TRUE(isAtTop(part));

    rollBack(transaction);

    EXPECT_FALSE(isAtTop(child));
    EXPECT_FALSE(isAtTop(part));
    EXPECT_EQ(parent, child->getParent());
    EXPECT_THAT(membersOf(parent->getParts()), ElementsAre(part));
}

TEST_F(TransactionRollback, RestoresTheFirstOfSeveralContainers)
{
    Node const p1 = make(), p2 = make(), p3 = make(), child = make();
    p1->getChildren().push_back(child);
    Transaction const transaction = begin();
    child->setParent(p2);
    child->setParent(p3);
    child->setParent(Node());
    p2->setBody(child);

    rollBack(transaction);

    EXPECT_EQ(p1, child->getParent());
    EXPECT_FALSE(p2->hasBody());
}

TEST_F(TransactionRollback, BringsBackToTheTopWhatWasContainedAndDestroyedSince)
{
    Node const parent = make(), child = make();
    Transaction const transaction = begin();
    parent->getChildren().push_back(child);
    child->destroy();

    rollBack(transaction);

    EXPECT_TRUE(child);
    EXPECT_TRUE(isAtTop(child));
    EXPECT_THAT(membersOf(parent->getChildren()), IsEmpty());
}

TEST_F(TransactionRollback, BringsBackToItsContainerWhatWasReleasedAndDestroyedSince)
{
    Node const parent = make(), child = make();
    parent->getChildren().push_back(child);
    Transaction const transaction = begin();
    child->setParent(Node());
    child->destroy();

    rollBack(transaction);

    EXPECT_TRUE(child);
    EXPECT_FALSE(isAtTop(child));
    EXPECT_EQ(parent, child->getParent());
    EXPECT_THAT(membersOf(parent->getChildren()), ElementsAre(child));
}

TEST_F(TransactionRollback, BringsBackAContainerAndWhatMovedOutOfIt)
{
    Node const parent = make(), child = make(), other = make();
    parent->getChildren().push_back(child);
    Transaction const transaction = begin();
    other->getChildren().push_back(child);
    parent->destroy();
    EXPECT_TRUE(child);

    rollBack(transaction);

    EXPECT_EQ(parent, child->getParent());
    EXPECT_THAT(membersOf(other->getChildren()), IsEmpty());
}

TEST_F(TransactionRollback, TurnsAnInvertedTreeAroundAgain)
{
    Node const a = make(), b = make(), c = make();
    a->getChildren().push_back(b);
    b->getChildren().push_back(c);
    Transaction const transaction = begin();
    b->setParent(Node());
    c->setParent(Node());
    c->getChildren().push_back(b);
    b->getChildren().push_back(a);

    rollBack(transaction);

    EXPECT_TRUE(isAtTop(a));
    EXPECT_EQ(a, b->getParent());
    EXPECT_EQ(b, c->getParent());
}

TEST_F(TransactionRollback, KeepsManyElementsAliveThatChangedHandsWhateverTheOrder)
{
    // Without pins, the restoration of one collection could drop the last handle of an element
    // that another one is about to take back.
    std::vector<UUID> ids;
    for (int i = 0; i < 40; ++i)
        ids.push_back(make()->getUuid());
    auto const at = [&](std::size_t i) { return Node::cast(model->findElement(ids[i])); };
    for (std::size_t i = 1; i < 20; ++i)
        at(0)->getChildren().push_back(at(i));
    long const before = Node::liveCount();
    {
        Transaction const transaction = begin();
        for (std::size_t i = 1; i < 20; ++i)
            at(20 + i)->setBody(at(i));
        for (std::size_t i = 21; i < 40; ++i)
            at(0)->getParts().push_back(at(i));
        at(0)->destroy();
        EXPECT_EQ(1u, model->getElementCount());
        rollBack(transaction);
    }
    EXPECT_EQ(before, Node::liveCount());
    EXPECT_EQ(40u, model->getElementCount());
    EXPECT_EQ(19u, at(0)->getChildren().size());
}

TEST_F(TransactionRollback, OfTheLastPropertyLeavesTheContainerAlone)
{
    SpecialNode const special = SpecialNode::create(model);
    SpecialNode const mentor = SpecialNode::create(model);
    Node const parent = make();
    parent->getChildren().push_back(special);
    Transaction const transaction = begin();
    special->setMentor(mentor);
    special->setLevel(3);

    rollBack(transaction);

    EXPECT_FALSE(special->hasMentor());
    EXPECT_EQ(0, special->getLevel());
    EXPECT_EQ(parent, special->getParent());
}
}  // namespace
