// Single references of reflective elements, and the links to their containers.
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

class ReflectiveReference : public ReflectiveFixture
{
protected:
    meta::Class const node = metamodel.makeClass(u"Node");
    meta::Class const special = metamodel.makeClass(u"Special", node);
    meta::Class const stranger = metamodel.makeClass(u"Stranger");
    meta::Property const buddy = metamodel.property(node, u"buddy", node);
    meta::Property const left = metamodel.property(node, u"left", node);
    meta::Property const right = metamodel.property(node, u"right", node).opposite(left);
    meta::Property const owned = metamodel.property(node, u"owned", node).many().ordered();
    meta::Property const owner = metamodel.property(node, u"owner", node).opposite(owned);
    meta::Property const children =
        metamodel.property(node, u"children", node).many().ordered().composite();
    meta::Property const parent = metamodel.property(node, u"parent", node).opposite(children);
    meta::Property const others =
        metamodel.property(node, u"others", node).many().ordered().composite();
    meta::Property const otherParent =
        metamodel.property(node, u"otherParent", node).opposite(others);
    meta::Property const core = metamodel.property(node, u"core", node).composite();
    meta::Property const body = metamodel.property(node, u"body", node).composite();
    meta::Property const host = metamodel.property(node, u"host", node).opposite(body);
};

TEST_F(ReflectiveReference, IsNullUntilItIsSet)
{
    ModelElement const a = make(node), b = make(node);
    EXPECT_EQ(valueOf(a, buddy), Value::createElementValue(buddy, ModelElement()));
    EXPECT_FALSE(has(a, buddy));

    set(a, buddy, b);
    EXPECT_EQ(valueOf(a, buddy), Value::createElementValue(buddy, b));
    EXPECT_TRUE(has(a, buddy));

    clear(a, buddy);
    EXPECT_FALSE(targetOf(a, buddy));
    EXPECT_FALSE(has(a, buddy));
}

TEST_F(ReflectiveReference, IsToAnElementOfItsClassOrOfASubclass)
{
    ModelElement const a = make(node), s = make(special), x = make(stranger);

    set(a, buddy, s);
    EXPECT_EQ(targetOf(a, buddy), s);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       setValue(a, buddy, Value(stranger, x)), u"rt.Node");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, setValue(a, buddy, Value(node, x)),
                       u"rt.Node");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       setValue(a, buddy, Value(StandardTypes::integerMeta, 1)), u"rt.Node");
    EXPECT_RAISES(messages::InvalidValue, setValue(a, buddy, valueOf(a, owned)));
    EXPECT_EQ(targetOf(a, buddy), s);
}

TEST_F(ReflectiveReference, KeepsTheOtherEndInStep)
{
    ModelElement const a = make(node), b = make(node), c = make(node), d = make(node);
    set(a, left, b);
    set(d, left, c);

    set(a, left, c);

    EXPECT_EQ(targetOf(a, left), c);
    EXPECT_EQ(targetOf(c, right), a);
    EXPECT_FALSE(targetOf(b, right));
    EXPECT_FALSE(targetOf(d, left));
    clear(c, right);
    EXPECT_FALSE(targetOf(a, left));
}

TEST_F(ReflectiveReference, TellsTheFirstChangeThatIsHeardOfBeforeEitherEndIsChanged)
{
    ModelElement const a = make(node), b = make(node), p = make(node);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    set(a, owner, b);
    int calls = 0;
    transaction.addFirstChangeCallback([&] {
        ++calls;
        EXPECT_EQ(targetOf(a, owner), b);
        EXPECT_THAT(entriesOf(b, owned), ElementsAre(a));
        EXPECT_THAT(entriesOf(p, owned), IsEmpty());
    });

    set(a, owner, p);
    set(a, left, b);

    EXPECT_EQ(calls, 1);
    EXPECT_THAT(entriesOf(b, owned), IsEmpty());
    EXPECT_THAT(entriesOf(p, owned), ElementsAre(a));
    EXPECT_EQ(targetOf(b, right), a);
    transaction.commit();
}

TEST_F(ReflectiveReference, StaysInAFrozenModelThoughNobodyWouldHearOfTheChange)
{
    ModelElement const a = make(node), b = make(node);
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    set(a, buddy, b);
    {
        Model::Freezer const freezer(model);
        EXPECT_RAISES(messages::ModelFrozen, set(a, owner, b));
        EXPECT_RAISES(messages::ModelFrozen, set(a, left, b));
        EXPECT_RAISES(messages::ModelFrozen, set(a, parent, b));
    }

    EXPECT_FALSE(targetOf(a, owner));
    EXPECT_FALSE(targetOf(b, right));
    EXPECT_THAT(entriesOf(b, owned), IsEmpty());
    EXPECT_THAT(entriesOf(b, children), IsEmpty());
    EXPECT_TRUE(a->isTopLevel());
    transaction.commit();
}

TEST_F(ReflectiveReference, EntersAndLeavesTheCollectionAtTheOtherEnd)
{
    ModelElement const p = make(node), q = make(node), x = make(node);

    set(x, owner, p);
    EXPECT_THAT(entriesOf(p, owned), ElementsAre(x));
    set(x, owner, q);
    EXPECT_THAT(entriesOf(p, owned), IsEmpty());
    EXPECT_THAT(entriesOf(q, owned), ElementsAre(x));
    clear(x, owner);
    EXPECT_THAT(entriesOf(q, owned), IsEmpty());

    genericOf(p, owned).genericAdd(x);
    EXPECT_EQ(targetOf(x, owner), p);
    genericOf(p, owned).genericRemove(x);
    EXPECT_FALSE(targetOf(x, owner));
}

TEST_F(ReflectiveReference, ToTheContainerIsTheLink)
{
    ModelElement const p = make(node), q = make(node), x = make(node);
    EXPECT_FALSE(has(x, parent));

    set(x, parent, p);
    EXPECT_EQ(x->container(), p);
    EXPECT_EQ(x->containmentFeature(), children);
    EXPECT_THAT(entriesOf(p, children), ElementsAre(x));
    EXPECT_FALSE(x->isTopLevel());

    set(x, parent, q);
    EXPECT_THAT(entriesOf(p, children), IsEmpty());
    EXPECT_EQ(targetOf(x, parent), q);

    clear(x, parent);
    EXPECT_TRUE(x->isTopLevel());
    EXPECT_THAT(entriesOf(q, children), IsEmpty());
}

TEST_F(ReflectiveReference, ToTheContainerIsThereOnlyInTheOppositeFeature)
{
    ModelElement const p = make(node), x = make(node);
    genericOf(p, others).genericAdd(x);

    EXPECT_EQ(x->container(), p);
    EXPECT_FALSE(has(x, parent));
    EXPECT_FALSE(targetOf(x, parent));
    EXPECT_TRUE(has(x, otherParent));
    EXPECT_EQ(targetOf(x, otherParent), p);
}

TEST_F(ReflectiveReference, ToTheContainerIsLeftAloneWhenAnotherFeatureHoldsTheElement)
{
    ModelElement const p = make(node), x = make(node);
    genericOf(p, others).genericAdd(x);
    ScriptedListener listener;
    listen(model, listener);

    clear(x, parent);  // would need a transaction

    EXPECT_EQ(targetOf(x, otherParent), p);
}

TEST_F(ReflectiveReference, ToTheContainerMovesTheElementFromAnyFeature)
{
    ModelElement const p = make(node), q = make(node), x = make(node);
    genericOf(p, others).genericAdd(x);

    set(x, parent, q);

    EXPECT_THAT(entriesOf(p, others), IsEmpty());
    EXPECT_THAT(entriesOf(q, children), ElementsAre(x));
    EXPECT_FALSE(has(x, otherParent));
}

TEST_F(ReflectiveReference, ThatIsCompositeContainsItsTarget)
{
    ModelElement const a = make(node), b = make(node), c = make(node), z = make(node);

    set(a, core, b);
    EXPECT_EQ(b->container(), a);
    EXPECT_EQ(b->containmentFeature(), core);
    set(a, core, c);
    EXPECT_TRUE(b->isTopLevel()) << "the one that was replaced is released";
    EXPECT_EQ(c->container(), a);
    set(z, core, c);
    EXPECT_FALSE(targetOf(a, core)) << "the one that moved has left";
    clear(z, core);
    EXPECT_TRUE(c->isTopLevel());

    set(a, body, b);
    EXPECT_EQ(targetOf(b, host), a);
    set(b, host, z);
    EXPECT_FALSE(targetOf(a, body));
    EXPECT_EQ(targetOf(z, body), b);
    set(z, body, c);
    EXPECT_TRUE(b->isTopLevel());
}

TEST_F(ReflectiveReference, DoesNotCloseACircleOfContainment)
{
    ModelElement const a = make(node), b = make(node), c = make(node);
    set(b, parent, a);
    set(c, parent, b);

    EXPECT_RAISES(messages::CircularContainment, set(a, parent, c));
    EXPECT_RAISES(messages::CircularContainment, set(a, parent, a));
    EXPECT_RAISES(messages::CircularContainment, set(c, core, a));
    EXPECT_RAISES(messages::CircularContainment, genericOf(c, children).genericAdd(a));

    EXPECT_TRUE(a->isTopLevel());
    EXPECT_EQ(targetOf(b, parent), a);
}

TEST_F(ReflectiveReference, DoesNotLeadAcrossModelsIfItContains)
{
    Model const elsewhere = Model::create(ModelConstellation());
    ModelElement const here = make(node);
    ModelElement const there = ModelElement::createReflective(elsewhere, node);

    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, set(here, core, there));
    EXPECT_RAISES(messages::CannotChangeModel, set(here, parent, there));
    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation,
                  genericOf(here, children).genericAdd(there));

    EXPECT_TRUE(here->isTopLevel());
    EXPECT_TRUE(there->isTopLevel());
    EXPECT_FALSE(targetOf(here, core));
    set(here, buddy, there);
    EXPECT_EQ(targetOf(here, buddy), there) << "a plain reference may";
    clear(here, buddy);
}

TEST_F(ReflectiveReference, ThatIsSetOnceMayBeSetWhileItIsNull)
{
    meta::Property const once = metamodel.property(node, u"once", node).readOnly().setOnce();
    ModelElement const a = make(node), b = make(node), c = make(node);

    set(a, once, b);
    set(a, once, b);  // the same element
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, set(a, once, c), u"once");
    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, clear(a, once), u"once");

    EXPECT_EQ(targetOf(a, once), b);
}

TEST_F(ReflectiveReference, FailsBeforeAnythingIsRecorded)
{
    Model const elsewhere = Model::create(ModelConstellation());
    ModelElement const a = make(node), b = make(node), x = make(stranger);
    ModelElement const there = ModelElement::createReflective(elsewhere, node);
    set(b, parent, a);
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = begin();

    EXPECT_RAISES(messages::CircularContainment, set(a, parent, b));
    EXPECT_RAISES(messages::CannotChangeModel, set(b, parent, there));
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, setValue(a, buddy, Value(stranger, x)));

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_THAT(listener.committed, IsEmpty());
    EXPECT_EQ(targetOf(b, parent), a);
}

TEST_F(ReflectiveReference, NeedsATransactionWhereTheModelDoes)
{
    ModelElement const a = make(node), b = make(node);
    ScriptedListener listener;
    listen(model, listener);

    EXPECT_RAISES(messages::NoOpenTransaction, set(a, left, b));
    EXPECT_RAISES(messages::NoOpenTransaction, set(a, parent, b));
    EXPECT_FALSE(targetOf(b, right));
    EXPECT_TRUE(a->isTopLevel());

    Transaction const transaction = begin();
    set(a, left, b);
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_THAT(listener.committed.at(0)->getChanged(), UnorderedElementsAre(a, b));
}

TEST_F(ReflectiveReference, IsNotListedTwiceByADocumentThatListsBothEnds)
{
    ModelElement const p = make(node), x = make(node);
    {
        Model::ParseInProgressIndicator const parsing(model);

        set(x, owner, p);
        EXPECT_THAT(entriesOf(p, owned), IsEmpty()) << "left to the other side of the document";
        sequenceOf(p, owned).genericInsert(x, 0);
    }

    EXPECT_EQ(targetOf(x, owner), p);
    EXPECT_THAT(entriesOf(p, owned), ElementsAre(x));
}

TEST_F(ReflectiveReference, ToTheContainerIsEnteredWhileParsingToo)
{
    ModelElement const p = make(node), x = make(node);
    {
        Model::ParseInProgressIndicator const parsing(model);
        set(x, parent, p);
    }

    EXPECT_THAT(entriesOf(p, children), ElementsAre(x));
}

TEST_F(ReflectiveReference, OfAForeignPropertyIsRefusedByTheOtherEnd)
{
    meta::Property const foreign = metamodel.property(stranger, u"foreign", stranger);
    ModelElement const a = make(node), b = make(node);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, a->inverseAdd(b, foreign), u"foreign", u"rt.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, a->inverseRemove(b, foreign), u"foreign",
                       u"rt.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, a->inverseContainsProxyTo(b, foreign), u"foreign",
                       u"rt.Node");
}
}  // namespace
}  // namespace testkit
