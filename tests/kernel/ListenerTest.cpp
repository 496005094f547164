#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/support/Deferred.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

#include <array>

namespace {

using namespace testkit;
using testing::ElementsAre;

/// A model with an element and three listeners for everything, on which transactions run.
class Listeners : public testing::Test
{
protected:
    Listeners()
    {
        element = Plain::create(model);
        for (ScriptedListener* const listener : {&first, &second, &third})
            listen(model, *listener);
    }

    /// Changes the element in a transaction of its own.
    TransactionResult run(int value = 1)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        change(element, value);
        return transaction.commit();
    }

    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Plain element;
    Trace trace;
    ScriptedListener first{"first", &trace};
    ScriptedListener second{"second", &trace};
    ScriptedListener third{"third", &trace};
};

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

// ---------------------------------------------------------------------------- in every phase

enum class Phase
{
    Prepare,
    Validate,
    Committed,
    RolledBack
};

void PrintTo(Phase phase, std::ostream* out)
{
    *out << std::array{"Prepare", "Validate", "Committed", "RolledBack"}[std::size_t(phase)];
}

/// What a listener may do in any phase.
class ListenersInAnyPhase : public Listeners, public testing::WithParamInterface<Phase>
{
protected:
    /// Lets `listener` do something in the phase, once.
    void in(ScriptedListener& listener, std::function<void()> action)
    {
        auto const once = [&listener, action = std::move(action)] {
            listener.onPrepare = listener.onCommitted = nullptr;
            listener.onValidate = nullptr;
            listener.onRolledBack = nullptr;
            action();
        };
        switch (GetParam())
        {
        case Phase::Prepare:
            listener.onPrepare = [=](Report const&) { once(); };
            break;
        case Phase::Validate:
            listener.onValidate = [=](Report const&) {
                once();
                return true;
            };
            break;
        case Phase::Committed:
            listener.onCommitted = [=](Report const&) { once(); };
            break;
        case Phase::RolledBack:
            listener.onRolledBack = [=](bool, Report const&) { once(); };
            break;
        }
    }
    /// Changes the element and ends the transaction as the phase needs it.
    TransactionResult runToPhase(int value = 1)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        change(element, value);
        return GetParam() == Phase::RolledBack ? transaction.rollBack() : transaction.commit();
    }
    TransactionResult usual() const
    {
        return GetParam() == Phase::RolledBack ? TransactionResult::RolledBack
                                               : TransactionResult::Committed;
    }
    /// The reports that a listener got in the phase.
    std::vector<Report> const& told(ScriptedListener const& listener) const
    {
        return GetParam() == Phase::Prepare     ? listener.prepared
               : GetParam() == Phase::Validate  ? listener.validated
               : GetParam() == Phase::Committed ? listener.committed
                                                : listener.rolledBack;
    }
};

INSTANTIATE_TEST_SUITE_P(Phases, ListenersInAnyPhase,
                         testing::Values(Phase::Prepare, Phase::Validate, Phase::Committed,
                                         Phase::RolledBack),
                         testing::PrintToStringParamName());

TEST_P(ListenersInAnyPhase, MayRemoveThemselvesAndLaterOnesAreToldAllTheSame)
{
    in(second, [&] { model->removeListener(&second); });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1, second.removals);
    EXPECT_EQ(1u, told(second).size());
    EXPECT_EQ(1u, told(third).size());
    EXPECT_FALSE(model->isListening(&second));
}

TEST_P(ListenersInAnyPhase, MayRemoveALaterOneWhichIsToldNoMore)
{
    in(first, [&] { model->removeListener(&third); });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1, third.removals);
    EXPECT_TRUE(told(third).empty());
    EXPECT_EQ(1u, told(second).size());
}

TEST_P(ListenersInAnyPhase, MayRemoveAnEarlierOne)
{
    in(third, [&] { model->removeListener(&first); });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1, first.removals);
    EXPECT_EQ(1u, told(second).size());
}

TEST_P(ListenersInAnyPhase, MayRemoveAllOfThem)
{
    in(first, [&] {
        for (ScriptedListener* const listener : {&first, &second, &third})
            model->removeListener(listener);
    });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_FALSE(model->hasListeners());
    EXPECT_TRUE(told(second).empty());
}

TEST_P(ListenersInAnyPhase, MayAddOneWhichHearsOfTheNextTransaction)
{
    ScriptedListener late;
    in(first, [&] { listen(model, late); });

    EXPECT_EQ(usual(), runToPhase());
    EXPECT_TRUE(told(late).empty());

    runToPhase(2);
    EXPECT_EQ(1u, told(late).size());
}

TEST_P(ListenersInAnyPhase, MayRemoveAndAddThemselvesAgain)
{
    in(second, [&] {
        model->removeListener(&second);
        listen(model, second);
    });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1u, told(second).size());
    runToPhase(2);
    EXPECT_EQ(2u, told(second).size());
}

TEST_P(ListenersInAnyPhase, MayOpenAndCommitATransaction)
{
    in(second, [&] { model->beginTransaction(false).commit(); });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1u, told(third).size());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());
}

TEST_P(ListenersInAnyPhase, MayDropTheLastHandleOfTheTransaction)
{
    Model const lone = Model::createTransientModel();
    ScriptedListener listener;
    ScriptedListener later;
    listen(lone, listener);
    listen(lone, later);
    for (Model const& each : {model, lone})
    {
        auto transaction = std::make_unique<Transaction>(each->beginTransaction(true));
        AbstractTransactionImpl* const impl = transaction->getImpl();
        in(each == lone ? listener : first, [&] { transaction.reset(); });
        if (each == lone)
            Plain::create(lone);
        else
            change(element, 1);

        TransactionResult const result =
            GetParam() == Phase::RolledBack ? impl->rollBack() : impl->commit(boost::none);

        EXPECT_EQ(usual(), result);
        EXPECT_EQ(nullptr, each->getCurrentTransaction());
        EXPECT_EQ(nullptr, transaction);
    }
    EXPECT_EQ(1u, told(later).size());
}

TEST_P(ListenersInAnyPhase, MayFreezeTheModelForGood)
{
    std::unique_ptr<Model::Freezer> freezer;
    in(first, [&] { freezer = std::make_unique<Model::Freezer>(model->freeze()); });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_EQ(1u, told(third).size());
    EXPECT_TRUE(model->isFrozen());
}

TEST_P(ListenersInAnyPhase, MayCreateAModelInTheConstellation)
{
    Model created;
    in(second, [&] { created = Model::create(constellation); });

    EXPECT_EQ(usual(), runToPhase());

    ASSERT_TRUE(created);
    EXPECT_EQ(nullptr, created->getCurrentTransaction());
    EXPECT_EQ(nullptr, constellation->getTransactionGroup());
    Transaction const next = created->beginTransaction(false);
    Plain const inCreated = Plain::create(created);
    EXPECT_EQ(TransactionResult::Committed, next.commit());
    EXPECT_TRUE(inCreated);
}

TEST_P(ListenersInAnyPhase, MayTouchNothingOfAReportAndKeepItAfterTheModel)
{
    EXPECT_EQ(usual(), runToPhase());
    Report const kept = told(third).at(0);
    model->destroy();

    EXPECT_THAT(kept->getChanged(), ElementsAre(element));
    EXPECT_FALSE(kept->getChanged().at(0));
    EXPECT_FALSE(kept->isEmpty());
}

/// Destroys things where that is allowed: everywhere but in a validation.
class ListenersThatDestroy : public ListenersInAnyPhase
{};

INSTANTIATE_TEST_SUITE_P(Phases, ListenersThatDestroy,
                         testing::Values(Phase::Prepare, Phase::Committed, Phase::RolledBack),
                         testing::PrintToStringParamName());

TEST_P(ListenersThatDestroy, MayDestroyTheirModel)
{
    in(second, [&] { model->destroy(); });

    runToPhase();

    EXPECT_FALSE(model);
    EXPECT_FALSE(element);
    EXPECT_EQ(1, first.removals);
    EXPECT_EQ(1, third.removals);
    EXPECT_TRUE(told(third).empty());
    EXPECT_EQ(nullptr, constellation->getTransactionGroup());
}

TEST_P(ListenersThatDestroy, MayDestroyALoneModel)
{
    Model const lone = Model::createTransientModel();
    ScriptedListener listener;
    ScriptedListener later;
    listen(lone, listener);
    listen(lone, later);
    in(listener, [&] { lone->destroy(); });
    bool ran = false;
    {
        Transaction const transaction = lone->beginTransaction(true);
        Plain::create(lone);
        transaction.eventEmitted(deferred([&] { ran = true; }));
        if (GetParam() == Phase::RolledBack)
            transaction.rollBack();
        else
            transaction.commit();
    }

    EXPECT_FALSE(lone);
    EXPECT_TRUE(told(later).empty());
    EXPECT_EQ(GetParam() == Phase::Committed, ran);
}

TEST_P(ListenersThatDestroy, MayDestroyTheConstellation)
{
    in(second, [&] { constellation->destroy(); });

    runToPhase();

    EXPECT_FALSE(constellation);
    EXPECT_FALSE(model);
    EXPECT_TRUE(told(third).empty());
}

TEST_P(ListenersThatDestroy, MayDestroyAnotherModelWhoseListenersAreNotToldAnyMore)
{
    Model const other = Model::create(constellation);
    other->setModelURI(u"test://later");
    model->setModelURI(u"test://earlier");
    ScriptedListener ofOther;
    Plain inOther;
    {
        Transaction const setUp = model->beginTransaction(false);
        inOther = Plain::create(other);
        setUp.commit();
    }
    listen(other, ofOther);
    for (ScriptedListener* const listener : {&first, &second, &third})
        listener->prepared = listener->committed = listener->rolledBack = {};
    in(first, [&] { other->destroy(); });
    {
        Transaction const transaction = model->beginTransaction(true);
        change(element, 1);
        change(inOther, 1);
        EXPECT_EQ(usual(),
                  GetParam() == Phase::RolledBack ? transaction.rollBack() : transaction.commit());
    }

    EXPECT_FALSE(other);
    EXPECT_EQ(1, ofOther.removals);
    EXPECT_TRUE(told(ofOther).empty());
    EXPECT_EQ(1u, told(third).size());
    EXPECT_EQ(nullptr, constellation->getTransactionGroup());
}

TEST_P(ListenersThatDestroy, MayRemoveAListenerOfAnotherModelThatIsStillToBeTold)
{
    Model const other = Model::create(constellation);
    other->setModelURI(u"test://later");
    model->setModelURI(u"test://earlier");
    auto ofOther = std::make_unique<ScriptedListener>();
    ScriptedListener stays;
    Plain inOther;
    {
        Transaction const setUp = model->beginTransaction(false);
        inOther = Plain::create(other);
        setUp.commit();
    }
    listen(other, *ofOther);
    listen(other, stays);
    in(first, [&] {
        other->removeListener(ofOther.get());
        ofOther.reset();
    });
    {
        Transaction const transaction = model->beginTransaction(true);
        change(element, 1);
        change(inOther, 1);
        EXPECT_EQ(usual(),
                  GetParam() == Phase::RolledBack ? transaction.rollBack() : transaction.commit());
    }

    EXPECT_EQ(nullptr, ofOther);
    EXPECT_EQ(1u, told(stays).size());
}

TEST_P(ListenersThatDestroy, MayDestroyTheFirstOfThreeModelsAndNoneOfTheOthersIsLeftOut)
{
    Model const second2 = Model::create(constellation);
    Model const third3 = Model::create(constellation);
    model->setModelURI(u"test://1");
    second2->setModelURI(u"test://2");
    third3->setModelURI(u"test://3");
    ScriptedListener ofSecond;
    ScriptedListener ofThird;
    Transaction const transaction = third3->beginTransaction(true);
    Plain const inSecond = Plain::create(second2);
    Plain const inThird = Plain::create(third3);
    transaction.commit();
    listen(second2, ofSecond);
    listen(third3, ofThird);
    in(first, [&] { model->destroy(); });
    {
        Transaction const next = third3->beginTransaction(true);
        change(element, 1);
        change(inSecond, 2);
        change(inThird, 3);
        EXPECT_EQ(usual(), GetParam() == Phase::RolledBack ? next.rollBack() : next.commit());
    }

    EXPECT_FALSE(model);
    EXPECT_EQ(1u, told(ofSecond).size());
    EXPECT_EQ(1u, told(ofThird).size());
}

TEST_P(ListenersThatDestroy, MayCreateAndDestroyElements)
{
    Plain created;
    in(second, [&] {
        Transaction const transaction = model->beginTransaction(false);
        created = Plain::create(model);
        element->destroy();
        transaction.commit();
    });

    EXPECT_EQ(usual(), runToPhase());

    EXPECT_FALSE(element);
    EXPECT_TRUE(created);
    EXPECT_EQ(1u, model->getElementCount());
}

TEST_F(Listeners, MayDestroyAnElementOfAnotherModelThatIsStillToBeReported)
{
    Model const other = Model::create(constellation);
    other->setModelURI(u"test://later");
    model->setModelURI(u"test://earlier");
    ScriptedListener ofOther;
    Plain inOther;
    {
        Transaction const setUp = model->beginTransaction(false);
        inOther = Plain::create(other);
        setUp.commit();
    }
    listen(other, ofOther, Wants{.prepare = false, .validate = false});
    first.onCommitted = [&](Report const&) {
        first.onCommitted = nullptr;
        inOther->destroy();
    };
    ofOther.onCommitted = [&](Report const& report) {
        for (ModelElement const& changed : report->getChanged())
            EXPECT_NE(nullptr, changed.getImpl());
    };
    Transaction const transaction = model->beginTransaction(false);
    change(element, 1);
    change(inOther, 1);
    transaction.commit();

    ASSERT_EQ(1u, ofOther.committed.size()) << "of the destruction; nothing is left of the change";
    EXPECT_THAT(ofOther.committed.at(0)->getDestroyed(), ElementsAre(inOther));
}

// ---------------------------------------------------------------------------- typed listeners

/// A client's listener for everything.
struct FullListener : Listener
{
    void transactionPreparing(ReportData& report) { tell("preparing", report); }
    bool transactionValidating(ReportData& report)
    {
        tell("validating", report);
        return accepts;
    }
    void transactionCommitted(ReportData& report) { tell("committed", report); }
    void transactionRolledBack(ReportData& report) { tell("rolled back", report); }
    void tell(char const* phase, ReportData& report)
    {
        heard.push_back(phase);
        changed = report.getChanged().size();
    }

    Trace heard;
    bool accepts = true;
    std::size_t changed = 0;
};

/// A client's listener for commits alone.
struct CommitListener : Listener
{
    void transactionCommitted(ReportData&) { ++commits; }
    void listenerRemoved() override { ++removals; }
    int commits = 0;
    int removals = 0;
};

/// A client's listener that needs no old values.
struct ShallowListener : Listener
{
    using ElementType = Plain;
    void transactionCommitted(ShallowChangeReport<Plain>& report)
    {
        report.doProcess([&](Plain const& element) { created.push_back(element); },
                         report.getCreated());
        report.doProcess([&](Plain const& element) { destroyed.push_back(element); },
                         report.getDestroyed());
        deep = report.getData().isDeep();
    }
    std::vector<Plain> created;
    std::vector<Plain> destroyed;
    bool deep = true;
};

TEST(TypedListener, GetsTheCallsThatItHasMethodsFor)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    FullListener full;
    CommitListener commits;
    model->addListener(&full);
    model->addListener(&commits);

    Transaction const accepted = model->beginTransaction(false);
    change(element, 1);
    accepted.commit();
    full.accepts = false;
    Transaction const refused = model->beginTransaction(false);
    change(element, 2);
    refused.commit();

    EXPECT_THAT(full.heard, ElementsAre("preparing", "validating", "committed", "preparing",
                                        "validating", "rolled back"));
    EXPECT_EQ(1u, full.changed);
    EXPECT_EQ(1, commits.commits);
    EXPECT_EQ(1, element->getValue());
    model->destroy();
    EXPECT_EQ(1, commits.removals);
}

TEST(TypedListener, IsAddedOnce)
{
    Model const model = Model::createTransientModel();
    CommitListener commits;
    ShallowListener shallow;
    model->addListener(&commits);
    model->addListener(&commits);
    model->addShallowListener(&shallow);
    model->addShallowListener(&shallow);

    EXPECT_EQ(2u, model->getListeners().size());
    model->destroy();
    EXPECT_EQ(1, commits.removals);
}

TEST(TypedListener, OfDeepKindMakesTransactionsDeep)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    CommitListener commits;
    model->addListener(&commits);

    Transaction const transaction = model->beginTransaction(false);
    change(element, 1);

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
    model->removeListener(&commits);
}

TEST(TypedListener, OwnedIsDeletedWithItsModel)
{
    struct Owned : CommitListener
    {
        explicit Owned(bool& deleted) : deleted(deleted) {}
        ~Owned() override { deleted = true; }
        bool& deleted;
    };
    bool deleted = false;
    Model const model = Model::createTransientModel();
    model->addOwnedListener(std::make_unique<Owned>(deleted));
    EXPECT_FALSE(deleted);

    model->destroy();

    EXPECT_TRUE(deleted);
}

TEST(ShallowListener, LeavesTransactionsShallowAndSeesElementsOfItsClass)
{
    Model const model = Model::createTransientModel();
    Plain const old = Plain::create(model);
    ShallowListener listener;
    model->addShallowListener(&listener);

    Transaction const transaction = model->beginTransaction(false);
    Plain const created = Plain::create(model);
    old->destroy();
    transaction.commit();

    EXPECT_FALSE(listener.deep);
    EXPECT_THAT(listener.created, ElementsAre(created));
    EXPECT_THAT(listener.destroyed, ElementsAre(old));
    model->removeListener(&listener);
}

TEST(ShallowListener, DoesNotSeeWhatWasCreatedAndDestroyed)
{
    Model const model = Model::createTransientModel();
    ShallowListener listener;
    model->addShallowListener(&listener);

    Transaction const transaction = model->beginTransaction(false);
    Plain::create(model)->destroy();
    transaction.commit();

    EXPECT_FALSE(listener.deep) << "it was told";
    EXPECT_TRUE(listener.created.empty());
    EXPECT_TRUE(listener.destroyed.empty());
    model->removeListener(&listener);
}
}  // namespace
