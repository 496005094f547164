#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;

/// The same for a model that hands out its transaction itself and for one in a constellation.
class NestedTransaction : public testing::TestWithParam<bool>
{
protected:
    Model const model =
        GetParam() ? Model::create(ModelConstellation()) : Model::createTransientModel();
    Plain const element = Plain::create(model);
};

INSTANTIATE_TEST_SUITE_P(Alone, NestedTransaction, testing::Values(false));
INSTANTIATE_TEST_SUITE_P(InAConstellation, NestedTransaction, testing::Values(true));

TEST_P(NestedTransaction, CommitsNothingByItselfAndTheOuterOneCommits)
{
    ScriptedListener listener;
    listen(model, listener);
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    {
        Transaction const inner = model->beginTransaction(/*revertible=*/true);
        change(element, 1);
        EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());
    }
    EXPECT_TRUE(listener.committed.empty());

    EXPECT_EQ(TransactionResult::Committed, outer.commit());

    EXPECT_EQ(1u, listener.committed.size());
    EXPECT_EQ(1, element->getValue());
}

TEST_P(NestedTransaction, DroppedUncommittedDoomsTheOuterOne)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    change(element, 1);
    {
        Transaction const inner = model->beginTransaction(/*revertible=*/true);
        change(element, 2);
    }
    EXPECT_TRUE(outer.isRollBackOnly());
    EXPECT_EQ(2, element->getValue());

    EXPECT_EQ(TransactionResult::RolledBack, outer.commit());

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST_P(NestedTransaction, RolledBackDoomsTheOuterOneAndWaitsForIt)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 2);

    EXPECT_EQ(TransactionResult::NotCompleted, inner.rollBack());
    EXPECT_EQ(2, element->getValue());
    EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());

    EXPECT_EQ(TransactionResult::RolledBack, outer.commit());
    EXPECT_EQ(0, element->getValue());
}

TEST_P(NestedTransaction, TakesTheDepthOfTheOuterOne)
{
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});
    Transaction const outer = model->beginTransaction(/*revertible=*/false);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 2);
    inner.commit();

    EXPECT_EQ(TransactionResult::Committed, outer.commit());

    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_FALSE(listener.committed[0]->isDeep());
}

TEST_P(NestedTransaction, SharesItsCommitAmongCopies)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    Transaction const copy = inner;

    EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, copy.rollBack());

    EXPECT_FALSE(outer.isRollBackOnly());
    EXPECT_EQ(TransactionResult::Committed, outer.commit());
}

TEST_P(NestedTransaction, IsCommittedByTheOuterOneWhileItIsStillHeld)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    EXPECT_EQ(TransactionResult::NotCompleted, outer.commit());
    EXPECT_EQ(TransactionResult::Committed, inner.commit());

    EXPECT_EQ(3, element->getValue());
}

TEST_P(NestedTransaction, ReportsTheOutermostMessageOnly)
{
    ScriptedListener listener;
    listen(model, listener);
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    inner.commit(u"inner");
    outer.commit(u"outer");

    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_EQ(u"outer", listener.committed[0]->getMessage()->getValue<ustring>());
}

TEST_P(NestedTransaction, HasTheOriginOfTheOuterOne)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);

    EXPECT_EQ(outer->getOrigin(), inner->getOrigin());
}

TEST_P(NestedTransaction, AnswersNothingOnceTheOuterOneHasEnded)
{
    Transaction outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);
    model->destroy();

    EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, outer.commit());
}

TEST_P(NestedTransaction, OfThreeLevelsCommitsWithTheOutermost)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    {
        Transaction const middle = model->beginTransaction(/*revertible=*/true);
        {
            Transaction const inner = model->beginTransaction(/*revertible=*/true);
            change(element, 3);
            EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());
        }
        EXPECT_EQ(TransactionResult::NotCompleted, middle.commit());
    }
    EXPECT_EQ(TransactionResult::Committed, outer.commit());
    EXPECT_EQ(3, element->getValue());
}

TEST_P(NestedTransaction, ReplacesTheFirstChangeCallbackOfTheOuterOneUntilItIsDone)
{
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    std::string heard;
    outer.addFirstChangeCallback([&] { heard += "outer"; });
    inner.addFirstChangeCallback([&] { heard += "inner"; });
    inner.commit();
    inner.addFirstChangeCallback([&] { heard += "too late"; });

    change(element, 3);

    EXPECT_EQ("inner", heard);
    outer.commit();
}

TEST_P(NestedTransaction, LeavesTheModelUsableAfterAFailedCreation)
{
    UUID const id = ElementImpl::generateNewUuid();
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Plain const first = Plain::create(model, id);

    EXPECT_RAISES(messages::UUIDConflict, Plain::create(model, id));

    EXPECT_FALSE(outer.isRollBackOnly());
    EXPECT_EQ(TransactionResult::Committed, outer.commit());
    EXPECT_EQ(first, Plain::cast(model->findElement(id)));
}

// A handle on the transaction itself and one on a nested transaction differ when they are dropped.

TEST(NestedTransactionOfALoneModel, CommitsAllWhenTheOuterHandleWasDropped)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    Transaction outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    outer = Transaction();
    EXPECT_FALSE(inner.isRollBackOnly());

    EXPECT_EQ(TransactionResult::Committed, inner.commit());
    EXPECT_EQ(3, element->getValue());
}

TEST(NestedTransactionInAConstellation, IsDoomedWhenTheOuterHandleWasDropped)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    Transaction outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    outer = Transaction();
    EXPECT_TRUE(inner.isRollBackOnly());
    EXPECT_EQ(3, element->getValue());

    EXPECT_EQ(TransactionResult::RolledBack, inner.commit());
    EXPECT_EQ(0, element->getValue());
}

TEST(NestedTransactionInAConstellation, RollsBackAtOnceWhenNobodyElseHoldsOne)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    Transaction const only = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    EXPECT_EQ(TransactionResult::RolledBack, only.rollBack());
    EXPECT_EQ(0, element->getValue());
}

TEST(NestedTransactionOfALoneModel, LetsTheTransactionItselfRollBackAtOnce)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    Transaction const outer = model->beginTransaction(/*revertible=*/true);
    Transaction const inner = model->beginTransaction(/*revertible=*/true);
    change(element, 3);

    EXPECT_EQ(TransactionResult::RolledBack, outer.rollBack());

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(TransactionResult::NotCompleted, inner.commit());
}
}  // namespace
