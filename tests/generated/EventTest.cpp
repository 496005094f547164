// Operations that wait for the end of a transaction.
#include "shapes/BellImpl.h"
#include "shapes/BellMetEvent.h"
#include "shapes/BellRungEvent.h"
#include "shapes/GongImpl.h"
#include "shapes/NodeImpl.h"
#include "shapes/VaultImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tests/generated/ShapesFixture.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

namespace testkit::shapes {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// A bell that is rung by a node.
class GeneratedEvent : public ShapesTest
{
protected:
    GeneratedEvent() { node->setName(u"somebody"); }

    Transaction begin() const { return m_model->beginTransaction(/*revertible=*/true); }
    void ring(Bell const& rung, int times) const
    {
        rung->rung(times, node, {u"ding", u"dong"}, Colour::Red, ustring(u"noon"), true);
    }
    static meta::Operation operation(meta::Class const& owner, ustring const& name)
    {
        return owner->getOperationsByName(name).at(0);
    }
    std::vector<ustring> log() const { return {bell->getLog().begin(), bell->getLog().end()}; }

    Bell const bell = Bell::create(m_model);
    Node node = Node::create(m_model);
};

TEST_F(GeneratedEvent, WaitsForTheEndOfTheTransaction)
{
    Transaction const transaction = begin();
    ring(bell, 3);
    EXPECT_EQ(bell->getStrokes(), 0);

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_EQ(bell->getStrokes(), 3);
    EXPECT_THAT(log(), ElementsAre(u"somebody", u"ding", u"dong", u"noon", u"red and loud"));
}

TEST_F(GeneratedEvent, HappensAtOnceWhereNoTransactionIsOpen)
{
    ring(bell, 3);

    EXPECT_EQ(bell->getStrokes(), 3);
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
}

TEST_F(GeneratedEvent, IsDroppedByARollback)
{
    Transaction const transaction = begin();
    ring(bell, 3);

    transaction.rollBack();

    EXPECT_EQ(bell->getStrokes(), 0);
    EXPECT_THAT(log(), IsEmpty());
}

TEST_F(GeneratedEvent, ComesInTheOrderOfTheCalls)
{
    Transaction const transaction = begin();
    bell->hung();
    bell->rung(1, Node(), {}, Colour::Green, boost::none, false);
    bell->hung();

    transaction.commit();

    EXPECT_THAT(log(), ElementsAre(u"hung", u"anything else", u"hung"));
}

TEST_F(GeneratedEvent, KeepsItsArguments)
{
    BellRungEvent const event(bell, 3, node, {u"ding"}, Colour::Green, ustring(u"noon"), true);

    EXPECT_EQ(event.getOwner(), bell);
    EXPECT_EQ(event.getOperation(), operation(Bell::metaClass(), u"rung"));
    EXPECT_EQ(event.getTimes(), 3);
    EXPECT_EQ(event.getBy(), node);
    EXPECT_THAT(event.getWords(), ElementsAre(u"ding"));
    EXPECT_EQ(event.getColour(), Colour::Green);
    EXPECT_EQ(event.getNote().value(), u"noon");
    EXPECT_TRUE(event.isLoud());
}

TEST_F(GeneratedEvent, HoldsItsElementsInMemory)
{
    BellRungEvent const event(bell, 3, node, {}, Colour::Green, boost::none, true);
    ElementImpl const* const impl = node.getImpl();
    node->destroy();
    node = Node();

    EXPECT_EQ(event.getBy().getElementImpl(), impl);
    EXPECT_FALSE(event.getBy());
}

TEST_F(GeneratedEvent, TakesManyElements)
{
    Bell const other = Bell::create(m_model);
    other->setStrokes(4);

    bell->met({other, other});

    EXPECT_EQ(bell->getStrokes(), 8);
    EXPECT_THAT(BellMetEvent(bell, {other}).getBells(), ElementsAre(other));
}

TEST_F(GeneratedEvent, IsNotForADestroyedElement)
{
    Transaction const transaction = begin();
    ring(bell, 3);
    bell->destroy();

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

    EXPECT_EQ(bell->getStrokes(), 0);
}

TEST_F(GeneratedEvent, RunsWhatASubclassMakesOfIt)
{
    Gong const gong = Gong::create(m_model);

    ring(gong, 3);

    EXPECT_EQ(gong->getStrokes(), 30);
}

TEST_F(GeneratedEvent, MayBeAbstract)
{
    Vault const vault = Vault::create(m_model);
    Guarded const guarded = vault;
    Transaction const transaction = begin();
    guarded->opened();
    EXPECT_FALSE(vault->getPrice().isFinal());

    transaction.commit();

    EXPECT_TRUE(vault->getPrice().isFinal());
}

TEST_F(GeneratedEvent, WaitsWhenItIsCalledByReflectionToo)
{
    meta::Operation const hung = operation(Bell::metaClass(), u"hung");
    Transaction const transaction = begin();

    boost::optional<Value> const result = bell->invoke(hung, {}, ModelElement::Impl::PUBLIC_ACCESS);

    EXPECT_FALSE(result);
    EXPECT_THAT(log(), IsEmpty());
    transaction.commit();
    EXPECT_THAT(log(), ElementsAre(u"hung"));
}

TEST_F(GeneratedEvent, IsAnOperationOfEachClassThatGivesItABody)
{
    meta::Operation const ofBell = operation(Bell::metaClass(), u"rung");
    meta::Operation const ofGong = operation(Gong::metaClass(), u"rung");
    Gong const gong = Gong::create(m_model);
    std::vector<Value> const arguments{
        Value(meta::StandardTypes::integerMeta, 2),
        Value(Node::metaClass(), node),
        Value(meta::StandardTypes::stringMeta, std::vector<ustring>{}),
        Value(ShapesMetaPackage::getInstance().getEnum(rows::enumerations::Colour), 3L),
        Value(meta::StandardTypes::stringMeta, boost::optional<ustring>()),
        Value(meta::StandardTypes::booleanMeta, true)};

    gong->invoke(ofGong, arguments, ModelElement::Impl::PUBLIC_ACCESS);
    gong->invoke(ofBell, arguments, ModelElement::Impl::PUBLIC_ACCESS);

    EXPECT_NE(ofBell, ofGong);
    EXPECT_TRUE(ofBell->isEvent());
    EXPECT_TRUE(ofGong->isEvent());
    EXPECT_FALSE(operation(Vault::metaClass(), u"paint")->isEvent());
    EXPECT_EQ(gong->getStrokes(), 40);
}

TEST_F(GeneratedEvent, IsRefusedByAModelThatIsBeingValidated)
{
    ScriptedListener listener;
    listener.onValidate = [&](Report const&) {
        EXPECT_RAISES(messages::ChangesProhibited, ring(bell, 1));
        return true;
    };
    listen(m_model, listener);
    Transaction const transaction = begin();
    node->setName(u"somebody else");

    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);

    EXPECT_EQ(bell->getStrokes(), 0);
}
}  // namespace
}  // namespace testkit::shapes
