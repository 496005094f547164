#include "tarnkiln/kernel/ReportData.h"

#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/support/Deferred.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeImpl.h"

#include <boost/optional/optional_io.hpp>

namespace {

using namespace testkit;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

meta::Property const& propertyAt(Slot const& slot)
{
    return NodeMetamodel::get().properties[slot.index];
}

class Reports : public testing::Test
{
protected:
    /// Runs `change` in a transaction and returns the report of its commit; null if there is none.
    Report reportOf(std::function<void()> const& change, bool deep = true)
    {
        ScriptedListener listener;
        listen(model, listener, Wants{.shallow = true, .prepare = false, .validate = false});
        Transaction const transaction = model->beginTransaction(/*revertible=*/deep);
        change();
        transaction.commit();
        return listener.committed.empty() ? nullptr : listener.committed[0];
    }

    Model const model = Model::create(ModelConstellation());
    Node const node = Node::create(model);
};

TEST_F(Reports, ListWhatWasCreatedChangedAndDestroyed)
{
    Node const changed = Node::create(model);
    Node created, gone;

    Report const report = reportOf([&] {
        created = Node::create(model);
        changed->setCount(1);
        node->destroy();
        gone = Node::create(model);
        gone->destroy();
    });

    ASSERT_TRUE(report);
    EXPECT_THAT(report->getCreated(), ElementsAre(created));
    EXPECT_THAT(report->getChanged(), ElementsAre(changed));
    EXPECT_THAT(report->getDestroyed(), ElementsAre(node));
    EXPECT_THAT(report->getCreatedAndDestroyed(), ElementsAre(gone));
    EXPECT_EQ(model, report->getModel());
}

TEST_F(Reports, ListAnElementOnceWhateverWasDoneToIt)
{
    Node created;
    Report const report = reportOf([&] {
        created = Node::create(model);
        created->setCount(4);
        node->setCount(1);
        node->setCount(2);
        node->setTag("x");
        node->destroy();
    });

    EXPECT_THAT(report->getCreated(), ElementsAre(created));
    EXPECT_THAT(report->getChanged(), IsEmpty());
    EXPECT_THAT(report->getDestroyed(), ElementsAre(node));
}

TEST_F(Reports, KnowANewElementUnderTheUuidOfADestroyedOne)
{
    UUID const id = node->getUuid();
    node->setCount(5);
    Node newcomer;
    Report const report = reportOf([&] {
        node->destroy();
        newcomer = Node::create(model, id);
        newcomer->setCount(6);
    });

    EXPECT_THAT(report->getCreated(), ElementsAre(newcomer));
    EXPECT_THAT(report->getDestroyed(), ElementsAre(node));
    EXPECT_FALSE(report->isChanged(newcomer, propertyAt(Node::Impl::COUNT)));
}

// ---------------------------------------------------------------------------- what changed

TEST_F(Reports, TellWhichPropertiesChanged)
{
    Report const report = reportOf([&] { node->setCount(1); });

    EXPECT_TRUE(report->isChanged(node, propertyAt(Node::Impl::COUNT)));
    EXPECT_FALSE(report->isChanged(node, propertyAt(Node::Impl::TAG)));
    EXPECT_THAT(report->getChangedProperties(node), ElementsAre(propertyAt(Node::Impl::COUNT)));
}

TEST_F(Reports, CallAPropertyThatWasSetBackChanged)
{
    Report const report = reportOf([&] {
        node->setCount(1);
        node->setCount(0);
    });

    EXPECT_TRUE(report->isChanged(node, propertyAt(Node::Impl::COUNT)));
    EXPECT_THAT(report->getChanged(), ElementsAre(node));
}

TEST_F(Reports, DoNotCallAPropertyThatWasSetToItsValueChanged)
{
    EXPECT_FALSE(reportOf([&] { node->setCount(0); }));
}

TEST_F(Reports, ListTheChangedPropertiesOfTheSubclassFirst)
{
    SpecialNode const special = SpecialNode::create(model);
    Report const report = reportOf([&] {
        special->setCount(1);
        special->setLevel(2);
        special->setTag("x");
    });

    std::vector<meta::Property> const changed = report->getChangedProperties(special);

    ASSERT_EQ(3u, changed.size());
    EXPECT_EQ(NodeMetamodel::get().properties[SpecialNode::Impl::LEVEL.index], changed[0]);
    EXPECT_THAT((std::vector(changed.begin() + 1, changed.end())),
                UnorderedElementsAre(propertyAt(Node::Impl::COUNT), propertyAt(Node::Impl::TAG)));
}

TEST_F(Reports, SayNothingOfPropertiesOfAnotherClass)
{
    Report const report = reportOf([&] { node->setCount(1); });
    meta::Property const& ofSubclass =
        NodeMetamodel::get().properties[SpecialNode::Impl::LEVEL.index];

    EXPECT_FALSE(report->isChanged(node, ofSubclass));
    EXPECT_FALSE(report->isChanged(node, meta::Property()));
    EXPECT_FALSE(report->isChanged(Node(), propertyAt(Node::Impl::COUNT)));
}

TEST_F(Reports, SayNothingOfTheChangesOfACreatedElement)
{
    Node created;
    Report const report = reportOf([&] {
        created = Node::create(model);
        created->setBuddy(node);
    });

    EXPECT_FALSE(report->isChanged(created, propertyAt(Node::Impl::BUDDY)));
    EXPECT_THAT(report->getChangedProperties(created), IsEmpty());
    EXPECT_EQ(Node(), report->getOldValue(created, propertyAt(Node::Impl::BUDDY)).getValue<Node>());
}

TEST_F(Reports, CallNothingOfADestroyedElementChangedAndKnowItsOldValues)
{
    node->setCount(7);
    Report const report = reportOf([&] {
        node->setCount(8);
        node->destroy();
    });

    EXPECT_FALSE(report->isChanged(node, propertyAt(Node::Impl::COUNT)));
    EXPECT_THAT(report->getChangedProperties(node), IsEmpty());
    EXPECT_EQ(7, report->getOldValue(node, propertyAt(Node::Impl::COUNT)).getValue<int>());
}

// ---------------------------------------------------------------------------- old values

TEST_F(Reports, KnowTheValueFromBeforeTheFirstOfSeveralChanges)
{
    node->setCount(1);
    node->setName(u"before");
    node->setRank(9);
    Report const report = reportOf([&] {
        node->setCount(2);
        node->setCount(3);
        node->setName(u"after");
        node->setRank(boost::none);
        node->setNote(ustring(u"new"));
    });

    EXPECT_EQ(1, report->getOldValue(node, propertyAt(Node::Impl::COUNT)).getValue<int>());
    EXPECT_EQ(u"before",
              report->getOldValue(node, propertyAt(Node::Impl::NAME)).getValue<ustring>());
    EXPECT_EQ(
        boost::optional<int>(9),
        report->getOldValue(node, propertyAt(Node::Impl::RANK)).getValue<boost::optional<int>>());
    EXPECT_FALSE(report->getOldValue(node, propertyAt(Node::Impl::NOTE))
                     .getValue<boost::optional<ustring>>()
                     .has_value());
}

TEST_F(Reports, KnowTheOldTargetsOfReferences)
{
    Node const before = Node::create(model);
    Node const after = Node::create(model);
    node->setBuddy(before);
    node->setLeft(before);
    Report const report = reportOf([&] {
        node->setBuddy(after);
        node->setLeft(after);
    });

    EXPECT_EQ(before, report->getOldValue(node, propertyAt(Node::Impl::BUDDY)).getValue<Node>());
    EXPECT_EQ(before, report->getOldValue(node, propertyAt(Node::Impl::LEFT)).getValue<Node>());
    EXPECT_EQ(node, report->getOldValue(before, propertyAt(Node::Impl::RIGHT)).getValue<Node>());
    EXPECT_EQ(Node(), report->getOldValue(after, propertyAt(Node::Impl::RIGHT)).getValue<Node>());
}

TEST_F(Reports, KnowTheOldContentsOfCollections)
{
    Node const first = Node::create(model);
    Node const second = Node::create(model);
    node->getLinks().push_back(first);
    Report const report = reportOf([&] {
        node->getLinks().push_back(second);
        node->getLinks().remove(first);
    });

    Value const old = report->getOldValue(node, propertyAt(Node::Impl::LINKS));
    EXPECT_THAT(old.getValue<ReferenceCollection&>().getAllValues(), ElementsAre(first));
    EXPECT_THAT(node->getLinks().getAllValues(), ElementsAre(second));
    EXPECT_THAT(report->getOldValue(second, propertyAt(Node::Impl::BACKLINKS))
                    .getValue<ReferenceCollection&>()
                    .getAllValues(),
                IsEmpty());
}

TEST_F(Reports, KnowTheOldContainer)
{
    Node const from = Node::create(model);
    Node const to = Node::create(model);
    Node const top = Node::create(model);
    from->getChildren().push_back(node);
    Report const report = reportOf([&] {
        node->setParent(to);
        top->setParent(to);
    });

    EXPECT_EQ(from, report->getOldValue(node, propertyAt(Node::Impl::PARENT)).getValue<Node>());
    EXPECT_EQ(Node(), report->getOldValue(top, propertyAt(Node::Impl::PARENT)).getValue<Node>());
    EXPECT_EQ(Node(), report->getOldValue(node, propertyAt(Node::Impl::HOST)).getValue<Node>());
}

TEST_F(Reports, GiveTheEmptyValueForWhatDidNotChange)
{
    Node const target = Node::create(model);
    Node const untouched = Node::create(model);
    for (Node const& each : {node, untouched})
    {
        each->setBuddy(target);
    }
    Report const report = reportOf([&] { node->setTag("x"); });

    for (Node const& each : {node, untouched, Node()})
    {
        Value const old = report->getOldValue(each, propertyAt(Node::Impl::BUDDY));
        EXPECT_EQ(Value::createEmptyValue(propertyAt(Node::Impl::BUDDY)), old);
        EXPECT_EQ(Node(), old.getValue<Node>()) << "not the present one";
    }
}

TEST_F(Reports, HaveNoOldValueOfManyThatDidNotChange)
{
    Node const untouched = Node::create(model);
    Report const report = reportOf([&] { node->setTag("x"); });

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       report->getOldValue(untouched, propertyAt(Node::Impl::LINKS)),
                       u"testkit.Node");
}

TEST_F(Reports, OfShallowTransactionsHaveNoOldValues)
{
    Report const report = reportOf([&] { node->setTag("x"); }, /*deep=*/false);
    Node const untouched = Node::create(model);

    EXPECT_FALSE(report->isDeep());
    EXPECT_TRUE(report->isChanged(node, propertyAt(Node::Impl::TAG)));
    EXPECT_RAISES(messages::GetOldValueFromNonDeep,
                  report->getOldValue(node, propertyAt(Node::Impl::TAG)));
    EXPECT_RAISES(messages::GetOldValueFromNonDeep,
                  report->getOldValue(untouched, propertyAt(Node::Impl::TAG)));
    EXPECT_RAISES(messages::GetOldValueFromNonDeep, report->getOldValue(Node(), meta::Property()));
}

TEST_F(Reports, OutliveTheirTransactionWithTheOldValues)
{
    Report report;
    {
        ScriptedListener listener;
        listen(model, listener);
        Transaction const transaction = model->beginTransaction(true);
        node->setCount(1);
        transaction.commit();
        report = listener.committed.at(0);
    }
    {
        Transaction const later = model->beginTransaction(true);
        node->setCount(2);
        later.commit();
    }

    EXPECT_EQ(0, report->getOldValue(node, propertyAt(Node::Impl::COUNT)).getValue<int>());
}

TEST_F(Reports, KnowElementsThatLaterTransactionsHaveChanged)
{
    Node const other = Node::create(model);
    Report const first = reportOf([&] {
        node->setCount(1);
        other->setCount(10);
    });
    Report const second = reportOf([&] {
        other->setCount(20);
        node->setTag("x");
    });

    meta::Property const& count = propertyAt(Node::Impl::COUNT);
    EXPECT_TRUE(first->isChanged(node, count));
    EXPECT_TRUE(first->isChanged(other, count));
    EXPECT_EQ(0, first->getOldValue(other, count).getValue<int>());
    EXPECT_EQ(10, second->getOldValue(other, count).getValue<int>());
    EXPECT_FALSE(second->isChanged(node, count));
}

TEST_F(Reports, TellElementsOfOneUuidApartInLaterTransactionsToo)
{
    UUID const id = node->getUuid();
    node->setCount(5);
    Node successor;
    Report const first = reportOf([&] {
        node->destroy();
        successor = Node::create(model, id);
    });
    Report const second = reportOf([&] { successor->setCount(6); });

    meta::Property const& count = propertyAt(Node::Impl::COUNT);
    EXPECT_EQ(0, second->getOldValue(successor, count).getValue<int>());
    EXPECT_THAT(first->getChangedProperties(successor), IsEmpty());
    EXPECT_THAT(first->getCreated(), ElementsAre(successor));
    EXPECT_THAT(first->getDestroyed(), ElementsAre(node));
}

TEST_F(Reports, OfARollbackHoldTheValuesThatWereTakenBack)
{
    Node const target = Node::create(model);
    node->getLinks().push_back(target);
    node->setCount(1);
    ScriptedListener listener;
    listen(model, listener);
    int present = 0;
    int taken = 0;
    std::size_t takenLinks = 9;
    listener.onRolledBack = [&](bool, Report const& report) {
        present = node->getCount();
        taken = report->getOldValue(node, propertyAt(Node::Impl::COUNT)).getValue<int>();
        takenLinks = report->getOldValue(node, propertyAt(Node::Impl::LINKS))
                         .getValue<ReferenceCollection&>()
                         .getAllValues()
                         .size();
    };
    Transaction const transaction = model->beginTransaction(true);
    node->setCount(2);
    node->getLinks().clear();
    transaction.rollBack();

    ASSERT_EQ(1u, listener.rolledBack.size());
    EXPECT_TRUE(listener.rolledBack[0]->isChanged(node, propertyAt(Node::Impl::COUNT)));
    EXPECT_EQ(1, present);
    EXPECT_EQ(2, taken);
    EXPECT_EQ(0u, takenLinks);
    EXPECT_THAT(node->getLinks().getAllValues(), ElementsAre(target));
}

// ---------------------------------------------------------------------------- emptiness

TEST_F(Reports, AreNotEmptyAfterTheDestructionOfAllElementsEvenOfNone)
{
    Model const empty = Model::createTransientModel();
    ScriptedListener listener;
    listen(empty, listener);

    empty->destroyAllContents();

    ASSERT_EQ(1u, listener.committed.size());
    ReportData const& report = *listener.committed[0];
    EXPECT_FALSE(report.isEmpty());
    EXPECT_TRUE(report.isDestroyAll());
    EXPECT_THAT(report.getDestroyed(), IsEmpty());
}

TEST_F(Reports, AreEmptyWithoutContents)
{
    ReportData const report(model, std::make_shared<ChangeRecords>(), boost::none,
                            /*revertUnchanged=*/false, /*deep=*/true, nullptr,
                            /*destroyAll=*/false, meta::TransactionOrigin());
    EXPECT_TRUE(report.isEmpty());

    auto const events = std::make_shared<ReportData::DeferredInvocations>();
    ReportData const withNoEvent(model, std::make_shared<ChangeRecords>(), boost::none, false, true,
                                 events, false, meta::TransactionOrigin());
    EXPECT_TRUE(withNoEvent.isEmpty());
    events->push_back(deferred([] {}));
    EXPECT_FALSE(withNoEvent.isEmpty());
}

// ---------------------------------------------------------------------------- changed back

class RevertedElements : public Reports
{
protected:
    RevertedElements() { model->setRevertUnchangedOnReport(true); }
};

TEST_F(RevertedElements, AreLeftOutOfTheReportAndWrittenToStandardOutput)
{
    Node const home = Node::create(model);
    Node const away = Node::create(model);
    home->getParts().push_back(node);
    testing::internal::CaptureStdout();

    Report const report = reportOf([&] {
        away->getParts().push_back(node);
        home->getParts().push_back(node);
    });

    std::string const written = testing::internal::GetCapturedStdout();
    ASSERT_TRUE(report);
    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(home, away));
    EXPECT_EQ("Reverted unchanged element testkit.Node\n", written);
}

TEST_F(RevertedElements, AreListedIfAnythingElseChanged)
{
    Node const home = Node::create(model);
    Node const away = Node::create(model);
    home->getParts().push_back(node);

    Report const report = reportOf([&] {
        away->getParts().push_back(node);
        home->getParts().push_back(node);
        node->setCount(1);
    });

    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(home, away, node));
}

TEST_F(RevertedElements, AreListedInAShallowTransactionWhichCannotTell)
{
    Node const home = Node::create(model);
    Node const away = Node::create(model);
    home->getChildren().push_back(node);

    Report const report = reportOf(
        [&] {
            away->getChildren().push_back(node);
            home->getChildren().push_back(node);
        },
        /*deep=*/false);

    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(home, away, node));
}

TEST_F(RevertedElements, AreListedIfTheModelDoesNotAskForIt)
{
    model->setRevertUnchangedOnReport(false);
    Node const home = Node::create(model);
    Node const away = Node::create(model);
    home->getParts().push_back(node);

    Report const report = reportOf([&] {
        away->getParts().push_back(node);
        home->getParts().push_back(node);
    });

    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(home, away, node));
}

TEST_F(RevertedElements, ThatAreAllThereWasLeaveTheReportEmptyAndNobodyIsTold)
{
    Node const target = Node::create(model);
    testing::internal::CaptureStdout();

    Report const report = reportOf([&] {
        node->setBuddy(target);
        node->setBuddy(Node());
    });

    std::string const written = testing::internal::GetCapturedStdout();
    EXPECT_FALSE(report);
    EXPECT_EQ("Reverted unchanged element testkit.Node\n", written);
}

TEST_F(RevertedElements, AreTestedAgainstTheModelAtTheTimeOfEachReport)
{
    Node const home = Node::create(model);
    Node const away = Node::create(model);
    home->getParts().push_back(node);
    ScriptedListener first, second;
    listen(model, first);
    listen(model, second);
    first.onPrepare = [&](Report const&) { node->setCount(1); };
    Transaction const transaction = model->beginTransaction(true);
    away->getParts().push_back(node);
    home->getParts().push_back(node);
    testing::internal::CaptureStdout();
    transaction.commit();
    testing::internal::GetCapturedStdout();

    EXPECT_THAT(first.prepared.at(0)->getChanged(), UnorderedElementsAre(home, away));
    EXPECT_THAT(second.prepared.at(0)->getChanged(), UnorderedElementsAre(home, away, node));
}
}  // namespace
