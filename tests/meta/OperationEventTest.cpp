#include "tarnkiln/meta/DeferredInvocation.h"

#include "tests/meta/CallsByReflection.h"
#include "tests/support/ScriptedListener.h"

namespace testkit {

using meta::DeferredInvocation;
using meta::Operation;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Not;

namespace {

/// Keeps what it is called, without a change of the model.
class Recorder : public Node::Impl
{
public:
    using Node::Impl::Impl;

    void note(ustring const& word) { m_trace->emplace_back(word.begin(), word.end()); }
    void fail() { throw std::runtime_error("no"); }
    void run() { m_run(); }

    Trace* m_trace = nullptr;
    std::function<void()> m_run;
};
}  // namespace

class EventsOfOperations : public CallsByReflection
{
protected:
    EventsOfOperations()
    {
        recorder = make<Recorder>();
        impl().m_trace = &trace;
        note = declareMethod(&Recorder::note);
        listen(m_model, listener);
    }

    Recorder& impl() const { return static_cast<Recorder&>(*recorder.getImpl()); }
    void emit(ustring const& word) { DeferredInvocation::emit(note, recorder, {text(word)}); }
    Transaction begin() const { return m_model->beginTransaction(/*revertible=*/true); }
    void expectConsistent() const { EXPECT_THAT(m_model->checkInvariants(), IsEmpty()); }

    Trace trace;
    ScriptedListener listener{"listener", &trace};
    Node recorder;
    Operation note;
};

TEST_F(EventsOfOperations, RunAfterAllListenersOnceTheTransactionIsCommitted)
{
    Transaction const transaction = begin();
    emit(u"first");
    emit(u"second");
    EXPECT_THAT(trace, IsEmpty());

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_THAT(trace, ElementsAre("listener prepare", "listener validate", "listener committed",
                                   "first", "second"));
}

TEST_F(EventsOfOperations, RunAtOnceInATransactionOfTheirOwn)
{
    emit(u"event");

    EXPECT_EQ(trace.back(), "event");
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
}

TEST_F(EventsOfOperations, AreDroppedByARollback)
{
    Transaction const transaction = begin();
    recorder->setName(u"mill");
    emit(u"event");

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_THAT(trace, ElementsAre("listener rolledBack"));
    EXPECT_EQ(recorder->getName(), u"");
    expectConsistent();
}

TEST_F(EventsOfOperations, AreDroppedByARefusal)
{
    listener.onValidate = [](Report const&) { return false; };
    Transaction const transaction = begin();
    emit(u"event");

    transaction.commit();

    EXPECT_THAT(trace, ElementsAre("listener prepare", "listener validate", "listener rolledBack"));
    expectConsistent();
}

TEST_F(EventsOfOperations, MayBeEmittedByPreparingListeners)
{
    listener.onPrepare = [&](Report const&) { emit(u"late"); };
    Transaction const transaction = begin();
    emit(u"early");

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_THAT(trace, ElementsAre("listener prepare", "listener validate", "listener committed",
                                   "early", "late"));
}

TEST_F(EventsOfOperations, AreRefusedByAModelThatIsBeingValidated)
{
    listener.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, emit(u"late"));
        return true;
    };
    Transaction const transaction = begin();
    recorder->setName(u"mill");

    transaction.commit();

    EXPECT_THAT(trace, Not(Contains("late")));
    expectConsistent();
}

TEST_F(EventsOfOperations, BelongToTheNextTransactionWhenListenersEmitThemAfterTheCommit)
{
    bool done = false;
    listener.onCommitted = [&](Report const&) {
        if (!std::exchange(done, true))
            emit(u"from the listener");
    };
    Transaction const transaction = begin();
    emit(u"event");

    transaction.commit();

    EXPECT_THAT(trace, ElementsAre("listener prepare", "listener validate", "listener committed",
                                   "listener prepare", "listener validate", "listener committed",
                                   "from the listener", "event"));
}

TEST_F(EventsOfOperations, MayBeEmittedByOtherEvents)
{
    Operation const run = declareMethod(&Recorder::run);
    impl().m_run = [&] { emit(u"inner"); };
    Transaction const transaction = begin();
    DeferredInvocation::emit(run, recorder, {});
    emit(u"outer");

    transaction.commit();

    trace.erase(trace.begin(), trace.end() - 2);
    EXPECT_THAT(trace, ElementsAre("inner", "outer"));
}

TEST_F(EventsOfOperations, MayChangeTheModel)
{
    Operation const call = declareMethod(&Node::Impl::setName);
    Transaction const transaction = begin();
    DeferredInvocation::emit(call, recorder, {text(u"mill")});
    EXPECT_EQ(recorder->getName(), u"");

    transaction.commit();

    EXPECT_EQ(recorder->getName(), u"mill");
    EXPECT_EQ(listener.committed.size(), 2u);
    expectConsistent();
}

TEST_F(EventsOfOperations, DisturbNobodyWhenTheyFail)
{
    Operation const fail = declareMethod(&Recorder::fail);
    Transaction const transaction = begin();
    DeferredInvocation::emit(fail, recorder, {});
    DeferredInvocation::emit(note, recorder, {});  // an argument is missing
    DeferredInvocation::emit(Operation(), recorder, {});
    emit(u"last");

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_EQ(trace.back(), "last");
}

TEST_F(EventsOfOperations, NeedNotBePublic)
{
    change([&] { note->setIsPublic(false); });

    emit(u"event");

    EXPECT_EQ(trace.back(), "event");
}

TEST_F(EventsOfOperations, AreNotForDestroyedElements)
{
    Transaction const transaction = begin();
    emit(u"event");
    recorder->destroy();

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_THAT(trace, Not(Contains("event")));
}

TEST_F(EventsOfOperations, TellTheirOperationTheirOwnerAndTheirArguments)
{
    DeferredInvocation const event(note, recorder, {text(u"word")});

    EXPECT_EQ(event.getOperation(), note);
    EXPECT_EQ(event.getOwner(), recorder);
    EXPECT_THAT(event.getArguments(), ElementsAre(text(u"word")));
}

TEST_F(EventsOfOperations, KeepTheirOwnerInMemory)
{
    ElementImpl const* const impl = recorder.getImpl();
    DeferredInvocation const event(note, recorder, {});
    recorder->destroy();
    recorder = Node();

    EXPECT_EQ(event.getOwner().getElementImpl(), impl);
    EXPECT_FALSE(event.getOwner());
}
}  // namespace testkit
