#include "tarnkiln/kernel/ExtensionListener.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/kernel/DestructionFixture.h"
#include "tests/support/ExpectRaises.h"
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
using Validity = ElementImpl::ElementValidity;

using ADestroyedModel = Destruction;
using AModelThatDestroysItsContents = Destruction;
using TheDestructionOfAModel = Destruction;

// ---------------------------------------------------------------------------- contents

TEST_F(AModelThatDestroysItsContents, StaysAndIsEmpty)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    parent->addChild(child);
    Plain const second = make("second");

    model->destroyAllContents();

    EXPECT_TRUE(model);
    EXPECT_FALSE(parent);
    EXPECT_FALSE(child);
    EXPECT_FALSE(second);
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_TRUE(make("next"));
}

TEST_F(AModelThatDestroysItsContents, ReportsThatAllIsGone)
{
    Plain const element = make("a");
    ScriptedListener listener;
    listen(model, listener);

    model->destroyAllContents();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_TRUE(listener.committed[0]->isDestroyAll());
    EXPECT_THAT(plains(listener.committed[0]->getDestroyed()), ElementsAre(element));
    model->removeListener(&listener);
}

TEST_F(AModelThatDestroysItsContents, ReportsItEvenWhenThereWasNothing)
{
    ScriptedListener listener;
    listen(model, listener);

    model->destroyAllContents();

    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_TRUE(listener.committed[0]->isDestroyAll());
    model->removeListener(&listener);
}

TEST_F(AModelThatDestroysItsContents, TakesNoNewElementInThatTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    model->destroyAllContents();

    EXPECT_RAISES_WITH(messages::CreateWithDestroyAll, make("late"));
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_TRUE(make("later"));
}

TEST_F(AModelThatDestroysItsContents, GetsThemBackByARollback)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    parent->addChild(child);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    model->destroyAllContents();

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(parent)));
    EXPECT_EQ(child->container(), parent);
    EXPECT_EQ(model->getElementCount(), 2u);
}

TEST_F(AModelThatDestroysItsContents, ClearsIncomingReferencesUnlessADataSourceHasThem)
{
    Plain const element = make("a");
    {
        TraceScope const trace;
        model->destroyAllContents();
        EXPECT_THAT(trace.steps,
                    ElementsAre("aboutToDestroy a", "notifyDestroying a", "disassociateIncoming a",
                                "doDestroy a", "invalidate a"));
    }
    FakeDataSource::installIn(model);
    Plain const second = make("b");
    {
        TraceScope const trace;
        model->destroyAllContents();
        EXPECT_THAT(trace.steps, ElementsAre("aboutToDestroy b", "notifyDestroying b",
                                             "doDestroy-keeping b", "invalidate b"));
    }
    Model const neighbour = Model::create(model->getModelConstellation());
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain const third = make("c");
    {
        TraceScope const trace;
        model->destroyAllContents();
        EXPECT_THAT(trace.steps,
                    ElementsAre("aboutToDestroy c", "notifyDestroying c", "disassociateIncoming c",
                                "doDestroy c", "invalidate c"));
    }
    transaction.commit();
}

// ---------------------------------------------------------------------------- the model

TEST_F(ADestroyedModel, IsInvalidWithAllItsElements)
{
    Plain const parent = make("parent");
    Plain const child = make("child");
    parent->addChild(child);

    model->destroy();

    EXPECT_FALSE(model);
    EXPECT_EQ(model->getValidity(), Validity::Invalid);
    EXPECT_FALSE(parent);
    EXPECT_FALSE(child);
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
}

TEST_F(ADestroyedModel, IsNotDestroyedAgain)
{
    InvalidationLog const log;

    model->destroy();
    model->destroy();

    EXPECT_EQ(log.deathsOf(model.getImpl()), 1);
}

TEST_F(ADestroyedModel, BelongsToNoConstellation)
{
    ModelConstellation const home = model->getModelConstellation();
    ustring const uri = model->getModelURI();

    model->destroy();

    EXPECT_FALSE(model->getModelConstellation());
    EXPECT_THAT(home->getModels(), IsEmpty());
    EXPECT_FALSE(home->peekModel(uri));
    EXPECT_TRUE(home);
}

TEST_F(ADestroyedModel, BeginsNoTransaction)
{
    model->destroy();

    EXPECT_RAISES_WITH(messages::ModelFrozen, model->beginTransaction(/*revertible=*/true));
    EXPECT_RAISES_WITH(messages::ModelFrozen, model->beginTransaction(/*revertible=*/false));
    EXPECT_RAISES_WITH(messages::ModelFrozen, model->destroyAllContents());
}

TEST_F(ADestroyedModel, EndsItsOpenTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    make("a");

    model->destroy();

    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
    EXPECT_EQ(transaction.commit(), TransactionResult::NotCompleted);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotCompleted);
}

TEST_F(ADestroyedModel, EndsAnOpenTransactionOutsideAConstellationToo)
{
    Model const alone = Model::createTransientModel();
    Transaction const transaction = alone->beginTransaction(/*revertible=*/true);
    Plain const element = Plain::create(alone);

    alone->destroy();

    EXPECT_FALSE(element);
    EXPECT_EQ(transaction.commit(), TransactionResult::NotCompleted);
}

TEST_F(ADestroyedModel, LetsTheOtherModelsOfTheGroupGoOn)
{
    Model const neighbour = Model::create(model->getModelConstellation());
    ScriptedListener listener;
    listen(neighbour, listener);
    Transaction const here = model->beginTransaction(/*revertible=*/true);
    Transaction const there = neighbour->beginTransaction(/*revertible=*/true);
    Plain const element = Plain::create(neighbour);

    model->destroy();
    EXPECT_THAT(listener.committed, IsEmpty());

    EXPECT_EQ(there.commit(), TransactionResult::Committed);
    EXPECT_EQ(listener.committed.size(), 1u);
    EXPECT_TRUE(element);
    neighbour->removeListener(&listener);
}

TEST_F(ADestroyedModel, CompletesAGroupThatWaitedForItOnly)
{
    Model const neighbour = Model::create(model->getModelConstellation());
    ScriptedListener listener;
    listen(neighbour, listener);
    Transaction const here = model->beginTransaction(/*revertible=*/true);
    {
        Transaction const there = neighbour->beginTransaction(/*revertible=*/true);
        Plain::create(neighbour);
        EXPECT_EQ(there.commit(), TransactionResult::NotCompleted);
    }

    model->destroy();

    EXPECT_EQ(listener.committed.size(), 1u);
    EXPECT_EQ(neighbour->getCurrentTransaction(), nullptr);
    neighbour->removeListener(&listener);
}

TEST_F(ADestroyedModel, HasListenersThatHeardOfTheirRemovalOnly)
{
    Trace trace;
    ScriptedListener first("first", &trace);
    ScriptedListener second("second", &trace);
    listen(model, first);
    listen(model, second, {.shallow = true});
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    make("a");

    model->destroy();

    EXPECT_THAT(trace, ElementsAre("first removed", "second removed"));
    EXPECT_FALSE(model->hasListeners());
}

/// Notes the step in a trace.
class TracingExtensionListener : public ExtensionListener
{
public:
    explicit TracingExtensionListener(std::vector<std::string>& trace) : m_trace(trace) {}

    void extensionAdded(Model const&, meta::Extension const&) override {}
    void extensionRemoved(Model const&, meta::Extension const&) override {}
    void listenerRemoved() override { m_trace.push_back("extension listener removed"); }

private:
    std::vector<std::string>& m_trace;
};

class TracingConstellationListener : public ConstellationListener
{
public:
    explicit TracingConstellationListener(std::vector<std::string>& trace) : m_trace(trace) {}

    void modelAdded(ModelConstellation const&, Model const&) override {}
    void modelDestroyed(ModelConstellation const& constellation, Model const& model) override
    {
        m_trace.push_back("constellation told");
        EXPECT_FALSE(model);
        EXPECT_EQ(constellation->getModels().size(), 1u) << "told before it forgets the model";
        EXPECT_TRUE(model->getModelConstellation());
    }
    void listenerRemoved(ModelConstellation const&) override {}

private:
    std::vector<std::string>& m_trace;
};

TEST_F(TheDestructionOfAModel, TakesItsStepsInOrder)
{
    Plain const parent = make("parent");
    parent->addChild(make("child"));
    TraceScope trace;
    TracingExtensionListener extensionListener(trace.steps);
    model->addExtensionListener(&extensionListener);
    ScriptedListener listener("listener", &trace.steps);
    listen(model, listener);
    ModelConstellation const home = model->getModelConstellation();
    TracingConstellationListener constellationListener(trace.steps);
    home->addConstellationListener(&constellationListener);
    FakeDataSource& source = FakeDataSource::installIn(model);
    source.onDeath = [&] {
        trace.steps.push_back("data source gone");
        EXPECT_EQ(model->getCurrentTransaction(), nullptr);
        EXPECT_EQ(model->getValidity(), Validity::ModelDestroying);
    };
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl&) {
        EXPECT_EQ(model->getValidity(), Validity::ModelDestroying);
        EXPECT_NE(model->getCurrentTransaction(), nullptr);
    };

    model->destroy();

    std::sort(trace.steps.begin() + 2, trace.steps.begin() + 4);  // in no promised order
    EXPECT_THAT(trace.steps,
                ElementsAre("extension listener removed", "listener removed",
                            "convertReferencesToProxies child", "convertReferencesToProxies parent",
                            "aboutToDestroy parent", "notifyDestroying parent",
                            "doDestroy-keeping parent", "aboutToDestroy child",
                            "notifyDestroying child", "doDestroy-keeping child", "invalidate child",
                            "invalidate parent", "data source gone", "constellation told"));
    home->removeConstellationListener(&constellationListener);
}

TEST_F(TheDestructionOfAModel, ComesWithItsLastHandleToo)
{
    ExpectNoLeakedElements const noLeaks;
    Plain element;
    {
        Model const alone = Model::createTransientModel();
        element = Plain::create(alone);
    }
    EXPECT_FALSE(element);
    element = Plain();
}

TEST_F(TheDestructionOfAModel, ResolvesNothing)
{
    Plain const target = make("target");
    Plain const proxy = Plain::createProxy(model, target->getPersistentProxyId(true));
    make("a");
    TraceScope const trace;
    ModelElement resolved = target;
    ModelElement peeked = target;
    Plain::Impl::whenAboutToDestroy = [&](Plain::Impl& element) {
        resolved = model->resolveProxy(&element, proxy);
        peeked = model->peekResolveProxy(&element, proxy);
    };

    model->destroy();

    EXPECT_EQ(resolved.getImpl(), nullptr);
    EXPECT_EQ(peeked.getImpl(), nullptr);
}

TEST_F(TheDestructionOfAModel, NeedsNoThaw)
{
    Plain const element = make("a");
    Model::Freezer const freezer = model->freeze();

    model->destroy();

    EXPECT_FALSE(element);
}

TEST_F(TheDestructionOfAModel, InvalidatesWhatNoCollectionHolds)
{
    Plain const container = make("container");
    Plain const lost = make("lost");
    container->_setContainedByThis(lost.getImpl(), Plain::Impl::PARTS_SLOT);

    model->destroy();

    EXPECT_FALSE(lost);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(TheDestructionOfAModel, CutsItsProxiesOff)
{
    Plain proxy = Plain::createProxy(model, ProxyId(ElementId::UUID_TYPE, u"x"));

    model->destroy();

    EXPECT_TRUE(proxy);
    EXPECT_EQ(proxy->getModelImpl(), nullptr);
    EXPECT_FALSE(proxy->getModel());
    proxy = Plain();
}

TEST_F(TheDestructionOfAModel, EmptiesTheReferencesOfThousandsOfElements)
{
    Node const parent = Node::create(model);
    std::vector<Node> children;
    Transaction const filling = model->beginTransaction(/*revertible=*/false);
    for (int i = 0; i < 3000; ++i)
    {
        children.push_back(Node::create(model));
        children.back()->setParent(parent);
        children.back()->setBuddy(children.front());
    }
    filling.commit();

    model->destroy();

    for (Node const& child : children)
    {
        ASSERT_FALSE(child);
        ASSERT_EQ(child->getBuddyImpl(), nullptr);
    }
    EXPECT_EQ(model->getElementCount(), 0u);
}
}  // namespace
