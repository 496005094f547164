#include "tarnkiln/kernel/Transaction.h"

#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;

// A model outside all constellations hands out its transaction itself, others a nested one.

TEST(Transaction, OfNoListenerAndNoCallbackCommitsAndRecordsNothing)
{
    Model const model = Model::createTransientModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain const element = Plain::create(model);

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_TRUE(element);
    EXPECT_THAT(model->getTopLevelElements(), testing::ElementsAre(element));
}

TEST(Transaction, ThatRecordedNothingCannotBeUndone)
{
    Model const model = Model::createTransientModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain const element = Plain::create(model);

    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());

    EXPECT_TRUE(element);
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST(Transaction, OfAShallowModelKeepsItsChangesInARollbackAndListenersHearOfIt)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});
    Plain element;
    {
        Transaction const setUp = model->beginTransaction(/*revertible=*/false);
        element = Plain::create(model);
        setUp.commit();
    }
    bool heardDeep = true;
    listener.onRolledBack = [&](bool deep, Report const&) { heardDeep = deep; };
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    change(element, 5);

    EXPECT_EQ(TransactionResult::NotRevertible, transaction.rollBack());

    EXPECT_EQ(5, element->getValue());
    ASSERT_EQ(1u, listener.rolledBack.size());
    EXPECT_FALSE(heardDeep);
    EXPECT_THAT(listener.rolledBack[0]->getChanged(), testing::ElementsAre(element));
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST(Transaction, WithoutChangesRollsBackWithoutResult)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());

    EXPECT_TRUE(listener.rolledBack.empty());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST(Transaction, ThatIsRevertibleTakesItsChangesBack)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    change(element, 1);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    change(element, 2);
    change(element, 3);

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());

    EXPECT_EQ(1, element->getValue());
}

TEST(Transaction, CommittedTwiceAnswersNothingTheSecondTime)
{
    Model const model = Model::createTransientModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());
}

TEST(Transaction, RolledBackAnswersNothingToAnyFurtherCall)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    change(element, 2);

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.commit());
}

TEST(Transaction, CopiedWaitsForTheCommitOfEachCopy)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    Transaction const first = model->beginTransaction(/*revertible=*/true);
    Transaction const second = first;
    change(element, 2);

    EXPECT_EQ(TransactionResult::NotCompleted, first.commit());
    EXPECT_NE(nullptr, model->getCurrentTransaction());
    EXPECT_EQ(TransactionResult::Committed, second.commit());

    EXPECT_EQ(nullptr, model->getCurrentTransaction());
    EXPECT_EQ(2, element->getValue());
}

TEST(Transaction, CopiedCountsEachCommitThroughWhicheverCopy)
{
    Model const model = Model::createTransientModel();
    Transaction const first = model->beginTransaction(/*revertible=*/true);
    Transaction const second = first;

    EXPECT_EQ(TransactionResult::NotCompleted, first.commit());
    EXPECT_EQ(TransactionResult::Committed, first.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, second.commit());
}

TEST(Transaction, StaysPendingWhenTheOtherCopyIsDroppedAndRollsBackWithTheLast)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    change(element, 1);
    Transaction last = model->beginTransaction(/*revertible=*/true);
    {
        Transaction const dropped = last;
        change(element, 2);
        EXPECT_EQ(TransactionResult::NotCompleted, last.commit());
    }
    EXPECT_NE(nullptr, model->getCurrentTransaction());
    EXPECT_EQ(2, element->getValue());

    last = Transaction();

    EXPECT_EQ(nullptr, model->getCurrentTransaction());
    EXPECT_EQ(1, element->getValue());
}

TEST(Transaction, DroppedUncommittedIsRolledBack)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    ScriptedListener listener;
    listen(model, listener);
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        change(element, 2);
    }

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(1u, listener.rolledBack.size());
    EXPECT_TRUE(listener.prepared.empty());
    EXPECT_TRUE(listener.validated.empty());
}

TEST(Transaction, DroppedShallowKeepsItsChanges)
{
    Model const model = Model::createTransientModel();
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        Plain::create(model);
    }

    EXPECT_EQ(1u, model->getElementCount());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST(Transaction, OfAModelInAConstellationSharesItsCommitAmongCopies)
{
    Model const model = Model::create(ModelConstellation());
    Transaction const first = model->beginTransaction(/*revertible=*/true);
    Transaction const second = first;

    EXPECT_EQ(TransactionResult::Committed, first.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, second.commit());
}

TEST(Transaction, OfAModelInAConstellationIsRolledBackWithItsLastHandle)
{
    Model const model = Model::create(ModelConstellation());
    Plain const element = Plain::create(model);
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        change(element, 4);
    }

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST(Transaction, KeepsItsModelUntilItsLastHandleGoes)
{
    Transaction transaction;
    Plain element;
    {
        Model const model = Model::createTransientModel();
        element = Plain::create(model);
        transaction = model->beginTransaction(/*revertible=*/true);
    }
    EXPECT_TRUE(element);

    transaction.commit();
    transaction = Transaction();

    EXPECT_FALSE(element);
}

TEST(Transaction, KeepsTheWholeConstellationWhileItIsOpen)
{
    Transaction transaction;
    Plain element;
    {
        Model const model = Model::create(ModelConstellation());
        element = Plain::create(model);
        transaction = model->beginTransaction(/*revertible=*/true);
    }
    EXPECT_TRUE(element);

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    transaction = Transaction();

    EXPECT_FALSE(element);
}

// ---------------------------------------------------------------------------- beginning

TEST(Transaction, CannotBeginOnADeadModel)
{
    Model const model = Model::create(ModelConstellation());
    model->destroy();

    EXPECT_RAISES(messages::ModelFrozen, model->beginTransaction(/*revertible=*/true));
    EXPECT_RAISES(messages::ModelFrozen, model->beginTransaction(/*revertible=*/false));
}

TEST(Transaction, OfADefaultBeginIsShallowWithoutADeepListener)
{
    Model const model = Model::create(ModelConstellation());
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});

    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);
    transaction.commit();

    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_FALSE(listener.committed[0]->isDeep());
}

TEST(Transaction, OfADefaultBeginIsDeepOnceADeepListenerIsThere)
{
    Model const model = Model::create(ModelConstellation());
    ScriptedListener shallow;
    ScriptedListener deep;
    listen(model, shallow, Wants{.shallow = true});
    listen(model, deep);

    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);
    transaction.commit();

    ASSERT_EQ(1u, shallow.committed.size());
    EXPECT_TRUE(shallow.committed[0]->isDeep());
}

TEST(Transaction, OfADefaultBeginIsShallowAgainWhenTheDeepListenerHasGone)
{
    Model const model = Model::create(ModelConstellation());
    ScriptedListener shallow;
    ScriptedListener deep;
    listen(model, shallow, Wants{.shallow = true});
    listen(model, deep);
    model->beginTransaction(/*revertible=*/false).commit();
    model->removeListener(&deep);

    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);
    transaction.commit();

    ASSERT_EQ(1u, shallow.committed.size());
    EXPECT_FALSE(shallow.committed[0]->isDeep());
}

TEST(Transaction, ThatIsRevertibleIsDeepWhoeverListens)
{
    Model const model = Model::create(ModelConstellation());
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});

    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain::create(model);
    transaction.commit();

    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_TRUE(listener.committed[0]->isDeep());
}

// ---------------------------------------------------------------------------- what needs one

TEST(Transaction, IsNotNeededOnALoneModelThatNobodyListensTo)
{
    Model const lone = Model::create(ModelConstellation());
    Model const transient = Model::createTransientModel();

    Plain const inLone = Plain::create(lone);
    Plain const inTransient = Plain::create(transient);
    change(inLone, 1);
    change(inTransient, 2);

    EXPECT_EQ(1, inLone->getValue());
    EXPECT_EQ(2, inTransient->getValue());
}

TEST(Transaction, IsNeededAsSoonAsSomeoneListens)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true, .prepare = false, .validate = false});

    EXPECT_RAISES(messages::NoOpenTransaction, change(element, 1));
    EXPECT_RAISES(messages::NoOpenTransaction, Plain::create(model));
    EXPECT_RAISES(messages::NoOpenTransaction, model->elementDestroying(element.getImpl()));
    EXPECT_RAISES(messages::NoOpenTransaction, model->allElementsDestroying());

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(1u, model->getElementCount());
}

TEST(Transaction, IsNeededInAConstellationOfSeveralModels)
{
    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Plain const element = Plain::create(model);
    Model const other = Model::create(constellation);

    EXPECT_RAISES(messages::NoOpenTransaction, change(element, 1));
    EXPECT_RAISES(messages::NoOpenTransaction, Plain::create(other));

    other->destroy();
    change(element, 1);
    EXPECT_EQ(1, element->getValue());
}

TEST(Transaction, LeavesChangesOfIndexZeroUnrecorded)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);

    element->notifyModifying(0);
    transaction.commit();

    EXPECT_TRUE(listener.committed.empty());
}

TEST(Transaction, LeavesElementsUnderConstructionUnrecorded)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Plain const unannounced(new Plain::Impl(model, UUID{}));

    change(unannounced, 7);

    EXPECT_EQ(7, unannounced->getValue());
}

// ---------------------------------------------------------------------------- all elements

TEST(Transaction, RefusesCreationAfterAllElementsWereDestroyed)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    model->destroyAllContents();

    EXPECT_RAISES(messages::CreateWithDestroyAll, Plain::create(model));

    EXPECT_EQ(0u, model->getElementCount());
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
}

TEST(Transaction, ThatRecordsNothingAllowsCreationAfterAllElementsWereDestroyed)
{
    Model const model = Model::createTransientModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    model->destroyAllContents();

    EXPECT_TRUE(Plain::create(model));
}

// ---------------------------------------------------------------------------- messages

TEST(Transaction, HandsItsMessageToTheReportsOfAllPhases)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);

    transaction.commit(u"done");

    for (auto const* reports : {&listener.prepared, &listener.validated, &listener.committed})
    {
        ASSERT_EQ(1u, reports->size());
        ASSERT_TRUE((*reports)[0]->getMessage());
        EXPECT_EQ(u"done", (*reports)[0]->getMessage()->getValue<ustring>());
    }
}

TEST(Transaction, HandsATextOfBytesOverAsOne)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);

    transaction.commit("done");

    ASSERT_EQ(1u, listener.committed.size());
    ASSERT_TRUE(listener.committed[0]->getMessage());
    EXPECT_EQ("done", listener.committed[0]->getMessage()->getValue<string>());
}

TEST(Transaction, ReportsOnlyTheMessageOfTheCommitThatEndsIt)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const first = model->beginTransaction(/*revertible=*/false);
    Transaction const second = first;
    Plain::create(model);

    first.commit(u"lost");
    second.commit(u"kept");

    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_EQ(u"kept", listener.committed[0]->getMessage()->getValue<ustring>());
}

TEST(Transaction, ReportsNoMessageOfARollback)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    listener.onValidate = [](Report const&) { return false; };
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Plain::create(model);

    EXPECT_EQ(TransactionResult::RolledBack, transaction.commit(u"refused"));

    ASSERT_EQ(1u, listener.rolledBack.size());
    EXPECT_FALSE(listener.rolledBack[0]->getMessage());
}

// ---------------------------------------------------------------------------- handles

TEST(TransactionHandle, IsTrueExactlyWhenItHoldsATransaction)
{
    Model const model = Model::createTransientModel();
    Transaction transaction = model->beginTransaction(/*revertible=*/true);

    EXPECT_FALSE(Transaction());
    EXPECT_TRUE(transaction);
    EXPECT_EQ(1u, transaction->getHandleCount());

    Transaction const copy = transaction;
    EXPECT_EQ(2u, transaction->getHandleCount());
    Transaction const moved = std::move(transaction);
    EXPECT_FALSE(transaction);
    EXPECT_EQ(2u, moved->getHandleCount());
    EXPECT_EQ(copy.getImpl(), moved.getImpl());
}

TEST(TransactionHandle, TellsWhetherItCanOnlyBeRolledBack)
{
    Model const model = Model::createTransientModel();
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    EXPECT_FALSE(transaction.isRollBackOnly());

    model->beginTransaction(/*revertible=*/true).rollBack();

    EXPECT_TRUE(transaction.isRollBackOnly());
}
}  // namespace
