// What collections do to the other end of an association and to containers.
#include "tests/collections/CollectionFixture.h"

namespace testkit {
namespace {

/// One to many: `owned` and `owner`.
class OneToMany : public CollectionFixture
{
protected:
    Node const first = node(u"first");
    Node const second = node(u"second");
    Node const x = node(u"x");
    Node const y = node(u"y");
};

TEST_F(OneToMany, AddingSetsTheOtherEnd)
{
    first->getOwned().push_back(x);

    EXPECT_EQ(x->getOwner(), first);
    EXPECT_EQ(namesIn(first->getOwned()), (Names{u"x"}));
}

TEST_F(OneToMany, AddingToAnotherTakesTheElementFromTheFirst)
{
    first->getOwned().push_back(x);

    second->getOwned().push_back(x);

    EXPECT_EQ(x->getOwner(), second);
    EXPECT_TRUE(first->getOwned().empty());
    EXPECT_EQ(namesIn(second->getOwned()), (Names{u"x"}));
}

TEST_F(OneToMany, SettingTheOtherEndAdds)
{
    x->setOwner(first);
    EXPECT_EQ(namesIn(first->getOwned()), (Names{u"x"}));

    x->setOwner(Node());
    EXPECT_TRUE(first->getOwned().empty());
}

TEST_F(OneToMany, RemovingClearsTheOtherEnd)
{
    for (Node const& element : {x, y})
        first->getOwned().push_back(element);

    first->getOwned().remove(x);
    EXPECT_FALSE(x->getOwner());

    first->getOwned().erase(0);
    EXPECT_FALSE(y->getOwner());
}

TEST_F(OneToMany, ClearingClearsAllOtherEnds)
{
    for (Node const& element : {x, y})
        first->getOwned().push_back(element);

    first->getOwned().clear();

    EXPECT_TRUE(first->getOwned().empty());
    EXPECT_FALSE(x->getOwner());
    EXPECT_FALSE(y->getOwner());
}

TEST_F(OneToMany, ReplacingTellsBothElements)
{
    first->getOwned().push_back(x);

    first->getOwned().replace(0, y);

    EXPECT_EQ(namesIn(first->getOwned()), (Names{u"y"}));
    EXPECT_EQ(y->getOwner(), first);
    EXPECT_FALSE(x->getOwner());
}

TEST_F(OneToMany, ReplacingByAnElementOfAnotherTakesItFromThere)
{
    first->getOwned().push_back(x);
    second->getOwned().push_back(y);

    first->getOwned().replace(0, y);

    EXPECT_EQ(namesIn(first->getOwned()), (Names{u"y"}));
    EXPECT_TRUE(second->getOwned().empty());
}

TEST_F(OneToMany, TheReferenceOfTheElementDecidesWhatIsContained)
{
    first->getOwned().push_back(x);
    UndoneAtEnd const undone(model);  // the ends are out of step here
    genericOf(first->getOwned()).genericBasicClear();
    ASSERT_EQ(x->getOwner(), first);

    EXPECT_TRUE(first->getOwned().contains(x));
    first->getOwned().push_back(x);
    EXPECT_TRUE(first->getOwned().empty()) << "taken for present, and not added";
    first->getOwned().push_back(y);
    EXPECT_RAISES(messages::CannotAddSecondObject, first->getOwned().replace(0, x));
}

TEST_F(OneToMany, BasicOperationsLeaveTheOtherEndAlone)
{
    first->getOwned().push_back(x);
    UndoneAtEnd const undone(model);  // the ends are out of step here

    genericOf(first->getOwned()).genericBasicClear();

    EXPECT_EQ(x->getOwner(), first);
}

/// Many to many: `links` and `backlinks`.
using ManyToMany = OneToMany;

TEST_F(ManyToMany, AddingAndRemovingKeepBothEndsInStep)
{
    first->getLinks().push_back(x);
    second->getLinks().push_back(x);
    x->getBacklinks().push_back(y);

    EXPECT_EQ(namesIn(x->getBacklinks()), (Names{u"first", u"second", u"y"}));
    EXPECT_EQ(namesIn(y->getLinks()), (Names{u"x"}));

    x->getBacklinks().erase(0);
    EXPECT_TRUE(first->getLinks().empty());
    second->getLinks().clear();
    EXPECT_EQ(namesIn(x->getBacklinks()), (Names{u"y"}));
}

TEST_F(ManyToMany, ReplacingKeepsBothEndsInStep)
{
    first->getLinks().push_back(x);

    first->getLinks().replace(0, y);

    EXPECT_TRUE(x->getBacklinks().empty());
    EXPECT_EQ(namesIn(y->getBacklinks()), (Names{u"first"}));
}

TEST_F(ManyToMany, AnElementMayReferToItself)
{
    x->getLinks().push_back(x);

    EXPECT_EQ(namesIn(x->getBacklinks()), (Names{u"x"}));
    x->getBacklinks().clear();
    EXPECT_TRUE(x->getLinks().empty());
}

TEST_F(ManyToMany, IsWrittenFromOneEndOnlyWhileADocumentIsRead)
{
    Model::ParseInProgressIndicator const parsing(model);

    first->getLinks().push_back(x);
    EXPECT_TRUE(x->getBacklinks().empty()) << "the document lists the other end too";

    x->getBacklinks().push_back(first);
    EXPECT_EQ(namesIn(first->getLinks()), (Names{u"x"}));
    EXPECT_EQ(namesIn(x->getBacklinks()), (Names{u"first"}));
}

TEST_F(ManyToMany, ReplacingWritesBothEndsEvenWhileADocumentIsRead)
{
    first->getLinks().push_back(x);
    Model::ParseInProgressIndicator const parsing(model);

    first->getLinks().replace(0, y);

    EXPECT_EQ(namesIn(y->getBacklinks()), (Names{u"first"}));
    EXPECT_TRUE(x->getBacklinks().empty());
}

TEST_F(ManyToMany, SetsKeepBothEndsInStep)
{
    first->getMarks().insert(x);
    second->getMarks().insert(x);

    EXPECT_EQ(sortedNamesIn(x->getMarkedBy()), (Names{u"first", u"second"}));

    x->getMarkedBy().erase(first);
    EXPECT_TRUE(first->getMarks().empty());
    x->getMarkedBy().clear();
    EXPECT_TRUE(second->getMarks().empty());
}

/// Composite with a way back: `children` and `parent`.
using Containment = OneToMany;

TEST_F(Containment, AddingContains)
{
    first->getChildren().push_back(x);

    EXPECT_EQ(x->container(), first);
    EXPECT_FALSE(x->isTopLevel());
    EXPECT_EQ(x->getParent(), first);
    EXPECT_EQ(x->getContainment(), Feature(Node::Impl::CHILDREN));
}

TEST_F(Containment, AddingMovesFromTheOldContainer)
{
    DeepCounter counter;
    first->getChildren().push_back(x);
    model->addListener(&counter);

    second->getChildren().push_back(x);

    EXPECT_EQ(x->container(), second);
    EXPECT_TRUE(first->getChildren().empty());
    EXPECT_EQ(namesIn(second->getChildren()), (Names{u"x"}));
    EXPECT_EQ(counter.commits, 1);
    EXPECT_TRUE(counter.sawChanged({first, second, x}));
    model->removeListener(&counter);
}

TEST_F(Containment, AddingMovesBetweenTwoPropertiesOfOneContainer)
{
    first->getParts().push_back(x);

    first->getChildren().push_back(x);
    EXPECT_TRUE(first->getParts().empty());
    EXPECT_EQ(x->getContainment(), Feature(Node::Impl::CHILDREN));

    first->getParts().push_back(x);
    EXPECT_TRUE(first->getChildren().empty());
    EXPECT_EQ(x->getContainment(), Feature(Node::Impl::PARTS));
    EXPECT_FALSE(x->getParent());
}

TEST_F(Containment, RemovingMakesTopLevel)
{
    for (Node const& element : {x, y})
        first->getChildren().push_back(element);

    first->getChildren().remove(x);
    EXPECT_TRUE(x->isTopLevel());
    EXPECT_TRUE(x);

    first->getChildren().clear();
    EXPECT_TRUE(y->isTopLevel());
}

TEST_F(Containment, ReplacingContainsTheOneAndReleasesTheOther)
{
    first->getChildren().push_back(x);

    first->getChildren().replace(0, y);

    EXPECT_EQ(y->container(), first);
    EXPECT_TRUE(x->isTopLevel());
    EXPECT_EQ(namesIn(first->getChildren()), (Names{u"y"}));
}

TEST_F(Containment, RefusesACircle)
{
    first->getChildren().push_back(x);
    x->getChildren().push_back(y);

    EXPECT_RAISES(messages::CircularContainment, y->getChildren().push_back(first));
    EXPECT_RAISES(messages::CircularContainment, first->getChildren().push_back(first));
    EXPECT_RAISES(messages::CircularContainment, y->getParts().insert(0, x));
    y->getParts().push_back(second);
    EXPECT_RAISES(messages::CircularContainment, y->getParts().replace(0, first));
    EXPECT_RAISES(messages::CircularContainment, y->getByName().insert(first));

    EXPECT_TRUE(first->isTopLevel());
    EXPECT_EQ(namesIn(y->getParts()), (Names{u"second"}));
    EXPECT_TRUE(y->getChildren().empty());
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(Containment, RefusesAnElementOfAnotherModel)
{
    Model const other = Model::create(model->getModelConstellation());
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Node const foreign = Node::create(other);

    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  first->getChildren().push_back(foreign));
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  first->getParts().push_back(foreign));
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, first->getByName().insert(foreign));

    EXPECT_TRUE(first->getChildren().empty());
    first->getLinks().push_back(foreign);
    EXPECT_EQ(foreign->getBacklinks().at(0), first) << "plain references may cross";
    transaction.commit();
}

TEST_F(Containment, DestroyingContentsEmptiesTheCollectionFirst)
{
    for (Node const& element : {x, y})
        first->getChildren().push_back(element);

    first->getChildren().destroyAllContents();

    EXPECT_TRUE(first->getChildren().empty());
    EXPECT_FALSE(x);
    EXPECT_FALSE(y);
}

/// Composite without a way back, not unique: `parts`.
using OneWayContainment = OneToMany;

TEST_F(OneWayContainment, AddingContains)
{
    first->getParts().push_back(x);

    EXPECT_EQ(x->container(), first);
    EXPECT_EQ(x->getContainment(), Feature(Node::Impl::PARTS));
}

TEST_F(OneWayContainment, AddingMovesFromTheOldContainer)
{
    first->getParts().push_back(x);

    second->getParts().insert(0, x);

    EXPECT_EQ(x->container(), second);
    EXPECT_TRUE(first->getParts().empty());
    EXPECT_EQ(namesIn(second->getParts()), (Names{u"x"}));
}

TEST_F(OneWayContainment, AddingAMemberAgainMovesItToTheEnd)
{
    Node const z = node(u"z");
    for (Node const& element : {x, y, z})
        first->getParts().push_back(element);

    first->getParts().push_back(x);

    EXPECT_EQ(namesIn(first->getParts()), (Names{u"y", u"z", u"x"}));
    EXPECT_EQ(x->container(), first);
}

TEST_F(OneWayContainment, InsertingAMemberBeforeItselfChangesNothing)
{
    Node const z = node(u"z");
    for (Node const& element : {x, y, z})
        first->getParts().push_back(element);

    EXPECT_EQ(first->getParts().insert(0, z), 2u);

    EXPECT_EQ(namesIn(first->getParts()), (Names{u"x", u"y", u"z"}))
        << "the first of the two is taken out";
    EXPECT_EQ(z->container(), first);
}

TEST_F(OneWayContainment, ReplacingByAMemberInFrontMovesIt)
{
    Node const z = node(u"z");
    for (Node const& element : {x, y, z})
        first->getParts().push_back(element);

    first->getParts().replace(2, x);

    EXPECT_EQ(namesIn(first->getParts()), (Names{u"y", u"x"}));
    EXPECT_TRUE(z->isTopLevel());
    EXPECT_EQ(x->container(), first);
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(OneWayContainment, ReplacingReleasesTheOldEntry)
{
    first->getParts().push_back(x);

    first->getParts().replace(0, y);

    EXPECT_TRUE(x->isTopLevel());
    EXPECT_EQ(y->container(), first);
}

TEST_F(OneWayContainment, RemovingMakesTopLevel)
{
    for (Node const& element : {x, y})
        first->getParts().push_back(element);

    first->getParts().erase(0);
    EXPECT_TRUE(x->isTopLevel());
    first->getParts().clear();
    EXPECT_TRUE(y->isTopLevel());
}

// ---------------------------------------------------------------------------- rollback

TEST_F(Containment, ARollbackRestoresBothContainersAndTheLink)
{
    first->getChildren().push_back(x);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    second->getChildren().push_back(x);
    second->getParts().push_back(x);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(x->container(), first);
    EXPECT_EQ(namesIn(first->getChildren()), (Names{u"x"}));
    EXPECT_TRUE(second->getChildren().empty());
    EXPECT_TRUE(second->getParts().empty());
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(ManyToMany, ARollbackRestoresBothEnds)
{
    first->getLinks().push_back(x);
    first->getMarks().insert(x);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    first->getLinks().replace(0, y);
    first->getMarks().clear();
    second->getMarks().insert(x);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(namesIn(first->getLinks()), (Names{u"x"}));
    EXPECT_EQ(namesIn(x->getBacklinks()), (Names{u"first"}));
    EXPECT_TRUE(y->getBacklinks().empty());
    EXPECT_EQ(namesIn(x->getMarkedBy()), (Names{u"first"}));
    EXPECT_TRUE(second->getMarks().empty());
    EXPECT_TRUE(model->checkInvariants().empty());
}

// ---------------------------------------------------------------------------- failures

/// A node that fails once it has taken its end of an association.
class FailingImpl : public Node::Impl
{
public:
    using Node::Impl::Impl;

    void inverseAddSlot(ModelElement const& element, Slot const& slot) override
    {
        Node::Impl::inverseAddSlot(element, slot);
        throw std::runtime_error("the other end fails");
    }
};

class FailureAtTheOtherEnd : public CollectionFixture
{
protected:
    FailureAtTheOtherEnd() { failing->notifyCreated(); }

    Node const owner = node(u"owner");
    Node const failing{new FailingImpl(model, UUID{})};
};

TEST_F(FailureAtTheOtherEnd, IsTakenBackIfTheTransactionIsDeep)
{
    DeepCounter counter;
    model->addListener(&counter);

    EXPECT_THROW(owner->getOwned().push_back(failing), std::runtime_error);
    EXPECT_THROW(owner->getMarks().insert(failing), std::runtime_error);
    EXPECT_THROW(owner->getByName().insert(failing), std::runtime_error);

    EXPECT_TRUE(owner->getOwned().empty());
    EXPECT_TRUE(owner->getMarks().empty());
    EXPECT_TRUE(owner->getByName().empty());
    EXPECT_FALSE(failing->hasOwner());
    EXPECT_TRUE(failing->isTopLevel());
    EXPECT_EQ(counter.commits, 0);
    EXPECT_EQ(counter.rollbacks, 3);
    EXPECT_FALSE(model->getCurrentTransaction());
    model->removeListener(&counter);
    EXPECT_TRUE(model->checkInvariants().empty());
}

TEST_F(FailureAtTheOtherEnd, StaysIfTheTransactionIsShallow)
{
    EXPECT_THROW(owner->getOwned().push_back(failing), std::runtime_error);

    EXPECT_EQ(owner->getOwned().size(), 1u);
    EXPECT_TRUE(failing->hasOwner());
    EXPECT_FALSE(model->getCurrentTransaction());
}

TEST_F(FailureAtTheOtherEnd, IsLeftToTheOuterTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_THROW(owner->getOwned().push_back(failing), std::runtime_error);
    EXPECT_EQ(owner->getOwned().size(), 1u);
    EXPECT_FALSE(transaction.isRollBackOnly());
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(owner->getOwned().empty());
    EXPECT_FALSE(failing->hasOwner());
}
}  // namespace
}  // namespace testkit
