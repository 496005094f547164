// Which properties of which elements an operation records, and in which order.
#include "tests/support/ExpectRaises.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/TracedNode.h"

namespace {

using namespace testkit;
using testing::ElementsAre;
using testing::IsEmpty;

class RecordOrder : public testing::Test
{
protected:
    Node make(char const* label) { return makeTraced(model, label, trace); }
    Node makeNamed(char const* label, ustring const& name)
    {
        Node const node = make(label);
        node->setName(name);
        return node;
    }
    /// What `change` records; it is taken back afterwards, which must leave all as it was.
    RecordTrace recordsOf(std::function<void()> const& change)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        trace.clear();
        change();
        RecordTrace const result = trace;
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        transaction.rollBack();
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        return result;
    }
    /// Looks at the model at the moment in which `node` records the property.
    void when(Node const& node, Slot const& slot, std::function<void()> look)
    {
        static_cast<TracedNodeImpl*>(node.getImpl())->whenRecorded =
            [index = slot.index, look = std::move(look)](unsigned long recorded) {
                if (recorded == index)
                    look();
            };
    }

    RecordTrace trace;
    Model const model = Model::create(ModelConstellation());
};

TEST_F(RecordOrder, OfOneToOneIsOldPartnerAssignmentNewPartner)
{
    Node const a = make("a"), b = make("b"), c = make("c"), d = make("d");
    a->setLeft(b);
    d->setLeft(c);
    Node atRight;
    when(c, Node::Impl::RIGHT, [&] { atRight = a->getLeft(); });

    EXPECT_THAT(recordsOf([&] { a->setLeft(c); }),
                ElementsAre("a.left", "b.right", "c.right", "d.left"));

    EXPECT_EQ(c, atRight) << "assigned before the new partner is told";
    EXPECT_EQ(b, a->getLeft());
    EXPECT_EQ(c, d->getLeft());
    EXPECT_EQ(a, b->getRight());
    EXPECT_EQ(d, c->getRight());
}

TEST_F(RecordOrder, OfOneToManyFromTheManySideIsCollectionMemberOldOwner)
{
    Node const p1 = make("p1"), p2 = make("p2"), x = make("x");
    p1->getOwned().push_back(x);
    std::size_t sizeAtOwner = 0;
    when(x, Node::Impl::OWNER, [&] { sizeAtOwner = p2->getOwned().size(); });

    EXPECT_THAT(recordsOf([&] { p2->getOwned().push_back(x); }),
                ElementsAre("p2.owned", "x.owner", "p1.owned"));

    EXPECT_EQ(1u, sizeAtOwner) << "appended before the member is told";
    EXPECT_EQ(p1, x->getOwner());
    EXPECT_THAT(p1->getOwned().getAllValues(), ElementsAre(x));
    EXPECT_THAT(p2->getOwned().getAllValues(), IsEmpty());
}

TEST_F(RecordOrder, OfOneToManyFromTheOneSideIsMemberOldOwnerNewOwner)
{
    Node const p1 = make("p1"), p2 = make("p2"), x = make("x");
    p1->getOwned().push_back(x);

    EXPECT_THAT(recordsOf([&] { x->setOwner(p2); }),
                ElementsAre("x.owner", "p1.owned", "p2.owned"));

    EXPECT_EQ(p1, x->getOwner());
}

TEST_F(RecordOrder, OfManyToManyIsThisEndThenTheOther)
{
    Node const a = make("a"), b = make("b");

    EXPECT_THAT(recordsOf([&] { a->getLinks().push_back(b); }),
                ElementsAre("a.links", "b.backlinks"));
    EXPECT_THAT(recordsOf([&] { b->getBacklinks().push_back(a); }),
                ElementsAre("b.backlinks", "a.links"));

    EXPECT_TRUE(a->getLinks().empty());
    EXPECT_TRUE(b->getBacklinks().empty());
}

TEST_F(RecordOrder, OfAChildThatMovesByItsNewContainer)
{
    Node const p1 = make("p1"), p2 = make("p2"), x = make("x");
    p1->getChildren().push_back(x);

    EXPECT_THAT(recordsOf([&] { p2->getChildren().push_back(x); }),
                ElementsAre("p2.children", "x.parent", "p1.children"));

    EXPECT_EQ(p1, x->getParent());
    EXPECT_THAT(p1->getChildren().getAllValues(), ElementsAre(x));
    EXPECT_THAT(p2->getChildren().getAllValues(), IsEmpty());
    EXPECT_FALSE(x->isTopLevel());
}

TEST_F(RecordOrder, OfAChildThatMovesByItsContainerReference)
{
    Node const p1 = make("p1"), p2 = make("p2"), x = make("x");
    p1->getChildren().push_back(x);

    EXPECT_THAT(recordsOf([&] { x->setParent(p2); }),
                ElementsAre("x.parent", "p1.children", "p2.children"));

    EXPECT_EQ(p1, x->getParent());
}

TEST_F(RecordOrder, OfAPartThatMovesHasNothingOfThePartButItsLink)
{
    Node const p1 = make("p1"), p2 = make("p2"), x = make("x");
    p1->getParts().push_back(x);

    EXPECT_THAT(recordsOf([&] { p2->getParts().push_back(x); }),
                ElementsAre("p2.parts", "p1.parts"));

    EXPECT_EQ(p1, Node::cast(x->container()));
    EXPECT_THAT(p1->getParts().getAllValues(), ElementsAre(x));
    EXPECT_THAT(p2->getParts().getAllValues(), IsEmpty());
}

TEST_F(RecordOrder, OfAPartThatIsReleasedIsTheCollectionAlone)
{
    Node const p = make("p"), x = make("x");
    p->getParts().push_back(x);

    EXPECT_THAT(recordsOf([&] {
                    p->getParts().remove(x);
                    EXPECT_TRUE(x->isTopLevel());
                }),
                ElementsAre("p.parts"));

    EXPECT_EQ(p, Node::cast(x->container()));
    EXPECT_FALSE(x->isTopLevel());
}

TEST_F(RecordOrder, OfAnEntryThatIsRenamedIsCollectionKeyCollection)
{
    Node const m = make("m"), x = makeNamed("x", u"old");
    m->getByName().insert(x);

    EXPECT_THAT(recordsOf([&] {
                    x->setName(u"new");
                    EXPECT_EQ(x, m->getByName().find(u"new"));
                }),
                ElementsAre("m.byName", "x.name"));

    EXPECT_EQ(u"old", x->getName());
    EXPECT_EQ(x, m->getByName().find(u"old"));
    EXPECT_FALSE(m->getByName().find(u"new"));
}

TEST_F(RecordOrder, OfADestroyedElementIsReferencesContainerContents)
{
    Node const p = make("p"), x = make("x"), c = make("c"), friendly = make("f");
    p->getChildren().push_back(x);
    x->getChildren().push_back(c);
    x->setLeft(friendly);

    RecordTrace const records = recordsOf([&] { x->destroy(); });

    auto const place = [&](char const* record) {
        return std::find(records.begin(), records.end(), record) - records.begin();
    };
    EXPECT_THAT(records, testing::IsSupersetOf({"x.left", "f.right", "p.children", "x.children"}));
    EXPECT_LT(place("x.left"), place("f.right"));
    EXPECT_LT(place("f.right"), place("p.children"));
    EXPECT_LT(place("p.children"), place("x.children"));
    EXPECT_THAT(records, testing::Not(testing::Contains("x.parent")));
    EXPECT_THAT(records, testing::Not(testing::Contains("c.parent")));
    EXPECT_EQ(p, x->getParent());
    EXPECT_EQ(x, c->getParent());
    EXPECT_EQ(friendly, x->getLeft());
}

TEST_F(RecordOrder, OfAContainerInAnotherModelIsTheSlotAndNotTheLink)
{
    Model const elsewhere = Model::create(ModelConstellation());
    Node const p = make("p"), x = make("x"), other = Node::create(elsewhere);
    p->getChildren().push_back(x);
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(true);
    trace.clear();

    EXPECT_RAISES(
        messages::CannotChangeModel,
        x->basicSetContainer(other.getImpl(), Node::Impl::CHILDREN, Node::Impl::PARENT.index));

    EXPECT_EQ(p, x->getParent());
    EXPECT_THAT(trace, ElementsAre("x.parent"));
    transaction.commit();
    ASSERT_EQ(1u, listener.committed.size());
    Report const report = listener.committed[0];
    meta::Property const& parent = NodeMetamodel::get().properties[Node::Impl::PARENT.index];
    EXPECT_THAT(report->getChanged(), ElementsAre(x));
    EXPECT_TRUE(report->isChanged(x, parent));
    EXPECT_EQ(Node(), report->getOldValue(x, parent).getValue<Node>());
}

TEST_F(RecordOrder, TakesNoSecondCopyOfAProperty)
{
    Node const a = make("a"), b = make("b");

    EXPECT_THAT(recordsOf([&] {
                    a->setCount(1);
                    a->setCount(2);
                    a->getLinks().push_back(b);
                    a->getLinks().remove(b);
                    a->getLinks().push_back(b);
                }),
                ElementsAre("a.count", "a.links", "b.backlinks"));
}

TEST_F(RecordOrder, TakesNoCopyOfACreatedElement)
{
    Node const p = make("p");

    EXPECT_THAT(recordsOf([&] {
                    Node const created = make("created");
                    created->setCount(3);
                    p->getChildren().push_back(created);
                    created->setParent(Node());
                }),
                ElementsAre("p.children"));
}

TEST_F(RecordOrder, TakesNoCopyInAShallowTransaction)
{
    Node const a = make("a");
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});
    Transaction const transaction = model->beginTransaction(false);
    trace.clear();
    a->setCount(3);
    transaction.commit();

    EXPECT_THAT(trace, IsEmpty());
    EXPECT_THAT(listener.committed.at(0)->getChanged(), ElementsAre(a));
}

TEST_F(RecordOrder, FailingInTheMiddleLeavesTheElementAsItWas)
{
    Node const a = make("a");
    Transaction const transaction = model->beginTransaction(true);
    when(a, Node::Impl::COUNT, [] { throw std::runtime_error("no room"); });

    EXPECT_THROW(a->notifyModifying(Node::Impl::COUNT.index), std::runtime_error);

    EXPECT_EQ(0, a->getCount());
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack()) << "nothing was recorded";
}

TEST_F(RecordOrder, FailingAtTheOtherEndIsLeftToTheRollbackOfTheOpenTransaction)
{
    Node const a = make("a"), b = make("b");
    Transaction const transaction = model->beginTransaction(true);
    when(b, Node::Impl::BACKLINKS, [] { throw std::runtime_error("no room"); });

    EXPECT_THROW(a->getLinks().push_back(b), std::runtime_error);

    EXPECT_FALSE(transaction.isRollBackOnly());
    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
    EXPECT_TRUE(a->getLinks().empty());
    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

TEST_F(RecordOrder, FailingAtThisEndLeavesTheTransactionUsable)
{
    Node const a = make("a"), b = make("b");
    Transaction const transaction = model->beginTransaction(true);
    when(a, Node::Impl::LINKS, [] { throw std::runtime_error("no room"); });

    EXPECT_THROW(a->getLinks().push_back(b), std::runtime_error);

    EXPECT_FALSE(transaction.isRollBackOnly());
    when(a, Node::Impl::LINKS, [] {});
    a->getLinks().push_back(b);
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    EXPECT_THAT(b->getBacklinks().getAllValues(), ElementsAre(a));
}
}  // namespace
