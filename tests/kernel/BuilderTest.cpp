#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Orchestrator = ModelElement::Builder::Orchestrator;

class Building : public ::testing::Test
{
protected:
    ~Building() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()); }

    Model const model = Model::create(ModelConstellation());
};

using ABuilder = Building;
using AnOrchestrator = Building;
using ABuiltProxy = Building;

// ---------------------------------------------------------------------------- builders

TEST_F(ABuilder, MakesAnElementWithItsValues)
{
    Plain::Builder builder(model);
    builder.setValue(5);

    Plain const built = Plain::cast(builder.create(uuidOf(1)));

    ASSERT_TRUE(built);
    EXPECT_EQ(built->getUuid(), uuidOf(1));
    EXPECT_EQ(built->getValue(), 5);
    EXPECT_TRUE(built->isTopLevel());
    EXPECT_EQ(model->findElement(uuidOf(1)), built);
}

TEST_F(ABuilder, GivesAFreshUuidForTheNilOne)
{
    Plain::Builder builder(model);

    EXPECT_FALSE(builder.create()->getUuid().is_nil());
}

TEST_F(ABuilder, KnowsWhichPropertiesWereSet)
{
    Plain::Builder builder(model);
    EXPECT_FALSE(builder.isValueSet());

    builder.setValue(0);

    EXPECT_TRUE(builder.isValueSet());
    EXPECT_EQ(builder.getModel(), model);
    EXPECT_EQ(builder.getOrchestrator(), nullptr);
}

TEST_F(ABuilder, OfTheBaseClassKnowsNoProperty)
{
    meta::MetaRegistry::getInstance();
    Plain::Builder builder(model);
    meta::Property const none;

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder.setOrAdd(none, Value(meta::StandardTypes::integerMeta, 1)), u"",
                       u"");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       (builder.setOrAdd(none, std::unique_ptr<ModelElement::Builder>())), u"",
                       u"");
}

TEST_F(ABuilder, BuildsATreeInOneTransaction)
{
    ScriptedListener listener;
    listen(model, listener);
    Plain::Builder builder(model);
    builder.setValue(1);
    auto child = std::make_unique<Plain::Builder>();
    child->setValue(2);
    child->addChild(std::make_unique<Plain::Builder>());
    builder.addChild(std::move(child));

    Plain const root = Plain::cast(builder.create());

    ASSERT_EQ(root->fields.children.size(), 1u);
    Plain const below = Plain::cast(root->fields.children[0]);
    EXPECT_EQ(below->getValue(), 2);
    EXPECT_EQ(below->container(), root);
    EXPECT_EQ(below->fields.children.size(), 1u);
    EXPECT_THAT(model->getTopLevelElements(), ElementsAre(ModelElement(root)));
    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_EQ(listener.committed[0]->getCreated().size(), 3u);
    EXPECT_TRUE(listener.committed[0]->isDeep());
    EXPECT_FALSE(listener.committed[0]->getMessage());
    model->removeListener(&listener);
}

TEST_F(ABuilder, MayBuildAgain)
{
    Plain::Builder builder(model);
    builder.setValue(3);

    Plain const first = Plain::cast(builder.create());
    Plain const second = Plain::cast(builder.create());

    EXPECT_NE(first, second);
    EXPECT_EQ(second->getValue(), 3);
}

TEST_F(ABuilder, TakesEverythingBackWhenAPartFails)
{
    ExpectNoLeakedElements const noLeaks;
    Plain const occupant = Plain::create(model, uuidOf(1));
    {
        Plain::Builder builder(model);
        auto child = std::make_unique<Plain::Builder>();
        child->beforeCreated = [](Plain const&) { throw std::runtime_error("no"); };
        builder.addChild(std::move(child));

        EXPECT_THROW(builder.create(), std::runtime_error);
        EXPECT_EQ(builder.getOrchestrator(), nullptr);
    }

    EXPECT_EQ(model->getElementCount(), 1u);
    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
    occupant->destroy();
}

/// An element that fails in its constructor, after the one of its base has run.
class FailingInConstructor : public Plain::Impl
{
public:
    explicit FailingInConstructor(Plain::Builder& builder) : Plain::Impl(builder, UUID{})
    {
        Plain const taken(this);  // lets go of before the failure
        throw std::runtime_error("no");
    }
};

class FailingBuilder : public Plain::Builder
{
public:
    using Plain::Builder::Builder;

protected:
    ModelElement doCreate(bool, UUID const&) override
    {
        Orchestrator orchestrator(this);
        try
        {
            return Plain(new FailingInConstructor(*this));
        }
        catch (std::runtime_error const&)
        {
            EXPECT_EQ(orchestrator.getCreatedElement(this).getImpl(), nullptr);
            throw;
        }
    }
};

TEST_F(ABuilder, ForgetsAnElementWhoseConstructorFails)
{
    ExpectNoLeakedElements const noLeaks;
    FailingBuilder builder(model);
    Plain::Builder outer(model);
    Orchestrator orchestrator(&outer);

    EXPECT_THROW(builder.create(), std::runtime_error);

    EXPECT_EQ(builder.getOrchestrator(), nullptr);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ABuilder, DoomsTheOuterTransactionWhenItFails)
{
    Plain const occupant = Plain::create(model, uuidOf(1));
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    occupant->setValue(1);
    Plain::Builder builder(model);

    EXPECT_RAISES_WITH(messages::UUIDConflict, builder.create(uuidOf(1)));

    EXPECT_TRUE(transaction.isRollBackOnly());
    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);
    EXPECT_EQ(occupant->getValue(), 0);
}

TEST_F(ABuilder, RefusesAFrozenModelAndDoomsTheOuterTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    {
        Model::Freezer const freezer = model->freeze();
        Plain::Builder builder(model);

        EXPECT_RAISES_WITH(messages::ModelFrozen, builder.create());
    }

    EXPECT_TRUE(transaction.isRollBackOnly());
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ABuilder, RefusesADeadModel)
{
    Plain::Builder builder(model);
    Model const dead = model;
    dead->destroy();

    EXPECT_RAISES_WITH(messages::ModelFrozen, builder.create());
    EXPECT_RAISES_WITH(messages::CannotCreateWithoutModel, builder.createProxy(ProxyId()));
}

// ---------------------------------------------------------------------------- orchestrator

TEST_F(AnOrchestrator, KnowsItsBuildersAndWhatTheyMade)
{
    Plain::Builder first(model);
    Plain::Builder second;
    Plain::Builder stranger(model);
    Orchestrator orchestrator(&first);
    EXPECT_EQ(first.getOrchestrator(), &orchestrator);
    orchestrator.addBuilder(&second);
    EXPECT_EQ(second.getOrchestrator(), &orchestrator);
    EXPECT_EQ(second.getModel(), model);
    EXPECT_EQ(orchestrator.getCreatedElement(&first).getImpl(), nullptr);

    Plain const made(new Plain::Impl(second, uuidOf(1)));

    EXPECT_EQ(orchestrator.getCreatedElement(&second), made);
    EXPECT_EQ(orchestrator.getCreatedElement(&first).getImpl(), nullptr);
    EXPECT_EQ(orchestrator.getCreatedElement(&stranger).getImpl(), nullptr);
    orchestrator.commit();
}

TEST_F(AnOrchestrator, LeavesABuilderToTheOneThatHasIt)
{
    Plain::Builder builder(model);
    Plain::Builder other(model);
    Orchestrator first(&builder);
    Orchestrator second(&other);

    second.addBuilder(&builder);

    EXPECT_EQ(builder.getOrchestrator(), &first);
    second.commit();
    first.commit();
}

TEST_F(AnOrchestrator, NeedsABuilderWithAModel)
{
    Plain::Builder builder;

    EXPECT_RAISES_WITH(messages::CannotCreateWithoutModel, Orchestrator{&builder});

    EXPECT_EQ(builder.getOrchestrator(), nullptr);
}

TEST_F(AnOrchestrator, LetsGoOfAllBuildersWhenItCommits)
{
    Plain::Builder builder(model);
    Orchestrator orchestrator(&builder);
    Plain const made(new Plain::Impl(builder, UUID{}));
    made->notifyCreated();

    orchestrator.commit();

    EXPECT_EQ(builder.getOrchestrator(), nullptr);
    EXPECT_EQ(orchestrator.getCreatedElement(&builder).getImpl(), nullptr);
    EXPECT_EQ(made->getRefCount(), 2u);
    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
}

TEST_F(AnOrchestrator, ForgetsABuilderThatDies)
{
    Plain::Builder root(model);
    Orchestrator orchestrator(&root);
    {
        Plain::Builder early(model);
        orchestrator.addBuilder(&early);
        EXPECT_EQ(early.getOrchestrator(), &orchestrator);
    }

    orchestrator.commit();

    EXPECT_EQ(root.getOrchestrator(), nullptr);
}

TEST_F(AnOrchestrator, TakesAllBackWhenItIsDroppedUncommitted)
{
    Plain::Builder builder(model);
    Plain made;
    {
        Orchestrator orchestrator(&builder);
        made = Plain(new Plain::Impl(builder, uuidOf(1)));
        made->notifyCreated();
        EXPECT_TRUE(model->getCurrentTransaction());
    }

    EXPECT_FALSE(made);
    EXPECT_EQ(builder.getOrchestrator(), nullptr);
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
}

TEST_F(AnOrchestrator, OpensARevertibleTransaction)
{
    Plain::Builder builder(model);
    Plain const old = Plain::create(model);
    {
        Orchestrator const orchestrator(&builder);
        change(old, 4);
    }

    EXPECT_EQ(old->getValue(), 0);
}

TEST_F(AnOrchestrator, OpensItsTransactionBeforeItSeesThatTheModelIsFrozen)
{
    Plain::Builder builder(model);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Model::Freezer const freezer = model->freeze();

    EXPECT_RAISES_WITH(messages::ModelFrozen, Orchestrator{&builder});

    EXPECT_EQ(builder.getOrchestrator(), nullptr);
    EXPECT_TRUE(transaction.isRollBackOnly());
}

TEST_F(AnOrchestrator, AcceptsAThawedModel)
{
    Model::Freezer freezer = model->freeze();
    Model::Thawer const thawer = freezer.thaw();
    Plain::Builder builder(model);

    EXPECT_TRUE(builder.create());
}

// ---------------------------------------------------------------------------- proxies

TEST_F(ABuiltProxy, CarriesItsIdAndIsKnownToNoRegistry)
{
    Plain::Builder builder(model);
    ProxyId const id(ElementId::UUID_TYPE, u"some", ustring(u"file://x"));

    ModelElement const proxy = builder.createProxy(id);

    EXPECT_TRUE(proxy);
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(proxy->getValidity(), ElementImpl::ElementValidity::BuilderProxy);
    ASSERT_TRUE(proxy->getProxyId());
    EXPECT_EQ(*proxy->getProxyId(), id);
    EXPECT_EQ(proxy->getModel(), model);
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_THAT(model->getTopLevelElements(), IsEmpty());
    EXPECT_FALSE(model->findElement(proxy->getUuid()));
}

TEST_F(ABuiltProxy, OpensNoTransactionAndIsNotAnnounced)
{
    ScriptedListener listener;
    listen(model, listener);
    Model::Freezer const freezer = model->freeze();

    ModelElement const proxy = Plain::Builder(model).createProxy(ProxyId());

    EXPECT_TRUE(proxy);
    EXPECT_THAT(listener.committed, IsEmpty());
    model->removeListener(&listener);
}

TEST_F(ABuiltProxy, DiesWithItsLastHandle)
{
    ExpectNoLeakedElements const noLeaks;

    Plain::Builder(model).createProxy(ProxyId());
}
}  // namespace
