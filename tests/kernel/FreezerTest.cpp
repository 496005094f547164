#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;

class Freezing : public testing::Test
{
protected:
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
};

TEST_F(Freezing, RefusesChangesAndAllowsReads)
{
    Model::Freezer const freezer = model->freeze();

    EXPECT_TRUE(model->isFrozen());
    EXPECT_RAISES(messages::ModelFrozen, change(element, 1));
    EXPECT_RAISES(messages::ModelFrozen, Plain::create(model));
    EXPECT_RAISES(messages::ModelFrozen, element->destroy());
    EXPECT_RAISES(messages::ModelFrozen, model->allElementsDestroying());

    EXPECT_EQ(0, element->getValue());
    EXPECT_TRUE(element);
    EXPECT_EQ(1u, model->getElementCount());
}

TEST_F(Freezing, EndsWithTheFreezer)
{
    {
        Model::Freezer const freezer = model->freeze();
    }
    change(element, 1);
    EXPECT_EQ(1, element->getValue());
}

TEST_F(Freezing, AllowsATransactionToBeginAndEnd)
{
    Model::Freezer const freezer = model->freeze();
    Transaction const transaction = model->beginTransaction(true);

    EXPECT_RAISES(messages::ModelFrozen, change(element, 1));
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
}

TEST_F(Freezing, ComesBeforeTheMissingTransaction)
{
    ScriptedListener listener;
    listen(model, listener);
    Model::Freezer const freezer = model->freeze();

    EXPECT_RAISES(messages::ModelFrozen, change(element, 1));
}

TEST_F(Freezing, LastsUntilTheLastFreezerGoes)
{
    Model::Freezer first = model->freeze();
    Model::Freezer second = model->freeze();
    first.deactivate();
    EXPECT_TRUE(model->isFrozen());

    second.deactivate();
    EXPECT_FALSE(model->isFrozen());

    second.deactivate();
    EXPECT_FALSE(model->isFrozen());
}

TEST_F(Freezing, DoesNotHinderARollback)
{
    Transaction const transaction = model->beginTransaction(true);
    change(element, 1);
    Plain const created = Plain::create(model);
    Plain const parent = Plain::create(model);
    parent->addChild(element);
    Model::Freezer const freezer = model->freeze();

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());

    EXPECT_EQ(0, element->getValue());
    EXPECT_FALSE(created);
    EXPECT_TRUE(element->isTopLevel());
    EXPECT_TRUE(model->isFrozen());
    EXPECT_THAT(model->checkInvariants(), testing::IsEmpty());
}

TEST_F(Freezing, DoesNotHinderTheDestructionOfTheModel)
{
    Model::Freezer freezer = model->freeze();

    model->destroy();

    EXPECT_FALSE(model);
    freezer.deactivate();
}

TEST_F(Freezing, LeavesTheUriFree)
{
    Model const named = Model::create(ModelConstellation());
    Model::Freezer const freezer = named->freeze();

    named->setModelURI(u"test://named");

    EXPECT_EQ(u"test://named", named->getModelURI());
}

// ---------------------------------------------------------------------------- moves

TEST_F(Freezing, MovesWithItsFreezer)
{
    Model::Freezer first = model->freeze();
    {
        Model::Freezer const moved = std::move(first);
        first.deactivate();
        EXPECT_TRUE(model->isFrozen());
    }
    EXPECT_FALSE(model->isFrozen());
}

TEST_F(Freezing, EndsForTheTargetOfAnAssignment)
{
    Model const other = Model::createTransientModel();
    Model::Freezer target = model->freeze();

    target = other->freeze();

    EXPECT_FALSE(model->isFrozen());
    EXPECT_TRUE(other->isFrozen());
}

// ---------------------------------------------------------------------------- thawing

using Thawing = Freezing;

TEST_F(Thawing, AllowsChangesUntilTheThawerGoes)
{
    Model::Freezer freezer = model->freeze();
    {
        Model::Thawer const thawer = freezer.thaw();
        change(element, 1);
    }
    EXPECT_EQ(1, element->getValue());
    EXPECT_RAISES(messages::ModelFrozen, change(element, 2));
}

TEST_F(Thawing, LastsUntilTheLastOfItsThawersGoes)
{
    Model::Freezer freezer = model->freeze();
    Model::Thawer outer = freezer.thaw();
    {
        Model::Thawer const inner = freezer.thaw();
        EXPECT_FALSE(model->isFrozen());
    }
    EXPECT_FALSE(model->isFrozen());
    Model::Thawer other = freezer.thaw();
    outer.deactivate();
    EXPECT_FALSE(model->isFrozen());
    other.deactivate();
    EXPECT_TRUE(model->isFrozen());
    other.deactivate();
    EXPECT_TRUE(model->isFrozen());
}

TEST_F(Thawing, ConcernsOneFreezerOnly)
{
    Model::Freezer first = model->freeze();
    Model::Freezer second = model->freeze();
    Model::Thawer const thawer = first.thaw();

    EXPECT_RAISES(messages::ModelFrozen, change(element, 1));

    Model::Thawer const both = second.thaw();
    change(element, 2);
    EXPECT_EQ(2, element->getValue());
}

TEST_F(Thawing, FollowsItsFreezerWhenThatMoves)
{
    Model::Freezer first = model->freeze();
    Model::Thawer thawer = first.thaw();
    Model::Freezer const moved = std::move(first);

    thawer.deactivate();

    EXPECT_TRUE(model->isFrozen());
}

TEST_F(Thawing, MovesWithItsThawer)
{
    Model::Freezer freezer = model->freeze();
    Model::Thawer first = freezer.thaw();
    {
        Model::Thawer const moved = std::move(first);
        first.deactivate();
        EXPECT_FALSE(model->isFrozen());
    }
    EXPECT_TRUE(model->isFrozen());
}

TEST_F(Thawing, EndsForTheTargetOfAnAssignment)
{
    Model const other = Model::createTransientModel();
    Model::Freezer freezer = model->freeze();
    Model::Freezer otherFreezer = other->freeze();
    Model::Thawer target = freezer.thaw();

    target = otherFreezer.thaw();

    EXPECT_TRUE(model->isFrozen());
    EXPECT_FALSE(other->isFrozen());
}

TEST_F(Thawing, DoesNothingOnceItsFreezerHasGone)
{
    auto freezer = std::make_unique<Model::Freezer>(model->freeze());
    Model::Thawer outer = freezer->thaw();
    Model::Thawer inner = freezer->thaw();
    freezer.reset();
    EXPECT_FALSE(model->isFrozen());

    inner.deactivate();
    outer.deactivate();

    EXPECT_FALSE(model->isFrozen());
    change(element, 1);
    EXPECT_EQ(1, element->getValue());
}

TEST_F(Thawing, OfADeactivatedFreezerDoesNothing)
{
    Model::Freezer freezer = model->freeze();
    Model::Freezer const still = model->freeze();
    freezer.deactivate();

    Model::Thawer const thawer = freezer.thaw();

    EXPECT_TRUE(model->isFrozen());
}

// ---------------------------------------------------------------------------- loading

TEST(DataSourceLoading, KeepsChangesOutOfTheReportButNotOutOfTheModel)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(true);
    Plain loaded;
    {
        Model::DataSourceLoadingInProgressIndicator const loading = model->startDataSourceLoading();
        EXPECT_TRUE(model->isDataSourceLoading());
        loaded = Plain::create(model);
        change(loaded, 4);
    }
    EXPECT_FALSE(model->isDataSourceLoading());

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_TRUE(listener.committed.empty());
    EXPECT_EQ(4, loaded->getValue());
    EXPECT_EQ(1u, model->getElementCount());
}

TEST(DataSourceLoading, IsRefusedByAFrozenModelAndWithoutATransaction)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Model::DataSourceLoadingInProgressIndicator const loading = model->startDataSourceLoading();

    EXPECT_RAISES(messages::NoOpenTransaction, Plain::create(model));
    Model::Freezer const freezer = model->freeze();
    EXPECT_RAISES(messages::ModelFrozen, Plain::create(model));
}

TEST(DataSourceLoading, LastsUntilTheLastIndicatorGoes)
{
    Model const model = Model::createTransientModel();
    {
        Model::DataSourceLoadingInProgressIndicator first = model->startDataSourceLoading();
        {
            Model::DataSourceLoadingInProgressIndicator const second =
                model->startDataSourceLoading();
            Model::DataSourceLoadingInProgressIndicator const moved = std::move(first);
        }
        EXPECT_FALSE(model->isDataSourceLoading());
    }
    EXPECT_FALSE(model->isDataSourceLoading());
}
}  // namespace
