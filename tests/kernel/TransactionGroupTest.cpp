#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/support/Deferred.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;
using testing::ElementsAre;

/// Three models in the order of their locations, each with an element and a listener.
class TransactionGroup : public testing::Test
{
protected:
    TransactionGroup()
    {
        a->setModelURI(u"test://a");
        b->setModelURI(u"test://b");
        c->setModelURI(u"test://c");
        Transaction const setUp = a->beginTransaction(/*revertible=*/true);
        inA = Plain::create(a);
        inB = Plain::create(b);
        inC = Plain::create(c);
        setUp.commit();
        listen(a, ofA);
        listen(b, ofB);
        listen(c, ofC);
    }

    void changeAll()
    {
        change(inA, 1);
        change(inB, 2);
        change(inC, 3);
    }
    std::vector<int> values() const { return {inA->getValue(), inB->getValue(), inC->getValue()}; }
    bool allEnded() const
    {
        return !a->getCurrentTransaction() && !b->getCurrentTransaction() &&
               !c->getCurrentTransaction() && !constellation->getTransactionGroup();
    }

    ModelConstellation const constellation = ModelConstellation::create();
    Model const a = Model::create(constellation);
    Model const b = Model::create(constellation);
    Model const c = Model::create(constellation);
    Plain inA, inB, inC;
    Trace trace;
    ScriptedListener ofA{"a", &trace};
    ScriptedListener ofB{"b", &trace};
    ScriptedListener ofC{"c", &trace};
};

TEST_F(TransactionGroup, OpensATransactionOnEachModel)
{
    Transaction const transaction = b->beginTransaction(/*revertible=*/false);

    EXPECT_NE(nullptr, a->getCurrentTransaction());
    EXPECT_NE(nullptr, b->getCurrentTransaction());
    EXPECT_NE(nullptr, c->getCurrentTransaction());
}

TEST_F(TransactionGroup, OfSeveralModelsIsDeepWhateverWasAskedFor)
{
    a->removeListener(&ofA);
    b->removeListener(&ofB);
    c->removeListener(&ofC);
    Transaction const transaction = b->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());

    EXPECT_THAT(values(), ElementsAre(0, 0, 0));
}

TEST_F(TransactionGroup, RunsEachPhaseOverAllModelsInTheOrderOfTheirLocations)
{
    Transaction const transaction = c->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_THAT(trace,
                ElementsAre("a prepare", "b prepare", "c prepare", "a validate", "b validate",
                            "c validate", "a committed", "b committed", "c committed"));
    EXPECT_TRUE(allEnded());
}

TEST_F(TransactionGroup, OrdersLocationsByCodeUnitAndNotByNumber)
{
    b->setModelURI(u"test://10");
    c->setModelURI(u"test://9");
    Transaction const transaction = c->beginTransaction(/*revertible=*/false);
    changeAll();
    transaction.commit();

    EXPECT_THAT(trace,
                ElementsAre("b prepare", "c prepare", "a prepare", "b validate", "c validate",
                            "a validate", "b committed", "c committed", "a committed"));
}

TEST_F(TransactionGroup, TellsOnlyModelsWithNews)
{
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    change(inB, 2);
    transaction.commit();

    EXPECT_THAT(trace, ElementsAre("b prepare", "b validate", "b committed"));
}

TEST_F(TransactionGroup, EndsAllMembersBeforeAnyoneIsTold)
{
    bool ended = false;
    ofA.onCommitted = [&](Report const&) { ended = allEnded(); };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();
    transaction.commit();

    EXPECT_TRUE(ended);
}

TEST_F(TransactionGroup, LetsAllPrepareBeforeChangesAreProhibited)
{
    ofA.onPrepare = [&](Report const&) { change(inB, 20); };
    ofB.onPrepare = [&](Report const&) { change(inA, 10); };
    ofC.onPrepare = [&](Report const&) { change(inA, 11); };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());

    EXPECT_THAT(values(), ElementsAre(11, 20, 3));
    EXPECT_THAT(ofA.prepared, testing::SizeIs(1)) << "one that has prepared is not asked again";
}

TEST_F(TransactionGroup, ProhibitsChangesInAllModelsBeforeAnyoneValidates)
{
    ofA.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, change(inA, 9));
        EXPECT_RAISES(messages::ChangesProhibited, change(inC, 9));
        return true;
    };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    EXPECT_THAT(values(), ElementsAre(1, 2, 3));
}

TEST_F(TransactionGroup, IsRolledBackWholeWhenOneListenerRefuses)
{
    ofB.onValidate = [](Report const&) { return false; };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::RolledBack, transaction.commit());

    EXPECT_THAT(values(), ElementsAre(0, 0, 0));
    EXPECT_THAT(trace, ElementsAre("a prepare", "b prepare", "c prepare", "a validate",
                                   "b validate", "a rolledBack", "b rolledBack", "c rolledBack"));
    EXPECT_TRUE(allEnded());
}

TEST_F(TransactionGroup, IsRolledBackWholeWhenOneListenerThrowsWhilePreparing)
{
    ofB.onPrepare = [](Report const&) { throw std::runtime_error("no"); };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::RolledBack, transaction.commit());

    EXPECT_THAT(values(), ElementsAre(0, 0, 0));
    EXPECT_THAT(trace, ElementsAre("a prepare", "b prepare", "a rolledBack", "b rolledBack",
                                   "c rolledBack"));
}

TEST_F(TransactionGroup, UndoesAllBeforeAnyoneHearsOfTheRollback)
{
    std::vector<int> seen;
    ofA.onRolledBack = [&](bool, Report const&) { seen = values(); };
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    changeAll();
    transaction.rollBack();

    EXPECT_THAT(seen, ElementsAre(0, 0, 0));
}

TEST_F(TransactionGroup, GivesEachListenerTheRecordsOfItsOwnModel)
{
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    change(inA, 1);
    change(inC, 3);
    transaction.commit(u"all");

    ASSERT_EQ(1u, ofA.committed.size());
    ASSERT_EQ(1u, ofC.committed.size());
    EXPECT_TRUE(ofB.committed.empty());
    EXPECT_THAT(ofA.committed[0]->getChanged(), ElementsAre(inA));
    EXPECT_EQ(a, ofA.committed[0]->getModel());
    EXPECT_THAT(ofC.committed[0]->getChanged(), ElementsAre(inC));
    EXPECT_EQ(u"all", ofC.committed[0]->getMessage()->getValue<ustring>());
    EXPECT_EQ(ofA.committed[0]->getOrigin(), ofC.committed[0]->getOrigin());
    EXPECT_EQ(a->getUuid(), ofC.committed[0]->getOrigin().getModel());
}

TEST_F(TransactionGroup, RunsDeferredInvocationsOfAllAfterAllWereTold)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    changeAll();
    onB.eventEmitted(deferred([&] { trace.push_back("deferred b"); }));
    onA.eventEmitted(deferred([&] { trace.push_back("deferred a"); }));
    trace.clear();
    onB.commit();
    onA.commit();

    ASSERT_EQ(11u, trace.size());
    EXPECT_EQ("c committed", trace[8]);
    EXPECT_EQ("deferred a", trace[9]);
    EXPECT_EQ("deferred b", trace[10]);
}

// ---------------------------------------------------------------------------- when it is ready

TEST_F(TransactionGroup, WaitsForTheHandlesOfAllModels)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    changeAll();

    EXPECT_EQ(TransactionResult::NotCompleted, onA.commit());
    EXPECT_NE(nullptr, a->getCurrentTransaction());
    EXPECT_EQ(TransactionResult::Committed, onB.commit());

    EXPECT_TRUE(allEnded());
    EXPECT_EQ(1u, ofA.committed.size());
}

TEST_F(TransactionGroup, IsReadyWhateverNestedTransactionsHaveBeenAndGone)
{
    Transaction const outer = a->beginTransaction(/*revertible=*/false);
    {
        Transaction const dropped = a->beginTransaction(/*revertible=*/false);
        dropped.commit();
    }
    Transaction const held = a->beginTransaction(/*revertible=*/false);
    held.commit();
    {
        Transaction const elsewhere = c->beginTransaction(/*revertible=*/false);
        EXPECT_EQ(TransactionResult::NotCompleted, elsewhere.commit());
    }

    EXPECT_EQ(TransactionResult::Committed, outer.commit());
}

TEST_F(TransactionGroup, DropOfAHandleThatWasCommittedLeavesTheRestWaiting)
{
    Transaction onA = a->beginTransaction(/*revertible=*/false);
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    changeAll();
    onA.commit();
    onA = Transaction();

    EXPECT_FALSE(onB.isRollBackOnly());
    EXPECT_EQ(TransactionResult::Committed, onB.commit());
    EXPECT_THAT(values(), ElementsAre(1, 2, 3));
}

TEST_F(TransactionGroup, DropOfAnUncommittedHandleDoomsTheGroupButOnlyItsOwnModelSaysSo)
{
    Transaction onA = a->beginTransaction(/*revertible=*/false);
    Transaction const alsoOnA = a->beginTransaction(/*revertible=*/false);
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    changeAll();
    onA = Transaction();

    EXPECT_TRUE(alsoOnA.isRollBackOnly());
    EXPECT_FALSE(onB.isRollBackOnly());
    EXPECT_EQ(TransactionResult::RolledBack, onB.commit());
    EXPECT_THAT(values(), ElementsAre(0, 0, 0));
    EXPECT_EQ(TransactionResult::NotCompleted, alsoOnA.commit());
}

TEST_F(TransactionGroup, DropOfTheLastUncommittedHandleRollsAllBack)
{
    {
        Transaction const onA = a->beginTransaction(/*revertible=*/false);
        changeAll();
    }

    EXPECT_TRUE(allEnded());
    EXPECT_THAT(values(), ElementsAre(0, 0, 0));
}

TEST_F(TransactionGroup, CommitOfADoomedGroupRollsBackThoughOthersHaveNotCommitted)
{
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    Transaction const alsoOnB = b->beginTransaction(/*revertible=*/false);
    changeAll();
    b->beginTransaction(/*revertible=*/false).rollBack();

    EXPECT_EQ(TransactionResult::RolledBack, onB.commit());
    EXPECT_EQ(TransactionResult::NotCompleted, alsoOnB.commit());
}

// ---------------------------------------------------------------------------- members come and go

TEST_F(TransactionGroup, TakesAModelThatIsCreatedMeanwhileIn)
{
    Transaction const transaction = a->beginTransaction(/*revertible=*/false);
    Model const late = Model::create(constellation);
    Plain const inLate = Plain::create(late);

    EXPECT_NE(nullptr, late->getCurrentTransaction());
    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());

    EXPECT_FALSE(inLate);
    EXPECT_TRUE(late);
    EXPECT_EQ(nullptr, late->getCurrentTransaction());
}

TEST_F(TransactionGroup, TellsALateModelAfterTheOthers)
{
    Transaction const transaction = c->beginTransaction(/*revertible=*/false);
    Model const late = Model::create(constellation);
    late->setModelURI(u"test://aa");
    ScriptedListener ofLate{"late", &trace};
    Plain const inLate = Plain::create(late);
    change(inA, 1);
    change(inB, 2);
    transaction.commit();
    listen(late, ofLate);
    trace.clear();

    Transaction const next = c->beginTransaction(/*revertible=*/false);
    change(inA, 3);
    change(inLate, 3);
    change(inB, 3);
    next.commit();

    EXPECT_THAT(trace,
                ElementsAre("a prepare", "late prepare", "b prepare", "a validate", "late validate",
                            "b validate", "a committed", "late committed", "b committed"))
        << "the next group has them in the order of locations again";
}

TEST(TransactionGroupOfOneModel, RefusesASecondModelWhileItIsShallow)
{
    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);

    EXPECT_RAISES(messages::CannotJoinShallowTransaction, Model::create(constellation));

    EXPECT_THAT(constellation->getModels(), ElementsAre(model));
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
}

TEST(TransactionGroupOfOneModel, TakesASecondModelInWhileItIsDeep)
{
    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);

    Model const second = Model::create(constellation);

    EXPECT_NE(nullptr, second->getCurrentTransaction());
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
}

TEST_F(TransactionGroup, CompletesTheOthersWhenTheModelThatHoldsItUpIsDestroyed)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    Transaction const onB = b->beginTransaction(/*revertible=*/false);
    changeAll();
    onA.commit(u"lost");
    trace.clear();

    b->destroy();

    EXPECT_TRUE(allEnded());
    EXPECT_THAT(trace, ElementsAre("b removed", "a prepare", "c prepare", "a validate",
                                   "c validate", "a committed", "c committed"));
    EXPECT_FALSE(ofA.committed.at(0)->getMessage());
    EXPECT_EQ(1, inA->getValue());
    EXPECT_EQ(3, inC->getValue());
    EXPECT_EQ(TransactionResult::NotCompleted, onB.commit());
}

TEST_F(TransactionGroup, StaysOpenWhenAModelThatHeldNothingUpIsDestroyed)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    changeAll();

    b->destroy();

    EXPECT_NE(nullptr, a->getCurrentTransaction());
    EXPECT_EQ(TransactionResult::Committed, onA.commit());
    EXPECT_EQ(3, inC->getValue());
}

TEST_F(TransactionGroup, RollsTheOthersBackWhenADoomedModelIsDestroyedAndTheyAreDoomedToo)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    changeAll();
    a->beginTransaction(/*revertible=*/false).rollBack();

    b->destroy();

    EXPECT_TRUE(allEnded());
    EXPECT_EQ(0, inA->getValue());
    EXPECT_EQ(0, inC->getValue());
    EXPECT_EQ(TransactionResult::NotCompleted, onA.commit());
}

TEST_F(TransactionGroup, ForgetsTheDoomOfAModelThatIsDestroyed)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    changeAll();
    b->beginTransaction(/*revertible=*/false).rollBack();

    b->destroy();

    EXPECT_EQ(TransactionResult::Committed, onA.commit());
    EXPECT_EQ(1, inA->getValue());
}

TEST_F(TransactionGroup, IsRolledBackWhenItsConstellationIsDestroyed)
{
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    changeAll();

    constellation->destroy();

    EXPECT_FALSE(a);
    EXPECT_EQ(1u, ofA.rolledBack.size());
    EXPECT_EQ(1, ofA.removals);
    EXPECT_EQ(TransactionResult::NotCompleted, onA.commit());
}

/// Begins a transaction on each model that is added.
class BeginsOnAddedModels : public ConstellationListener
{
public:
    void modelAdded(ModelConstellation const&, Model const& model) override
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        added = Plain::create(model);
        result = transaction.commit();
    }
    void modelDestroyed(ModelConstellation const&, Model const&) override {}
    void listenerRemoved(ModelConstellation const&) override {}

    Plain added;
    TransactionResult result = TransactionResult::RolledBack;
};

TEST_F(TransactionGroup, IsJoinedEarlyByAModelThatAListenerBeginsOn)
{
    BeginsOnAddedModels begins;
    constellation->addConstellationListener(&begins);
    Transaction const onA = a->beginTransaction(/*revertible=*/false);
    change(inA, 1);

    Model const late = Model::create(constellation);

    EXPECT_EQ(TransactionResult::NotCompleted, begins.result);
    EXPECT_EQ(TransactionResult::RolledBack, onA.rollBack());
    EXPECT_EQ(0, inA->getValue());
    EXPECT_FALSE(begins.added);
    EXPECT_TRUE(allEnded());
    constellation->removeConstellationListener(&begins);
}
}  // namespace
