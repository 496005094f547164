#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/kernel/DestructionFixture.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/InvalidationLog.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;
using Validity = ElementImpl::ElementValidity;

using ADestroyedElement = Destruction;
using ADestroyedSubtree = Destruction;
using TheDestructionOfAnElement = Destruction;

// ---------------------------------------------------------------------------- one element

TEST_F(ADestroyedElement, IsInvalidAndUnknownToItsModel)
{
    Plain const element = make("a");

    element->destroy();

    EXPECT_FALSE(element);
    EXPECT_EQ(element->getValidity(), Validity::Invalid);
    EXPECT_FALSE(model->findElement(element->getUuid()));
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
}

TEST_F(ADestroyedElement, IsNotDestroyedAgain)
{
    InvalidationLog const log;
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain const element = make("a");
    element->destroy();
    TraceScope const trace;

    element->destroy();
    element->destroyRecursively(false, true, false);
    transaction.commit();

    EXPECT_THAT(trace.steps, IsEmpty());
    EXPECT_EQ(log.deathsOf(element.getImpl()), 1);
    model->removeListener(&listener);
}

TEST_F(ADestroyedElement, CannotBeDestroyedAgainEvenWhenItsModelIsGone)
{
    Plain const element = make("a");
    model->destroy();

    element->destroy();

    EXPECT_FALSE(element);
}

TEST_F(ADestroyedElement, IsFreedWithItsLastHandle)
{
    ExpectNoLeakedElements const noLeaks;
    {
        Plain const element = make("a");
        element->destroy();
    }
}

TEST_F(ADestroyedElement, LeavesItsContainer)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    Plain const part = make("part");
    parent->addChild(child);
    parent->addPart(part);

    child->destroy();
    part->destroy();

    EXPECT_THAT(parent->fields.children, IsEmpty());
    EXPECT_THAT(parent->fields.parts, IsEmpty());
}

TEST_F(ADestroyedElement, KeepsItsLinkAndItsContainerInMemory)
{
    Plain const child = make("child");
    {
        Plain const parent = make("parent");
        parent->addPart(child);
        parent->destroy();
    }

    EXPECT_FALSE(child);
    ASSERT_NE(child->basicContainer(), nullptr);
    EXPECT_EQ(Plain::cast(child->container())->name, "parent");
}

TEST_F(ADestroyedElement, DropsItsReferencesAndIsDroppedByTheOtherEnds)
{
    Plain const element = make("a");
    Plain const peer = make("peer");
    Plain const target = make("target");
    Plain const source = make("source");
    element->setPeer(peer);
    element->addLink(target);
    source->addLink(element);
    element->setLook(target);

    element->destroy();

    EXPECT_FALSE(peer->fields.peer);
    EXPECT_THAT(target->fields.backlinks, IsEmpty());
    EXPECT_THAT(source->fields.links, IsEmpty());
    EXPECT_THAT(element->fields.links, IsEmpty());
    EXPECT_FALSE(element->fields.look);
}

TEST_F(ADestroyedElement, StaysAsADeadTargetOfReferencesWithoutAnOpposite)
{
    Plain const looking = make("looking");
    Plain const target = make("target");
    looking->setLook(target);

    target->destroy();

    EXPECT_FALSE(looking->fields.look);
    EXPECT_EQ(looking->fields.look, target);
    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

TEST_F(ADestroyedElement, LeavesNoCycleOfMutualReferencesBehind)
{
    ExpectNoLeakedElements const noLeaks;
    {
        Plain const first = make("first");
        Plain const second = make("second");
        first->setLook(second);
        second->setLook(first);
        first->destroy();
        second->destroy();
    }
}

TEST_F(TheDestructionOfAnElement, TakesItsStepsInOrder)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    Plain const grandchild = make("grandchild");
    parent->addChild(child);
    child->addPart(grandchild);
    TraceScope const trace;

    child->destroy();

    EXPECT_THAT(trace.steps, ElementsAre("aboutToDestroy child", "notifyDestroying child",
                                         "disassociateIncoming child", "doDestroy child",
                                         "aboutToDestroy grandchild", "notifyDestroying grandchild",
                                         "disassociateIncoming grandchild", "doDestroy grandchild",
                                         "invalidate grandchild", "invalidate child"));
}

TEST_F(TheDestructionOfAnElement, TakesItOutOfItsContainerBetweenReferencesAndContents)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    Plain const peer = make("peer");
    parent->addChild(child);
    child->setPeer(peer);
    TraceScope const trace;
    Plain::Impl::tracesModifications = true;

    child->destroy();
    Plain::Impl::tracesModifications = false;

    EXPECT_THAT(trace.steps, ElementsAre("aboutToDestroy child", "notifyDestroying child",
                                         "disassociateIncoming child", "modify 6 child",
                                         "modify 7 child", "modify 5 child", "modify 5 peer",
                                         "modify 8 child", "modify 2 parent", "doDestroy child",
                                         "modify 2 child", "modify 4 child", "invalidate child"));
}

TEST_F(TheDestructionOfAnElement, FindsItValidUntilTheEnd)
{
    Plain const element = make("a");
    Validity duringDestruction{};
    TraceScope const trace;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl& destroyed) {
        duringDestruction = destroyed.getValidity();
    };

    element->destroy();

    EXPECT_EQ(duringDestruction, Validity::Valid);
}

TEST_F(TheDestructionOfAnElement, IsAChangeOfOneTransaction)
{
    Plain const parent = make("parent");
    parent->addChild(make("child"));
    parent->addPart(make("part"));
    ScriptedListener listener;
    listen(model, listener);

    parent->destroy();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_EQ(listener.committed[0]->getDestroyed().size(), 3u);
    EXPECT_FALSE(listener.committed[0]->getMessage());
    model->removeListener(&listener);
}

TEST_F(TheDestructionOfAnElement, IsUndoneWhenAListenerRefusesIt)
{
    Plain const element = make("a");
    ScriptedListener listener;
    listener.onValidate = [](Report const&) { return false; };
    listen(model, listener);

    element->destroy();

    EXPECT_TRUE(element);
    EXPECT_EQ(model->findElement(element->getUuid()), element);
    model->removeListener(&listener);
}

TEST_F(TheDestructionOfAnElement, LoadsTheSubtreeFirst)
{
    FakeDataSource& source = FakeDataSource::installIn(model);
    Plain const parent = make("parent");
    Plain late;
    source.onLoadSubtree = [&](ModelElement const& element) {
        EXPECT_EQ(element, parent);
        EXPECT_NE(model->getCurrentTransaction(), nullptr);
        late = make("late");
        parent->addPart(late);
    };

    parent->destroy();

    EXPECT_THAT(source.calls, ElementsAre("loadElementSubtree"));
    EXPECT_FALSE(late);
}

TEST_F(TheDestructionOfAnElement, SurvivesHooksThatDestroyOthers)
{
    Plain const parent = make("parent");
    Plain const first = make("first");
    Plain const second = make("second");
    parent->addChild(first);
    parent->addChild(second);
    TraceScope const trace;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl& element) {
        if (&element == first.getImpl())
            second->destroy();
    };

    parent->destroy();

    EXPECT_FALSE(first);
    EXPECT_FALSE(second);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(TheDestructionOfAnElement, SurvivesAHookThatDropsTheLastHandle)
{
    Plain element = make("a");
    ModelElement::Impl* const impl = element.getImpl();
    TraceScope const trace;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl&) { element = Plain(); };

    impl->destroy();

    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(TheDestructionOfAnElement, OfAProxyOnlyInvalidatesIt)
{
    Plain const proxy = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));
    TraceScope const trace;

    proxy->destroyRecursively(false, true, false);

    EXPECT_FALSE(proxy);
    EXPECT_THAT(trace.steps, ElementsAre("invalidate "));
}

TEST_F(TheDestructionOfAnElement, OfAProxyMayComeAfterThatOfItsModel)
{
    Plain const proxy = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));
    model->destroy();

    proxy->destroy();

    EXPECT_FALSE(proxy);
}

// ---------------------------------------------------------------------------- subtrees

TEST_F(ADestroyedSubtree, IsReportedElementByElementWithItsLinksUntouched)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    Plain const grandchild = make("grandchild");
    parent->addChild(child);
    child->addPart(grandchild);
    ScriptedListener listener;
    listen(model, listener);

    parent->destroy();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_THAT(plains(listener.committed[0]->getDestroyed()),
                UnorderedElementsAre(parent, child, grandchild));
    EXPECT_THAT(listener.committed[0]->getChanged(), IsEmpty());
    EXPECT_EQ(child->basicContainer(), parent.getImpl());
    EXPECT_EQ(grandchild->basicContainer(), child.getImpl());
    EXPECT_EQ(grandchild->getContainment(), Feature(Plain::Impl::PARTS_SLOT));
    model->removeListener(&listener);
}

TEST_F(ADestroyedSubtree, IsFreedAtOnceWhenNobodyHoldsIt)
{
    ExpectNoLeakedElements const noLeaks;
    Plain parent = make("parent");
    for (int i = 0; i < 10; ++i)
    {
        Plain const child = make("child");
        parent->addChild(child);
        child->addPart(make("part"));
    }

    parent->destroy();
    parent = Plain();
}

TEST_F(ADestroyedSubtree, MayBeDeep)
{
    ExpectNoLeakedElements const noLeaks;
    Plain const root = make("root");
    Plain const deepest = addChain(root, 50'000);

    root->destroy();

    EXPECT_FALSE(deepest);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ADestroyedSubtree, ComesBackFromAnyDepth)
{
    Plain const root = make("root");
    Plain const deepest = addChain(root, 5'000);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    root->destroy();
    EXPECT_FALSE(deepest);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(deepest);
    EXPECT_EQ(model->getElementCount(), 5'001u);
    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

TEST_F(ADestroyedSubtree, MayBeDestroyedByAHookFromDeepWithinAnother)
{
    Plain const root = make("root");
    Plain const deep = addChain(root, 98);
    Plain const other = make("other");
    Plain const below = addChain(other, 10);
    bool wasGoneAfterwards = false;
    TraceScope const trace;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl& element) {
        if (&element != deep.getImpl())
            return;
        other->destroy();
        wasGoneAfterwards = !below;
    };

    root->destroy();

    EXPECT_TRUE(wasGoneAfterwards);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ADestroyedSubtree, IsTakenBackWhenAHookFailsDeepWithinIt)
{
    Plain const root = make("root");
    Plain const deepest = addChain(root, 1'000);
    Plain const other = make("other");
    TraceScope const trace;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl& element) {
        if (&element == deepest.getImpl())
            throw std::runtime_error("no");
    };
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_THROW(root->destroy(), std::runtime_error);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(root);
    EXPECT_EQ(model->getElementCount(), 1'002u);
    other->destroy();
    EXPECT_EQ(model->getElementCount(), 1'001u);
}

TEST(ADeepSubtree, OfNodesIsDestroyedAndBroughtBackAtAnyDepth)
{
    Model const model = Model::create(ModelConstellation());
    Node const root = Node::create(model);
    Node deepest = root;
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        for (int i = 0; i < 8'000; ++i)
        {
            Node const next = Node::create(model);
            next->setParent(deepest);
            deepest = next;
        }
        transaction.commit();
    }
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    root->destroy();
    EXPECT_FALSE(deepest);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(deepest);
    EXPECT_TRUE(deepest->container());
    root->destroy();
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST(ADeepSubtree, IsReleasedWithItsModel)
{
    ExpectNoLeakedElements const noLeaks;
    Model const model = Model::createTransientModel();
    addChain(Plain::create(model), 50'000);
}
}  // namespace
