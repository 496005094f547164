#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tests/kernel/ListenerFixture.h"
#include "tests/support/ExpectRaises.h"

#include <gmock/gmock.h>

namespace {

using namespace testkit;
using testing::ElementsAre;

TEST_F(Listeners, AreToldPhaseByPhaseInTheOrderOfTheList)
{
    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_THAT(trace, ElementsAre("first prepare", "second prepare", "third prepare",
                                   "first validate", "second validate", "third validate",
                                   "first committed", "second committed", "third committed"));
}

TEST_F(Listeners, OfARollbackAreToldOfNothingElse)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    change(element, 1);
    transaction.rollBack();

    EXPECT_THAT(trace, ElementsAre("first rolledBack", "second rolledBack", "third rolledBack"));
}

TEST_F(Listeners, AreNotToldOfATransactionWithoutChanges)
{
    EXPECT_EQ(TransactionResult::Committed, model->beginTransaction(true).commit());

    EXPECT_TRUE(trace.empty());
}

TEST_F(Listeners, GetOnlyTheCallsThatTheyWant)
{
    Model const other = Model::createTransientModel();
    ScriptedListener prepares{"prepares", &trace};
    ScriptedListener validates{"validates", &trace};
    ScriptedListener notified{"notified", &trace};
    listen(other, prepares, Wants{.validate = false, .notify = false});
    listen(other, validates, Wants{.prepare = false, .notify = false});
    listen(other, notified, Wants{.prepare = false, .validate = false});
    {
        Transaction const transaction = other->beginTransaction(false);
        Plain::create(other);
        transaction.commit();
    }
    EXPECT_THAT(trace, ElementsAre("prepares prepare", "validates validate", "notified committed"));
    trace.clear();
    {
        Transaction const transaction = other->beginTransaction(false);
        Plain::create(other);
        transaction.rollBack();
    }
    EXPECT_THAT(trace, ElementsAre("notified rolledBack"));
    trace.clear();

    other->destroy();
    EXPECT_THAT(trace, ElementsAre("prepares removed", "validates removed", "notified removed"));
}

TEST_F(Listeners, AddedDuringATransactionHearOfTheNext)
{
    ScriptedListener late{"late", &trace};
    Transaction const transaction = model->beginTransaction(false);
    change(element, 1);
    listen(model, late);
    transaction.commit();

    EXPECT_TRUE(late.prepared.empty());
    EXPECT_TRUE(late.committed.empty());
    run(2);
    EXPECT_EQ(1u, late.committed.size());
}

TEST_F(Listeners, RemovedDuringATransactionHearNoMoreOfIt)
{
    Transaction const transaction = model->beginTransaction(false);
    change(element, 1);
    model->removeListener(&second);

    EXPECT_EQ(1, second.removals);
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    EXPECT_TRUE(second.prepared.empty());
    EXPECT_EQ(1u, third.committed.size());
}

TEST_F(Listeners, ThatAreOwnedAreDeletedWhenRemoved)
{
    struct Owned : ScriptedListener
    {
        explicit Owned(bool& deleted) : deleted(deleted) {}
        ~Owned() override { deleted = true; }
        bool& deleted;
    };
    bool deleted = false;
    bool toldBefore = false;
    auto* const owned = new Owned(deleted);
    owned->onRemoved = [&] { toldBefore = !deleted; };
    listen(model, *owned, Wants{.owned = true});

    model->removeListener(owned);

    EXPECT_TRUE(deleted);
    EXPECT_TRUE(toldBefore);
}

TEST_F(Listeners, UnknownToTheModelAreNotRemoved)
{
    ScriptedListener stranger;
    model->removeListener(&stranger);

    EXPECT_EQ(0, stranger.removals);
    EXPECT_FALSE(model->isListening(&stranger));
    EXPECT_TRUE(model->isListening(&first));
}

TEST_F(Listeners, OfADestroyedModelAreRemovedFirstAndHearNoReport)
{
    Transaction const transaction = model->beginTransaction(true);
    change(element, 1);
    trace.clear();

    model->destroy();

    EXPECT_THAT(trace, ElementsAre("first removed", "second removed", "third removed"));
    EXPECT_FALSE(element);
}

// ---------------------------------------------------------------------------- prepare

TEST_F(Listeners, ThatChangeTheModelWhilePreparingShowTheNextOnesAFreshReport)
{
    Plain created;
    second.onPrepare = [&](Report const&) { created = Plain::create(model); };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_THAT(first.prepared.at(0)->getCreated(), ElementsAre());
    EXPECT_EQ(first.prepared.at(0), second.prepared.at(0)) << "nothing changed in between";
    EXPECT_NE(second.prepared.at(0), third.prepared.at(0));
    EXPECT_THAT(third.prepared.at(0)->getCreated(), ElementsAre(created));
    EXPECT_THAT(first.committed.at(0)->getCreated(), ElementsAre(created));
}

TEST_F(Listeners, ThatThrowWhilePreparingCauseARollback)
{
    second.onPrepare = [](Report const&) { throw std::runtime_error("no"); };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
    EXPECT_THAT(trace, ElementsAre("first prepare", "second prepare", "first rolledBack",
                                   "second rolledBack", "third rolledBack"));
}

TEST_F(Listeners, ThatDropANestedTransactionWhilePreparingCauseARollback)
{
    second.onPrepare = [&](Report const&) { model->beginTransaction(false); };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(1u, third.prepared.size());
    EXPECT_TRUE(first.validated.empty());
    EXPECT_EQ(1u, first.rolledBack.size());
}

TEST_F(Listeners, ThatCommitANestedTransactionWhilePreparingDisturbNothing)
{
    TransactionResult inner = TransactionResult::Committed;
    second.onPrepare = [&](Report const&) {
        Transaction const nested = model->beginTransaction(true);
        change(element, 7);
        inner = nested.commit();
    };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_EQ(TransactionResult::NotCompleted, inner);
    EXPECT_EQ(7, element->getValue());
    EXPECT_EQ(1u, first.committed.size());
}

TEST_F(Listeners, ThatRollTheTransactionBackWhilePreparingCauseOneRollback)
{
    TransactionResult inner = TransactionResult::RolledBack;
    Transaction transaction;
    first.onPrepare = [&](Report const&) { inner = model->beginTransaction(true).rollBack(); };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(TransactionResult::NotCompleted, inner);
    EXPECT_EQ(1u, third.rolledBack.size());
    EXPECT_EQ(0, element->getValue());
}

// ---------------------------------------------------------------------------- validate

TEST_F(Listeners, ThatRefuseCauseARollbackAndEndTheValidation)
{
    second.onValidate = [](Report const&) { return false; };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
    EXPECT_TRUE(third.validated.empty());
    EXPECT_EQ(1u, third.rolledBack.size());
}

TEST_F(Listeners, ThatThrowWhileValidatingCauseARollback)
{
    second.onValidate = [](Report const&) -> bool { throw 5; };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
    EXPECT_TRUE(third.validated.empty());
}

TEST_F(Listeners, ThatLetTheFailureOfAChangeEscapeWhileValidatingCauseARollback)
{
    second.onValidate = [&](Report const&) {
        change(element, 9);
        return true;
    };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
}

TEST_F(Listeners, CannotChangeTheModelWhileValidating)
{
    second.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, change(element, 9));
        EXPECT_RAISES(messages::ChangesProhibited, Plain::create(model));
        EXPECT_RAISES(messages::ChangesProhibited, model->allElementsDestroying());
        EXPECT_RAISES(messages::ChangesProhibited, model->elementDestroying(element.getImpl()));
        return true;
    };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_EQ(1, element->getValue());
    EXPECT_EQ(1u, model->getElementCount());
}

TEST_F(Listeners, ThatFailInsideAnOperationThatOpensATransactionCauseARollbackThoughTheyCatchIt)
{
    second.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, element->destroy());
        return true;
    };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_TRUE(element);
    EXPECT_EQ(0, element->getValue());
}

TEST_F(Listeners, CannotDestroyAModelThatIsBeingValidated)
{
    second.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, model->destroy());
        EXPECT_RAISES(messages::ChangesProhibited, constellation->destroy());
        return true;
    };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_TRUE(model);
    EXPECT_EQ(1, element->getValue());
    EXPECT_EQ(1u, third.committed.size());
    EXPECT_EQ(0, first.removals);
}

TEST_F(Listeners, MayCreateAModelWhileValidatingWhichIsProhibitedFromChangesToo)
{
    Model created;
    second.onValidate = [&](Report const&) {
        created = Model::create(constellation);
        EXPECT_RAISES(messages::ChangesProhibited, Plain::create(created));
        return true;
    };
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    change(element, 1);

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    ASSERT_TRUE(created);
    EXPECT_EQ(nullptr, created->getCurrentTransaction());
}

TEST_F(Listeners, ThatDropANestedTransactionWhileValidatingCauseARollback)
{
    second.onValidate = [&](Report const&) {
        model->beginTransaction(false);
        return true;
    };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(0, element->getValue());
}

// ---------------------------------------------------------------------------- notify

TEST_F(Listeners, ThatThrowWhenNotifiedDisturbNobody)
{
    first.onCommitted = [](Report const&) { throw std::runtime_error("no"); };
    second.onCommitted = [](Report const&) { throw 5; };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_EQ(1u, third.committed.size());
    EXPECT_EQ(1, element->getValue());
}

TEST_F(Listeners, ThatThrowWhenToldOfARollbackDisturbNobody)
{
    first.onValidate = [](Report const&) { return false; };
    first.onRolledBack = [](bool, Report const&) { throw std::runtime_error("no"); };
    second.onRolledBack = [](bool, Report const&) { throw 5; };

    EXPECT_EQ(TransactionResult::RolledBack, run());

    EXPECT_EQ(1u, third.rolledBack.size());
}

TEST_F(Listeners, MayOpenATransactionWhenNotifiedWhichIsANewOne)
{
    first.onCommitted = [&](Report const&) {
        first.onCommitted = nullptr;
        Transaction const transaction = model->beginTransaction(false);
        change(element, 10);
        EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_EQ(10, element->getValue());
    EXPECT_EQ(2u, third.committed.size());
}

TEST_F(Listeners, NeedATransactionToChangeTheModelWhenNotified)
{
    first.onCommitted = [&](Report const&) {
        EXPECT_RAISES(messages::NoOpenTransaction, change(element, 5));
    };

    EXPECT_EQ(TransactionResult::Committed, run());
    EXPECT_EQ(1u, first.committed.size());
}

TEST_F(Listeners, FindTheModelFrozenWhenNotifiedIfItIsToBe)
{
    model->setFreezeOnNotify(true);
    first.onCommitted = [&](Report const&) {
        Transaction const transaction = model->beginTransaction(false);
        EXPECT_RAISES(messages::ModelFrozen, change(element, 5));
        EXPECT_TRUE(model->isFrozen());
    };

    EXPECT_EQ(TransactionResult::Committed, run());

    EXPECT_EQ(1, element->getValue());
    EXPECT_FALSE(model->isFrozen());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST_F(Listeners, FindTheModelFrozenWhenToldOfARollbackIfItIsToBe)
{
    model->setFreezeOnNotify(true);
    bool frozen = false;
    first.onRolledBack = [&](bool, Report const&) {
        frozen = model->isFrozen();
        throw std::runtime_error("no");
    };
    Transaction const transaction = model->beginTransaction(false);
    change(element, 5);
    transaction.rollBack();

    EXPECT_TRUE(frozen);
    EXPECT_FALSE(model->isFrozen());
}

TEST_F(Listeners, FindTheModelAsItWasWhenTheTransactionBegan)
{
    Transaction const transaction = model->beginTransaction(false);
    model->setFreezeOnNotify(true);
    first.onCommitted = [&](Report const&) { EXPECT_FALSE(model->isFrozen()); };
    change(element, 1);
    transaction.commit();

    EXPECT_EQ(1u, first.committed.size());
}

TEST_F(Listeners, MayChangeTheFreezeWhileTheyAreTold)
{
    model->setFreezeOnNotify(true);
    first.onCommitted = [&](Report const&) { model->setFreezeOnNotify(false); };

    run();

    EXPECT_FALSE(model->isFrozen());
}

TEST_F(Listeners, OfARollbackFindCreatedElementsDeadAndDestroyedOnesAlive)
{
    Plain created;
    std::vector<bool> alive;
    first.onRolledBack = [&](bool, Report const& report) {
        alive = {static_cast<bool>(report->getCreated().at(0)),
                 static_cast<bool>(report->getDestroyed().at(0))};
    };
    Transaction const transaction = model->beginTransaction(false);
    created = Plain::create(model);
    element->destroy();
    transaction.rollBack();

    EXPECT_THAT(alive, ElementsAre(false, true));
    EXPECT_THAT(first.rolledBack.at(0)->getCreated(), ElementsAre(created));
    EXPECT_THAT(first.rolledBack.at(0)->getDestroyed(), ElementsAre(element));
}
}  // namespace
