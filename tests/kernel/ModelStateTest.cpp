// When a model takes changes: frozen, parsed, loaded, or outside transactions.
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tests/kernel/ModelFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/Uuids.h"

#include <gmock/gmock.h>

#include <memory>
#include <utility>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::IsEmpty;

// ---------------------------------------------------------------------------- freezing

class AFrozenModel : public ModelFixture
{
protected:
    Plain const element = Plain::create(model, uuidOf(1));
};

TEST_F(AFrozenModel, RefusesEveryKindOfChange)
{
    Model::Freezer const freezer = model->freeze();

    EXPECT_TRUE(model->isFrozen());
    EXPECT_RAISES_WITH(messages::ModelFrozen, Plain::create(model));
    EXPECT_RAISES_WITH(messages::ModelFrozen, element->setValue(1));
    EXPECT_RAISES_WITH(messages::ModelFrozen, element->destroy());
    EXPECT_RAISES_WITH(messages::ModelFrozen, model->destroyAllContents());
    EXPECT_RAISES_WITH(messages::ModelFrozen, change(element, 1));
    EXPECT_EQ(element->getValue(), 0);
    EXPECT_TRUE(element);
    EXPECT_EQ(model->getElementCount(), 1u);
}

TEST_F(AFrozenModel, IsThawedEarlyByDeactivationOnce)
{
    Model::Freezer first = model->freeze();
    Model::Freezer const second = model->freeze();

    first.deactivate();
    first.deactivate();

    EXPECT_TRUE(model->isFrozen());
}

TEST_F(AFrozenModel, SurvivesTheAssignmentOfItsFreezerToItself)
{
    Model::Freezer freezer = model->freeze();
    Model::Freezer& same = freezer;

    freezer = std::move(same);

    EXPECT_TRUE(model->isFrozen());
}

TEST_F(AFrozenModel, IsKeptInMemoryByItsFreezer)
{
    auto freezer = std::make_unique<Model::Freezer>(Model::createTransientModel()->freeze());

    freezer.reset();  // would touch a model that is gone, did the freezer not hold it
}

TEST_F(AFrozenModel, CanBeThawedAgainAndAgain)
{
    Model::Freezer freezer = model->freeze();
    for (int value = 1; value < 4; ++value)
    {
        {
            Model::Thawer const thawer = freezer.thaw();
            element->setValue(value);
        }
        EXPECT_RAISES(messages::ModelFrozen, element->setValue(-1));
    }
    EXPECT_EQ(element->getValue(), 3);
}

TEST_F(AFrozenModel, IsFrozenByANewFreezerAfterOneDiedThawed)
{
    auto freezer = std::make_unique<Model::Freezer>(model->freeze());
    auto thawer = std::make_unique<Model::Thawer>(freezer->thaw());

    freezer.reset();
    EXPECT_FALSE(model->isFrozen());
    thawer.reset();
    EXPECT_FALSE(model->isFrozen());
    Model::Freezer const next = model->freeze();

    EXPECT_TRUE(model->isFrozen());
}

// ---------------------------------------------------------------------------- progress

TEST(AParseIndicator, CountsWhileItLives)
{
    Model const model = Model::create(ModelConstellation());
    EXPECT_FALSE(model->isParsing());
    {
        Model::ParseInProgressIndicator const outer = model->startParse();
        {
            Model::ParseInProgressIndicator const inner = model->startParse();
            EXPECT_TRUE(model->isParsing());
        }
        EXPECT_TRUE(model->isParsing());
    }
    EXPECT_FALSE(model->isParsing());
}

TEST(AParseIndicator, CountsOnceWhenItMoves)
{
    Model const model = Model::create(ModelConstellation());
    Model const other = Model::create(ModelConstellation());
    {
        Model::ParseInProgressIndicator first = model->startParse();
        Model::ParseInProgressIndicator second(std::move(first));
        EXPECT_TRUE(model->isParsing());
        Model::ParseInProgressIndicator third = other->startParse();
        third = std::move(second);
        EXPECT_TRUE(model->isParsing());
    }
    EXPECT_FALSE(model->isParsing());
    EXPECT_FALSE(other->isParsing());
}

TEST(AParseIndicator, OutlivesItsModel)
{
    Model model = Model::createTransientModel();
    Model::ParseInProgressIndicator const indicator = model->startParse();

    model->destroy();
    model = Model();
}

class ALoadingIndicator : public ModelFixture
{
protected:
    ALoadingIndicator() { listen(model, listener); }
    ~ALoadingIndicator() override { model->removeListener(&listener); }

    ScriptedListener listener;
};

TEST_F(ALoadingIndicator, CountsWhileItLivesAndOnceWhenItMoves)
{
    {
        Model::DataSourceLoadingInProgressIndicator outer = model->startDataSourceLoading();
        {
            Model::DataSourceLoadingInProgressIndicator const inner =
                model->startDataSourceLoading();
        }
        Model::DataSourceLoadingInProgressIndicator const moved(std::move(outer));
        EXPECT_TRUE(model->isDataSourceLoading());
    }
    EXPECT_FALSE(model->isDataSourceLoading());
}

TEST_F(ALoadingIndicator, HidesCreationChangeAndDestructionFromTheTransaction)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    {
        Model::DataSourceLoadingInProgressIndicator const loading = model->startDataSourceLoading();
        Plain const element = Plain::create(model);
        change(element, 1);
        Plain::create(model)->destroy();
        Plain::create(model)->setParent(element);
    }
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_THAT(listener.committed, IsEmpty());
    EXPECT_EQ(model->getElementCount(), 2u);
}

TEST_F(ALoadingIndicator, KeepsWhatWasLoadedWhenTheTransactionIsRolledBack)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain loaded;
    {
        Model::DataSourceLoadingInProgressIndicator const loading = model->startDataSourceLoading();
        loaded = Plain::create(model);
    }

    transaction.rollBack();

    EXPECT_TRUE(loaded);
    EXPECT_EQ(model->findElement(loaded->getUuid()), loaded);
}

// ---------------------------------------------------------------------------- outside transactions

TEST(AChangeWithoutATransaction, IsAllowedInALoneModelThatNobodyListensTo)
{
    for (Model const& model : {Model::create(ModelConstellation()), Model::createTransientModel(),
                               Model::createRegistryModel(u"registry://lone")})
    {
        Plain const element = Plain::create(model);
        change(element, 3);
        EXPECT_EQ(element->getValue(), 3);
        EXPECT_EQ(model->getCurrentTransaction(), nullptr);
    }
}

TEST(AChangeWithoutATransaction, IsRefusedWhereSomebodyListens)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    ScriptedListener listener;
    listen(model, listener, {.shallow = true});

    EXPECT_RAISES_WITH(messages::NoOpenTransaction, change(element, 1));
    EXPECT_RAISES_WITH(messages::NoOpenTransaction, Plain::create(model));
    model->removeListener(&listener);

    change(element, 1);
    EXPECT_EQ(element->getValue(), 1);
}

TEST(AChangeWithoutATransaction, IsRefusedInAConstellationOfSeveralModels)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    Model const second = Model::create(model->getModelConstellation());

    EXPECT_RAISES(messages::NoOpenTransaction, change(element, 1));
    EXPECT_RAISES(messages::NoOpenTransaction, Plain::create(second));
    second->destroy();

    change(element, 1);
    EXPECT_EQ(element->getValue(), 1);
}

TEST(AChangeWithoutATransaction, IsRefusedAsFrozenFirst)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    Model const second = Model::create(model->getModelConstellation());
    Model::Freezer const freezer = model->freeze();

    EXPECT_RAISES(messages::ModelFrozen, change(element, 1));
}
}  // namespace
