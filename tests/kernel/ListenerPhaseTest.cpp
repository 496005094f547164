// What a listener may do in each phase of the end of a transaction.
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tests/kernel/ListenerFixture.h"
#include "tests/support/Deferred.h"
#include "tests/support/ExpectRaises.h"

#include <gmock/gmock.h>

#include <array>

namespace {

using namespace testkit;
using testing::ElementsAre;

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
}  // namespace
