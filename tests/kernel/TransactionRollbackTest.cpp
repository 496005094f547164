#include "tarnkiln/meta/Package.h"
#include "tests/kernel/TransactionRollbackFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeImpl.h"

#include <boost/optional/optional_io.hpp>

namespace {

using namespace testkit;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

// ---------------------------------------------------------------------------- plain values

TEST_F(TransactionRollback, RestoresPlainValuesOfAllKinds)
{
    Node const node = make(u"old");
    UUID const token = ElementImpl::generateNewUuid();
    node->setCount(1);
    node->setWeight(1.5);
    node->setTag("old");
    node->setToken(token);
    node->setNote(ustring(u"old"));
    node->getNumbers().push_back(4);
    node->getNumbers().push_back(4);
    node->getLabels().push_back(u"l");
    node->getWords().insert(u"w");
    Transaction const transaction = begin();
    node->setName(u"new");
    node->setCount(2);
    node->setWeight(2.5);
    node->setIsOpen(false);
    node->setTag("new");
    node->setToken(UUID{});
    node->setRank(3);
    node->setNote(boost::none);
    node->getNumbers().push_back(5);
    node->getLabels().clear();
    node->getWords().insert(u"x");

    rollBack(transaction);

    EXPECT_EQ(u"old", node->getName());
    EXPECT_EQ(1, node->getCount());
    EXPECT_EQ(1.5, node->getWeight());
    EXPECT_TRUE(node->isOpen());
    EXPECT_EQ("old", node->getTag());
    EXPECT_EQ(token, node->getToken());
    EXPECT_EQ(boost::none, node->getRank());
    EXPECT_EQ(u"old", node->getNote().value());
    EXPECT_THAT(node->getNumbers(), ElementsAre(4, 4));
    EXPECT_THAT(node->getLabels(), ElementsAre(u"l"));
    EXPECT_EQ(1u, node->getWords().size());
}

TEST_F(TransactionRollback, EmptiesCollectionsThatCameToExist)
{
    Node const node = make();
    Node const other = make();
    Transaction const transaction = begin();
    node->getNumbers().push_back(5);
    node->getLinks().push_back(other);
    node->getGrouped().insert(other);

    rollBack(transaction);

    EXPECT_EQ(0u, node->getNumbers().size());
    EXPECT_THAT(membersOf(node->getLinks()), IsEmpty());
    EXPECT_THAT(membersOf(other->getBacklinks()), IsEmpty());
    EXPECT_THAT(membersOf(node->getGrouped()), IsEmpty());
}

TEST_F(TransactionRollback, LeavesCollectionsWhereTheyAre)
{
    Node const node = make();
    auto* const links = &node->getLinks();
    Transaction const transaction = begin();
    node->getLinks().push_back(make());

    rollBack(transaction);

    EXPECT_EQ(links, &node->getLinks());
}

TEST_F(TransactionRollback, RestoresTheOrderOfASequence)
{
    Node const node = make();
    Node const a = make(), b = make(), c = make();
    for (Node const& each : {a, b, c})
        node->getLinks().push_back(each);
    Transaction const transaction = begin();
    node->getLinks().remove(a);
    node->getLinks().push_back(a);
    node->getLinks().ensureAt(0, c);

    rollBack(transaction);

    EXPECT_THAT(membersOf(node->getLinks()), ElementsAre(a, b, c));
}

// ---------------------------------------------------------------------------- creation

TEST_F(TransactionRollback, TakesCreatedElementsOutOfExistence)
{
    Node const parent = make();
    Transaction const transaction = begin();
    Node const top = make();
    Node const child = make();
    parent->getChildren().push_back(child);

    rollBack(transaction);

    EXPECT_FALSE(top);
    EXPECT_FALSE(child);
    EXPECT_FALSE(model->findElement(top->getUuid()));
    EXPECT_THAT(membersOf(parent->getChildren()), IsEmpty());
    EXPECT_EQ(1u, model->getElementCount());
}

TEST_F(TransactionRollback, FreesCreatedElementsThatReferToOneAnother)
{
    long const before = Node::liveCount();
    {
        Transaction const transaction = begin();
        Node const a = make(), b = make(), c = make();
        a->setBuddy(b);
        b->setBuddy(a);
        a->setLeft(b);
        a->getLinks().push_back(b);
        b->getLinks().push_back(a);
        a->getMarks().insert(b);
        a->getParts().push_back(c);
        c->setBuddy(a);
        rollBack(transaction);
    }
    EXPECT_EQ(before, Node::liveCount());
}

TEST_F(TransactionRollback, FreesCreatedTreesOfWhichOnlyALeafIsHeld)
{
    long const before = Node::liveCount();
    {
        Node leaf;
        {
            Transaction const transaction = begin();
            Node const root = make(), middle = make();
            leaf = make();
            root->getChildren().push_back(middle);
            middle->setBody(leaf);
            rollBack(transaction);
        }
        EXPECT_FALSE(leaf);
    }
    EXPECT_EQ(before, Node::liveCount());
}

TEST_F(TransactionRollback, LeavesWhatWasCreatedAndDestroyedGone)
{
    Node const parent = make();
    Transaction const transaction = begin();
    Node const gone = make();
    parent->getChildren().push_back(gone);
    gone->destroy();

    rollBack(transaction);

    EXPECT_FALSE(gone);
    EXPECT_FALSE(model->findElement(gone->getUuid()));
    EXPECT_THAT(membersOf(parent->getChildren()), IsEmpty());
}

TEST_F(TransactionRollback, ReleasesOldElementsFromCreatedContainers)
{
    Node const old = make();
    Node const parent = make();
    Node const child = make();
    parent->getChildren().push_back(child);
    Transaction const transaction = begin();
    Node const created = make();
    created->getParts().push_back(old);
    created->getChildren().push_back(child);

    rollBack(transaction);

    EXPECT_TRUE(isAtTop(old));
    EXPECT_EQ(parent, child->getParent());
    EXPECT_FALSE(isAtTop(child));
    EXPECT_FALSE(created);
}

TEST_F(TransactionRollback, RestoresTheOldElementUnderAUuidThatWasTakenAgain)
{
    Node const old = make(u"old");
    Node const parent = make();
    parent->getChildren().push_back(old);
    Transaction const transaction = begin();
    old->destroy();
    Node const newcomer = Node::create(model, old->getUuid());
    newcomer->setName(u"new");
    parent->getChildren().push_back(newcomer);

    rollBack(transaction);

    EXPECT_TRUE(old);
    EXPECT_FALSE(newcomer);
    EXPECT_EQ(old, Node::cast(model->findElement(old->getUuid())));
    EXPECT_THAT(membersOf(parent->getChildren()), ElementsAre(old));
    EXPECT_EQ(u"old", old->getName());
}

TEST_F(TransactionRollback, RestoresTheOldElementAfterSeveralSuccessorsUnderItsUuid)
{
    Node const old = make(u"old");
    UUID const id = old->getUuid();
    Transaction const transaction = begin();
    old->destroy();
    Node const first = Node::create(model, id);
    first->destroy();
    Node const second = Node::create(model, id);
    second->setCount(2);

    rollBack(transaction);

    EXPECT_TRUE(old);
    EXPECT_FALSE(first);
    EXPECT_FALSE(second);
    EXPECT_EQ(old, Node::cast(model->findElement(id)));
}

// ---------------------------------------------------------------------------- doomed transactions

TEST_F(TransactionRollback, ThatCannotBeAvoidedComesBehindEachChangeOfSeveralSteps)
{
    Node const p = make(u"p"), q = make(u"q"), x = make(u"x"), y = make(u"y");
    p->getGrouped().insert(x);
    p->getByName().insert(y);
    p->getLinks().push_back(x);
    std::function<void()> const changes[] = {
        [&] { x->setName(u"new"); },
        [&] { y->setName(u"new"); },
        [&] { q->setBody(y); },
        [&] { x->setParent(p); },
        [&] { p->getByName().destroyAllContents(); },
        [&] { p->destroy(); },
        [&] { model->destroyAllContents(); },
    };
    for (std::function<void()> const& change : changes)
    {
        Transaction const outer = begin();
        begin();  // dropped at once
        ASSERT_TRUE(outer.isRollBackOnly());

        change();
        outer.commit();

        EXPECT_EQ(nullptr, model->getCurrentTransaction());
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        EXPECT_EQ(u"x", x->getName());
        EXPECT_THAT(membersOf(p->getGrouped()), ElementsAre(x));
        EXPECT_EQ(y, p->getByName().find(u"y"));
        EXPECT_EQ(p, y->container());
        EXPECT_FALSE(q->hasBody());
        EXPECT_TRUE(isAtTop(x));
    }
}

TEST_F(TransactionRollback, ThatCannotBeAvoidedComesAtOnceBehindTheChangeOfASetter)
{
    Node const x = make(u"x");
    Transaction const outer = begin();
    begin();  // dropped at once

    x->setName(u"new");

    EXPECT_EQ(nullptr, model->getCurrentTransaction());
    EXPECT_EQ(u"x", x->getName());
    EXPECT_EQ(TransactionResult::NotCompleted, outer.commit());
}

TEST_F(TransactionRollback, ThatCannotBeAvoidedComesBehindAChangeInAnotherModelOfTheGroup)
{
    Model const other = Model::create(model->getModelConstellation());
    Transaction const outer = begin();
    Node const inOther = Node::create(other), target = Node::create(other);
    other->beginTransaction(true);  // dropped at once
    Node const a = make(), b = make();
    ASSERT_FALSE(outer.isRollBackOnly()) << "only the model of the dropped handle says so";

    a->getChildren().push_back(b);
    inOther->getLinks().push_back(target);

    EXPECT_EQ(TransactionResult::RolledBack, outer.commit());
    EXPECT_EQ(0u, model->getElementCount());
    EXPECT_EQ(0u, other->getElementCount());
}

// ---------------------------------------------------------------------------- afterwards

TEST_F(TransactionRollback, LeavesTheModelReadyForTheNextTransaction)
{
    Node const node = make(), other = make();
    for (int round = 0; round < 3; ++round)
    {
        Transaction const transaction = begin();
        node->setCount(round + 1);
        other->destroy();
        make();
        rollBack(transaction);
    }
    Transaction const transaction = begin();
    node->setCount(7);
    other->destroy();
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_EQ(7, node->getCount());
    EXPECT_EQ(1u, model->getElementCount());
}

TEST_F(TransactionRollback, RecordsNothingOfWhatItDoes)
{
    ScriptedListener listener;
    Node const node = make();
    Node const child = make();
    listen(model, listener);
    Transaction const transaction = begin();
    node->getChildren().push_back(child);
    node->destroy();
    rollBack(transaction);

    ASSERT_EQ(1u, listener.rolledBack.size());
    EXPECT_THAT(listener.rolledBack[0]->getDestroyed(), UnorderedElementsAre(node, child));
    EXPECT_THAT(listener.rolledBack[0]->getChanged(), IsEmpty());
    EXPECT_TRUE(listener.prepared.empty());
}

TEST_F(TransactionRollback, LeavesTheUriAsItIs)
{
    Transaction const transaction = begin();
    model->setModelURI(u"test://other");
    make();
    rollBack(transaction);

    EXPECT_EQ(u"test://other", model->getModelURI());
}

TEST_F(TransactionRollback, DoesNotCountPackagesBack)
{
    {
        Transaction const transaction = begin();
        make();
        rollBack(transaction);
    }
    EXPECT_EQ(0u, model->getElementCount());
    EXPECT_THAT(model->getUsedPackages(), testing::Contains(NodeMetamodel::get().package))
        << "what was created and undone stays counted";

    Model const second = Model::create(ModelConstellation());
    Node const node = Node::create(second);
    Transaction const transaction = second->beginTransaction(true);
    node->destroy();
    transaction.rollBack();

    EXPECT_TRUE(node);
    EXPECT_THAT(second->getUsedPackages(), IsEmpty())
        << "what was destroyed and brought back is not counted again";
}

TEST_F(TransactionRollback, LetsADeadElementReachItsDeadContainer)
{
    Node leaf = make();
    {
        Node const parent = make();
        parent->getChildren().push_back(leaf);
        parent->destroy();
    }

    ASSERT_NE(nullptr, leaf->basicContainer());
    EXPECT_FALSE(leaf->basicContainer()->isLive());
}

TEST_F(TransactionRollback, LeavesNothingInMemory)
{
    long const before = Node::liveCount();
    {
        Model const own = Model::create(ModelConstellation());
        Node const a = Node::create(own), b = Node::create(own);
        a->getChildren().push_back(b);
        a->setBuddy(b);
        b->setBuddy(a);
        {
            Transaction const transaction = own->beginTransaction(true);
            a->destroy();
            Node const c = Node::create(own);
            c->setBuddy(a);
            transaction.rollBack();
        }
        Transaction const transaction = own->beginTransaction(true);
        a->destroy();
        transaction.commit();
    }
    EXPECT_EQ(before, Node::liveCount());
}
}  // namespace
