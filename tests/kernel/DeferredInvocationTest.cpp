#include "tests/support/Deferred.h"

#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;
using testing::ElementsAre;

class DeferredInvocations : public testing::TestWithParam<bool>
{
protected:
    DeferredInvocations() { listen(model, listener); }

    Transaction begin() const { return model->beginTransaction(/*revertible=*/true); }
    void emit(Transaction const& transaction, std::string const& text)
    {
        transaction.eventEmitted(deferred([this, text] { trace.push_back(text); }));
    }

    Model const model =
        GetParam() ? Model::create(ModelConstellation()) : Model::createTransientModel();
    Trace trace;
    ScriptedListener listener{"listener", &trace};
};

INSTANTIATE_TEST_SUITE_P(Alone, DeferredInvocations, testing::Values(false));
INSTANTIATE_TEST_SUITE_P(InAConstellation, DeferredInvocations, testing::Values(true));

TEST_P(DeferredInvocations, RunInTheirOrderAfterAllListeners)
{
    Transaction const transaction = begin();
    emit(transaction, "first");
    Plain::create(model);
    emit(transaction, "second");

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_THAT(trace, ElementsAre("listener prepare", "listener validate", "listener committed",
                                   "first", "second"));
}

TEST_P(DeferredInvocations, AloneMakeAReportWithNoElements)
{
    Transaction const transaction = begin();
    emit(transaction, "event");

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    ASSERT_EQ(1u, listener.committed.size());
    ReportData const& report = *listener.committed[0];
    EXPECT_FALSE(report.isEmpty());
    EXPECT_TRUE(report.getCreated().empty());
    EXPECT_TRUE(report.getChanged().empty());
    EXPECT_TRUE(report.getDestroyed().empty());
    EXPECT_TRUE(report.getCreatedAndDestroyed().empty());
    EXPECT_THAT(
        trace, ElementsAre("listener prepare", "listener validate", "listener committed", "event"));
}

TEST_P(DeferredInvocations, DoNotRunAfterARollbackOfWhichListenersHear)
{
    Transaction const transaction = begin();
    emit(transaction, "event");

    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());

    EXPECT_THAT(trace, ElementsAre("listener rolledBack"));
}

TEST_P(DeferredInvocations, ThatThrowDisturbNobody)
{
    Transaction const transaction = begin();
    transaction.eventEmitted(deferred([] { throw std::runtime_error("no"); }));
    transaction.eventEmitted(deferred([] { throw 5; }));
    emit(transaction, "third");

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_EQ("third", trace.back());
}

TEST_P(DeferredInvocations, ComeFromNestedTransactionsToo)
{
    Transaction const outer = begin();
    {
        Transaction const inner = begin();
        emit(inner, "event");
        inner.commit();
    }
    outer.commit();

    EXPECT_EQ("event", trace.back());
}

TEST_P(DeferredInvocations, AreRefusedOnceChangesAreProhibited)
{
    Transaction const transaction = begin();
    listener.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, emit(transaction, "late"));
        return true;
    };
    Plain::create(model);

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    EXPECT_THAT(trace, testing::Not(testing::Contains("late")));
}

TEST_P(DeferredInvocations, MayComeFromPreparingListeners)
{
    Transaction const transaction = begin();
    listener.onPrepare = [&](Report const&) { emit(transaction, "late"); };
    Plain::create(model);

    transaction.commit();

    EXPECT_EQ("late", trace.back());
}

TEST_P(DeferredInvocations, AreDroppedAfterARollback)
{
    Transaction const transaction = begin();
    Plain::create(model);
    transaction.rollBack();

    emit(transaction, "late");

    EXPECT_THAT(trace, ElementsAre("listener rolledBack"));
}

TEST_P(DeferredInvocations, MayChangeTheModelInATransactionOfTheirOwn)
{
    Transaction const transaction = begin();
    Plain created;
    transaction.eventEmitted(deferred([&] {
        Transaction const own = begin();
        created = Plain::create(model);
        own.commit();
    }));

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_TRUE(created);
    EXPECT_EQ(2u, listener.committed.size());
}

TEST_P(DeferredInvocations, AreSharedWithTheReportThatKeepsThem)
{
    auto const counted = std::make_shared<int>();
    {
        Transaction const transaction = begin();
        transaction.eventEmitted(deferred([counted] {}));
        transaction.commit();
    }
    EXPECT_EQ(2, counted.use_count());
    EXPECT_FALSE(listener.committed.at(0)->isEmpty());

    listener.prepared = listener.validated = listener.committed = {};
    EXPECT_EQ(1, counted.use_count());
}

TEST_P(DeferredInvocations, DoNotMakeATransactionOneWithChanges)
{
    bool called = false;
    Transaction const transaction = begin();
    transaction.addFirstChangeCallback([&] { called = true; });
    emit(transaction, "event");
    transaction.commit();

    EXPECT_FALSE(called);
}
}  // namespace
