#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
using Validity = ElementImpl::ElementValidity;

class Rollback : public ::testing::Test
{
protected:
    ~Rollback() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()); }

    void begin() { m_transaction = model->beginTransaction(/*revertible=*/true); }
    void rollBack()
    {
        EXPECT_EQ(m_transaction.rollBack(), TransactionResult::RolledBack);
        m_transaction = Transaction();
    }

    Model const model = Model::create(ModelConstellation());
    Plain const parent = Plain::create(model, uuidOf(1));
    Plain const child = Plain::create(model, uuidOf(2));
    Plain const grandchild = Plain::create(model, uuidOf(3));

private:
    Transaction m_transaction;
};

using AResurrectedElement = Rollback;
using AResurrectedSubtree = Rollback;
using AnUndoneCreation = Rollback;
using AnElementCreatedAndDestroyed = Rollback;
using AReusedUuid = Rollback;

TEST_F(AResurrectedElement, IsTheSameObjectWithTheSameUuid)
{
    Plain::Impl* const impl = child.getImpl();
    begin();
    child->destroy();
    EXPECT_FALSE(child);

    rollBack();

    EXPECT_TRUE(child);
    EXPECT_EQ(child->getValidity(), Validity::Valid);
    EXPECT_EQ(child->getUuid(), uuidOf(2));
    EXPECT_EQ(model->findElementImpl(uuidOf(2)), impl);
    EXPECT_EQ(model->getTopLevelElements().size(), 3u);
}

TEST_F(AResurrectedElement, NeedsNoHandleOfAClient)
{
    UUID const id = Plain::create(model)->getUuid();
    ModelElement::Impl* const impl = model->findElementImpl(id);
    begin();
    impl->destroy();
    EXPECT_EQ(model->findElementImpl(id), nullptr);

    rollBack();

    EXPECT_EQ(model->findElementImpl(id), impl);
    EXPECT_EQ(impl->getRefCount(), 1u);
}

TEST_F(AResurrectedElement, HasItsValuesFromBeforeTheTransaction)
{
    child->setValue(7);
    begin();
    child->setValue(8);
    child->destroy();

    rollBack();

    EXPECT_EQ(child->getValue(), 7);
}

TEST_F(AResurrectedElement, HasItsReferencesBackAtBothEnds)
{
    child->setPeer(parent);
    child->addLink(grandchild);
    child->setLook(grandchild);
    grandchild->setLook(child);
    begin();
    child->destroy();

    rollBack();

    EXPECT_EQ(child->fields.peer, parent);
    EXPECT_EQ(parent->fields.peer, child);
    EXPECT_THAT(child->fields.links, ElementsAre(ModelElement(grandchild)));
    EXPECT_THAT(grandchild->fields.backlinks, ElementsAre(ModelElement(child)));
    EXPECT_EQ(child->fields.look, grandchild);
    EXPECT_TRUE(grandchild->fields.look) << "a dead reference without an opposite revives";
}

TEST_F(AResurrectedElement, ReturnsIntoItsContainer)
{
    parent->addChild(child);
    begin();
    child->destroy();

    rollBack();

    EXPECT_EQ(child->container(), parent);
    EXPECT_THAT(parent->fields.children, ElementsAre(ModelElement(child)));
    EXPECT_THAT(model->getTopLevelElements(), UnorderedElementsAre(parent, grandchild));
}

TEST_F(AResurrectedElement, ReturnsToTheTopLevelIfItWasContainedOnlyInTheTransaction)
{
    begin();
    parent->addPart(child);
    parent->destroy();

    rollBack();

    EXPECT_TRUE(child->isTopLevel());
    EXPECT_TRUE(parent->isTopLevel());
    EXPECT_EQ(model->getTopLevelElements().size(), 3u);
}

TEST_F(AResurrectedElement, ReturnsIntoItsContainerIfItWasReleasedInTheTransaction)
{
    parent->addPart(child);
    begin();
    child->makeUncontained();
    child->destroy();

    rollBack();

    EXPECT_EQ(child->container(), parent);
    EXPECT_THAT(model->getTopLevelElements(), UnorderedElementsAre(parent, grandchild));
}

TEST_F(AResurrectedElement, CanBeDestroyedForGood)
{
    begin();
    child->destroy();
    rollBack();

    child->destroy();

    EXPECT_FALSE(child);
    EXPECT_FALSE(model->findElement(uuidOf(2)));
}

TEST_F(AResurrectedElement, WasToldDeadOnceAndIsNotToldAlive)
{
    InvalidationLog const log;
    begin();
    child->destroy();
    rollBack();

    EXPECT_EQ(log.deathsOf(child.getImpl()), 1);
}

TEST_F(AResurrectedElement, LetsGoOfTheContainerThatItHeldInMemory)
{
    ExpectNoLeakedElements const noLeaks;
    {
        Plain const top = Plain::create(model);
        Plain const below = Plain::create(model);
        top->addPart(below);
        begin();
        top->destroy();
        rollBack();
        EXPECT_EQ(top->getRefCount(), 2u);
        top->destroy();
    }
}

TEST_F(AResurrectedElement, MayNotBeResurrectedFromAShallowTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    child->destroy();

    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotCompleted) << "nothing was recorded";

    EXPECT_FALSE(child);
}

TEST_F(AResurrectedSubtree, IsWholeAgain)
{
    parent->addChild(child);
    child->addPart(grandchild);
    grandchild->setValue(5);
    Plain::Impl* const impls[] = {parent.getImpl(), child.getImpl(), grandchild.getImpl()};
    begin();
    parent->destroy();
    EXPECT_EQ(model->getElementCount(), 0u);

    rollBack();

    EXPECT_EQ(model->findElementImpl(uuidOf(1)), impls[0]);
    EXPECT_EQ(model->findElementImpl(uuidOf(2)), impls[1]);
    EXPECT_EQ(model->findElementImpl(uuidOf(3)), impls[2]);
    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(grandchild->container(), child);
    EXPECT_THAT(child->fields.parts, ElementsAre(ModelElement(grandchild)));
    EXPECT_EQ(grandchild->getValue(), 5);
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(parent)));
    grandchild->setValue(6);
    EXPECT_EQ(grandchild->getValue(), 6);
}

TEST_F(AResurrectedSubtree, IsWholeWhoeverWasDestroyedFirst)
{
    parent->addChild(child);
    child->addChild(grandchild);
    begin();
    grandchild->destroy();
    child->destroy();
    parent->destroy();

    rollBack();

    EXPECT_EQ(grandchild->container(), child);
    EXPECT_EQ(child->container(), parent);
    EXPECT_THAT(child->fields.children, ElementsAre(ModelElement(grandchild)));
}

TEST_F(AResurrectedSubtree, IsAsBeforeWhateverHappenedInBetween)
{
    parent->addChild(child);
    child->addChild(grandchild);
    begin();
    parent->addChild(grandchild);
    child->destroy();
    Plain const fresh = Plain::create(model);
    fresh->addChild(grandchild);
    fresh->addPart(parent);
    grandchild->destroy();
    fresh->destroy();

    rollBack();

    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(grandchild->container(), child);
    EXPECT_FALSE(fresh);
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(parent)));
    EXPECT_EQ(model->getElementCount(), 3u);
}

TEST_F(AResurrectedSubtree, KeepsNothingInMemoryAfterwards)
{
    ExpectNoLeakedElements const noLeaks;
    {
        Plain const top = Plain::create(model);
        for (int i = 0; i < 20; ++i)
            top->addChild(Plain::create(model));
        begin();
        top->destroy();
        rollBack();
        EXPECT_EQ(top->fields.children.size(), 20u);
        top->destroy();
    }
}

TEST_F(AResurrectedSubtree, OfManyElementsFindsItsPlacesInTheRegistry)
{
    std::vector<Plain> many;
    for (std::uint32_t i = 0; i < 1'000; ++i)
        many.push_back(Plain::create(model, uuidOf(100 + i)));
    begin();
    for (Plain const& element : many)
        element->destroy();

    rollBack();

    for (std::uint32_t i = 0; i < 1'000; ++i)
        ASSERT_EQ(model->findElement(uuidOf(100 + i)), many[i]) << i;
    EXPECT_EQ(model->getElementCount(), 1'003u);
}

TEST_F(AnUndoneCreation, LeavesADeadElementThatNobodyKnows)
{
    begin();
    Plain const fresh = Plain::create(model, uuidOf(9));

    rollBack();

    EXPECT_FALSE(fresh);
    EXPECT_EQ(fresh->getUuid(), uuidOf(9));
    EXPECT_FALSE(model->findElement(uuidOf(9)));
    EXPECT_EQ(model->getTopLevelElements().size(), 3u);
}

TEST_F(AnUndoneCreation, DropsItsReferencesSilently)
{
    ExpectNoLeakedElements const noLeaks;
    begin();
    {
        Plain const first = Plain::create(model);
        Plain const second = Plain::create(model);
        first->setLook(second);
        second->setLook(first);
        first->addPart(second);
        parent->setPeer(first);
    }

    rollBack();

    EXPECT_FALSE(parent->fields.peer);
}

TEST_F(AnUndoneCreation, IsToldToTheInvalidateCallback)
{
    InvalidationLog const log;
    begin();
    Plain const fresh = Plain::create(model);

    rollBack();

    EXPECT_EQ(log.deathsOf(fresh.getImpl()), 1);
}

TEST_F(AnUndoneCreation, GivesItsContentsBackToWhereTheyWere)
{
    parent->addChild(child);
    begin();
    Plain const fresh = Plain::create(model);
    fresh->addChild(child);
    fresh->addPart(grandchild);

    rollBack();

    EXPECT_EQ(child->container(), parent);
    EXPECT_TRUE(grandchild->isTopLevel());
    EXPECT_THAT(model->getTopLevelElements(), UnorderedElementsAre(parent, grandchild));
}

TEST_F(AnElementCreatedAndDestroyed, IsNeitherResurrectedNorRestored)
{
    begin();
    Plain const fresh = Plain::create(model);
    fresh->destroy();
    std::vector<std::string> trace;
    Plain::Impl::trace = &trace;

    rollBack();
    Plain::Impl::trace = nullptr;

    EXPECT_FALSE(fresh);
    EXPECT_THAT(trace, IsEmpty());
    EXPECT_EQ(model->getElementCount(), 3u);
}

TEST_F(AReusedUuid, GoesBackToTheElementThatHadItBefore)
{
    begin();
    child->destroy();
    Plain const successor = Plain::create(model, uuidOf(2));
    EXPECT_EQ(model->findElement(uuidOf(2)), successor);

    rollBack();

    EXPECT_FALSE(successor);
    EXPECT_TRUE(child);
    EXPECT_EQ(model->findElement(uuidOf(2)), child);
}

TEST_F(AReusedUuid, GoesBackThroughAnyNumberOfSuccessors)
{
    begin();
    child->destroy();
    Plain const second = Plain::create(model, uuidOf(2));
    second->destroy();
    Plain const third = Plain::create(model, uuidOf(2));

    rollBack();

    EXPECT_FALSE(second);
    EXPECT_FALSE(third);
    EXPECT_EQ(model->findElement(uuidOf(2)), child);
}

TEST_F(AReusedUuid, IsReportedAsDestroyedAndCreated)
{
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    child->destroy();
    Plain const successor = Plain::create(model, uuidOf(2));
    transaction.commit();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getDestroyed()), ElementsAre(child));
    EXPECT_THAT(plains(listener.committed[0]->getCreated()), ElementsAre(successor));
    EXPECT_EQ(model->findElement(uuidOf(2)), successor);
    model->removeListener(&listener);
}
}  // namespace
