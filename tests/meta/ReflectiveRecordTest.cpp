// What transactions remember of reflective elements, and how they take it back.
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

class ReflectiveRecord : public ReflectiveFixture
{
protected:
    /// Runs `change` in a deep transaction and gives the report of its commit.
    Report reportOf(std::function<void()> const& change)
    {
        ScriptedListener listener;
        listen(model, listener);
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        change();
        EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
        return listener.committed.empty() ? nullptr : listener.committed.back();
    }
    /// Runs `change` in a deep transaction and takes it back.
    void rolledBack(std::function<void()> const& change)
    {
        Transaction const transaction = begin();
        change();
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
    }

    meta::Class const base = metamodel.makeClass(u"Base");
    meta::Class const node = metamodel.makeClass(u"Node", base);
    meta::Property const label =
        metamodel.property(base, u"label", StandardTypes::stringMeta).required();
    meta::Property const count =
        metamodel.property(node, u"count", StandardTypes::integerMeta).required();
    meta::Property const rank = metamodel.property(node, u"rank", StandardTypes::integerMeta);
    meta::Property const buddy = metamodel.property(node, u"buddy", node);
    meta::Property const numbers =
        metamodel.property(node, u"numbers", StandardTypes::integerMeta).many().ordered();
    meta::Property const links = metamodel.property(node, u"links", node).many().ordered();
    meta::Property const backlinks =
        metamodel.property(node, u"backlinks", node).many().opposite(links);
    meta::Property const children =
        metamodel.property(node, u"children", node).many().ordered().composite();
    meta::Property const parent = metamodel.property(node, u"parent", node).opposite(children);
    meta::Property const core = metamodel.property(node, u"core", node).composite();
};

TEST_F(ReflectiveRecord, TellsMovingFromCreationForAClassWithoutProperties)
{
    meta::Class const bare = metamodel.makeClass(u"Bare");
    meta::Property const things = metamodel.property(node, u"things", bare).many().composite();
    ModelElement const thing = make(bare), x = make(node);

    rolledBack([&] { genericOf(x, things).genericAdd(thing); });

    EXPECT_TRUE(static_cast<bool>(thing));
    EXPECT_TRUE(thing->isTopLevel());
    EXPECT_THAT(entriesOf(x, things), IsEmpty());
}

TEST_F(ReflectiveRecord, HasTheValuesFromBeforeTheFirstChange)
{
    ModelElement const x = make(node), y = make(node), z = make(node);
    set(x, label, u"old");
    set(x, count, 1);
    set(x, buddy, y);

    Report const report = reportOf([&] {
        set(x, label, u"between");
        set(x, label, u"new");
        set(x, count, 2);
        set(x, rank, 3);
        set(x, buddy, z);
    });

    EXPECT_EQ(report->getOldValue(x, label), Value(StandardTypes::stringMeta, ustring(u"old")));
    EXPECT_EQ(report->getOldValue(x, count), Value(StandardTypes::integerMeta, 1));
    EXPECT_EQ(report->getOldValue(x, rank), Value::createEmptyValue(rank));
    EXPECT_EQ(report->getOldValue(x, buddy), Value::createElementValue(buddy, y));
    EXPECT_THAT(report->getChangedProperties(x), ElementsAre(buddy, count, rank, label))
        << "class by class upward, by name";
}

TEST_F(ReflectiveRecord, HasTheCollectionsFromBeforeTheFirstChange)
{
    ModelElement const x = make(node), y = make(node), z = make(node);
    genericOf(x, links).genericAdd(y);
    valuesOf(x, numbers).genericAdd(Value(StandardTypes::integerMeta, 1));

    Report const report = reportOf([&] {
        genericOf(x, links).genericAdd(z);
        genericOf(x, links).genericRemove(y);
        valuesOf(x, numbers).clear();
    });

    Value const oldLinks = report->getOldValue(x, links);
    EXPECT_TRUE(oldLinks.isReflective());
    EXPECT_EQ(oldLinks.getFlags(), ValueFlags::Sequence);
    EXPECT_THAT(oldLinks.getValue<ReferenceCollection&>().getAllValues(), ElementsAre(y));
    Value const oldNumbers = report->getOldValue(x, numbers);
    EXPECT_FALSE(oldNumbers.isReflective());
    EXPECT_THAT(oldNumbers.getValue<AbstractPrimitiveCollection&>().getAllValues(),
                ElementsAre(Value(StandardTypes::integerMeta, 1)));
    EXPECT_THAT(report->getOldValue(y, backlinks).getValue<ReferenceCollection&>().getAllValues(),
                ElementsAre(x));
    EXPECT_THAT(report->getOldValue(z, backlinks).getValue<ReferenceCollection&>().getAllValues(),
                IsEmpty());
}

TEST_F(ReflectiveRecord, HasTheContainerFromBefore)
{
    ModelElement const p = make(node), q = make(node), x = make(node), y = make(node);
    set(x, parent, p);

    Report const report = reportOf([&] {
        set(x, parent, q);
        set(y, parent, p);
    });

    EXPECT_EQ(report->getOldValue(x, parent), Value::createElementValue(parent, p));
    EXPECT_EQ(report->getOldValue(y, parent), Value::createEmptyValue(parent));
    EXPECT_TRUE(report->isChanged(x, parent));
}

TEST_F(ReflectiveRecord, HasNothingOfWhatDidNotChange)
{
    ModelElement const x = make(node);
    set(x, count, 5);

    Report const report = reportOf([&] { set(x, rank, 1); });

    EXPECT_FALSE(report->isChanged(x, count));
    EXPECT_EQ(report->getOldValue(x, count), Value::createEmptyValue(count))
        << "the empty value, not the present one";
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, report->getOldValue(x, links),
                       u"rt.Node");
}

TEST_F(ReflectiveRecord, KnowsNoPropertyOfAnotherClass)
{
    meta::Class const other = metamodel.makeClass(u"Other");
    meta::Property const foreign =
        metamodel.property(other, u"foreign", StandardTypes::integerMeta).required();
    ModelElement const x = make(node);
    std::unique_ptr<ModelElement::Impl::Storage> const record(x->createStorage());

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       record->getOldValue(foreign, ModelElement::Impl::PUBLIC_ACCESS), u"foreign",
                       u"rt.Node");
}

TEST_F(ReflectiveRecord, KeepsASetBackPropertyMarkedAndForgetsARestoredContainer)
{
    ModelElement const p = make(node), x = make(node), y = make(node);
    set(p, core, x);
    model->setRevertUnchangedOnReport(true);

    Report const report = reportOf([&] {
        set(y, count, 1);
        set(y, count, 0);
        clear(p, core);
        set(p, core, x);
    });

    EXPECT_TRUE(report->isChanged(y, count));
    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(p, y));
}

TEST_F(ReflectiveRecord, IsShallowIfNobodyNeedsOldValues)
{
    ModelElement const x = make(node);
    ScriptedListener listener;
    listen(model, listener, Wants{.shallow = true});
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    set(x, count, 2);
    genericOf(x, links).genericAdd(x);
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    Report const report = listener.committed.at(0);
    EXPECT_TRUE(report->isChanged(x, count));
    EXPECT_TRUE(report->isChanged(x, links));
    EXPECT_FALSE(report->isChanged(x, rank));
    EXPECT_RAISES(messages::GetOldValueFromNonDeep, report->getOldValue(x, count));
}

TEST_F(ReflectiveRecord, OutlivesTheElement)
{
    ModelElement x = make(node), y = make(node);
    set(x, label, u"old");
    set(x, buddy, y);
    Report const report = reportOf([&] {
        set(x, label, u"new");
        clear(x, buddy);
    });
    x->destroy();
    y->destroy();

    EXPECT_EQ(report->getOldValue(x, label), Value(StandardTypes::stringMeta, ustring(u"old")));
    EXPECT_EQ(report->getOldValue(x, buddy).getValue<ModelElement>().getImpl(), y.getImpl());
}

// ---------------------------------------------------------------------------- rollback

TEST_F(ReflectiveRecord, RestoresAllKindsOfProperties)
{
    ModelElement const x = make(node), y = make(node), z = make(node);
    set(x, label, u"old");
    set(x, buddy, y);
    genericOf(x, links).genericAdd(y);
    valuesOf(x, numbers).genericAdd(Value(StandardTypes::integerMeta, 1));
    ReferenceCollection* const collection = &referencesOf(x, links);

    rolledBack([&] {
        set(x, label, u"new");
        set(x, rank, 4);
        set(x, buddy, z);
        genericOf(x, links).genericClear();
        genericOf(x, links).genericAdd(z);
        valuesOf(x, numbers).clear();
    });

    EXPECT_EQ(get<ustring>(x, label), u"old");
    EXPECT_FALSE(has(x, rank));
    EXPECT_EQ(targetOf(x, buddy), y);
    EXPECT_THAT(entriesOf(x, links), ElementsAre(y));
    EXPECT_THAT(entriesOf(z, backlinks), IsEmpty());
    EXPECT_THAT(valuesOf(x, numbers).getAllValues(),
                ElementsAre(Value(StandardTypes::integerMeta, 1)));
    EXPECT_EQ(&referencesOf(x, links), collection) << "the collection is the same object";
}

TEST_F(ReflectiveRecord, EmptiesACollectionThatWasFirstUsedInTheTransaction)
{
    ModelElement const x = make(node), y = make(node);

    rolledBack([&] {
        genericOf(x, links).genericAdd(y);
        valuesOf(x, numbers).genericAdd(Value(StandardTypes::integerMeta, 1));
    });

    EXPECT_FALSE(has(x, links));
    EXPECT_FALSE(has(x, numbers));
    EXPECT_FALSE(has(y, backlinks));
}

TEST_F(ReflectiveRecord, RestoresTheContainer)
{
    ModelElement const p = make(node), q = make(node), x = make(node), y = make(node);
    set(x, parent, p);
    set(p, core, y);

    rolledBack([&] {
        set(x, parent, q);
        clear(p, core);
    });
    EXPECT_EQ(targetOf(x, parent), p);
    EXPECT_THAT(entriesOf(p, children), ElementsAre(x));
    EXPECT_THAT(entriesOf(q, children), IsEmpty());
    EXPECT_EQ(targetOf(p, core), y);
    EXPECT_EQ(y->container(), p);

    rolledBack([&] { clear(x, parent); });
    EXPECT_EQ(targetOf(x, parent), p);
    EXPECT_FALSE(x->isTopLevel());
}

TEST_F(ReflectiveRecord, RestoresThePropertyWithTheHighestIndexAndNotTheContainer)
{
    meta::Property const last =
        metamodel.property(node, u"last", StandardTypes::integerMeta).required().at(100);
    ModelElement const p = make(node), x = make(node);
    set(x, parent, p);

    rolledBack([&] { set(x, last, 1); });

    EXPECT_EQ(get<int>(x, last), 0);
    EXPECT_EQ(targetOf(x, parent), p);
}

TEST_F(ReflectiveRecord, RestoresPropertiesThatShareAnIndex)
{
    meta::Property const twin =
        metamodel.property(node, u"twin", StandardTypes::integerMeta).required().at(50);
    meta::Property const other =
        metamodel.property(node, u"other", StandardTypes::integerMeta).required().at(50);
    ModelElement const x = make(node);

    rolledBack([&] {
        set(x, twin, 1);
        set(x, other, 2);
    });

    EXPECT_EQ(get<int>(x, twin), 0);
    EXPECT_EQ(get<int>(x, other), 0);
}

TEST_F(ReflectiveRecord, HasNothingOfAPropertyWithoutAnIndex)
{
    meta::Property const zero =
        metamodel.property(node, u"zero", StandardTypes::integerMeta).required().at(0);
    meta::Property const none =
        metamodel.property(node, u"none", StandardTypes::integerMeta).required().at(-1);
    ModelElement const x = make(node);
    Transaction const transaction = begin();

    set(x, zero, 1);
    set(x, none, 2);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotCompleted) << "nothing was recorded";

    EXPECT_EQ(get<int>(x, zero), 1);
    EXPECT_EQ(get<int>(x, none), 2);
}

TEST_F(ReflectiveRecord, UndoesTheCreationOfElementsThatReferToEachOther)
{
    ModelElement x, y;

    rolledBack([&] {
        x = make(node);
        y = make(node);
        set(x, buddy, y);
        set(y, buddy, x);
        genericOf(x, links).genericAdd(y);
        set(y, parent, x);
    });

    EXPECT_FALSE(x);
    EXPECT_FALSE(y);
    EXPECT_EQ(model->getElementCount(), 0u);
    EXPECT_EQ(x->getRefCount(), 2u) << "the handle, and the pin of its dead child";
    EXPECT_EQ(y->getRefCount(), 1u) << "the handle alone";
}
}  // namespace
}  // namespace testkit
