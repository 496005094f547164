// What a builder does for each shape of property, given by its setters.
#include "tests/kernel/NodeBuildingFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeBuilder.h"
#include "tests/support/Uuids.h"

#include <boost/optional/optional_io.hpp>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Orchestrator = ModelElement::Builder::Orchestrator;
using BuiltValues = NodeBuilding;
using BuiltReferences = NodeBuilding;
using BuiltContents = NodeBuilding;
using OrchestratedBuilding = NodeBuilding;
using BuilderOfAStandIn = NodeBuilding;

// ---------------------------------------------------------------------------- plain values

TEST_F(BuiltValues, AreThoseOfTheSetters)
{
    m_builder.setName(u"a").setCount(3).setWeight(1.5).setIsOpen(false).setTag("red");
    m_builder.setToken(uuidOf(7)).setRank(4).setNote(u"seen");
    m_builder.addNumbers({3, 1, 3}).addLabels(u"x").addLabels({u"y", u"x"}).addWords({u"b", u"a"});

    Node const made = Node::cast(m_builder.create(uuidOf(1)));

    EXPECT_EQ(made->getUuid(), uuidOf(1));
    EXPECT_EQ(made->getName(), u"a");
    EXPECT_EQ(made->getCount(), 3);
    EXPECT_EQ(made->getWeight(), 1.5);
    EXPECT_FALSE(made->isOpen());
    EXPECT_EQ(made->getTag(), "red");
    EXPECT_EQ(made->getToken(), uuidOf(7));
    EXPECT_EQ(made->getRank(), boost::optional<int>(4));
    EXPECT_EQ(made->getNote().value(), u"seen");
    EXPECT_THAT(made->getNumbers().getEntries(), ElementsAre(3, 1, 3));
    EXPECT_THAT(made->getLabels().getEntries(), ElementsAre(u"x", u"y"));
    EXPECT_THAT(made->getWords().getEntries(), ElementsAre(u"a", u"b"));
}

TEST_F(BuiltValues, AreTheInitialOnesWhereNothingWasGiven)
{
    Node const made = build(m_builder);

    EXPECT_EQ(made->getName(), u"");
    EXPECT_TRUE(made->isOpen());
    EXPECT_EQ(made->getRank(), boost::none);
    EXPECT_FALSE(made->hasBuddy());
    EXPECT_FALSE(made->hasNumbers());
    EXPECT_FALSE(made->hasChildren());
}

TEST_F(BuiltValues, AreTheLastOnesGiven)
{
    m_builder.setCount(1).setCount(2).setRank(3).setRank(boost::none);
    m_builder.addNumbers(1).clearNumbers().addNumbers(2);
    m_builder.addChildren(named(u"gone")).clearChildren().addChildren(named(u"stays"));

    Node const made = build(m_builder);

    EXPECT_EQ(made->getCount(), 2);
    EXPECT_EQ(made->getRank(), boost::none);
    EXPECT_THAT(made->getNumbers().getEntries(), ElementsAre(2));
    EXPECT_THAT(names(made->getChildren()), ElementsAre(u"stays"));
}

TEST_F(BuiltValues, IncludeThoseOfTheSuperclass)
{
    SpecialNode const mentor = SpecialNode::create(m_model);
    SpecialNode::Builder builder(m_model);
    builder.setLevel(5).setMentor(mentor).setName(u"special").addChildren(named(u"child"));

    SpecialNode const made = SpecialNode::cast(builder.create());

    EXPECT_EQ(made->getLevel(), 5);
    EXPECT_EQ(made->getMentor(), mentor);
    EXPECT_EQ(made->getName(), u"special");
    EXPECT_THAT(names(made->getChildren()), ElementsAre(u"child"));
    EXPECT_EQ(made->getMetaClass(), SpecialNode::metaClass());
}

TEST_F(BuiltValues, AreMarkedInTheBuilderByTheirSlots)
{
    for (unsigned long index = 0; index <= Node::Impl::SLOTS; ++index)
        EXPECT_FALSE(m_builder.isSet(index)) << index;

    m_builder.setIsOpen(true).clearWords().addChildren(named(u"a"));

    for (unsigned long index = 0; index <= Node::Impl::SLOTS; ++index)
    {
        bool const wasGiven = index == Node::Impl::IS_OPEN.index ||
                              index == Node::Impl::WORDS.index ||
                              index == Node::Impl::CHILDREN.index;
        EXPECT_EQ(m_builder.isSet(index), wasGiven) << index;
    }
}

TEST_F(BuiltValues, AreThereWhenTheElementIsAnnounced)
{
    std::vector<std::size_t> seen;
    whenAnnounced([&](Node const& made) { seen.push_back(made->getNumbers().size()); });
    m_builder.addNumbers({1, 2});

    build(m_builder);

    EXPECT_THAT(seen, ElementsAre(2));
}

// ---------------------------------------------------------------------------- references

TEST_F(BuiltReferences, AgreeAtBothEnds)
{
    Node const buddy = make();
    Node const left = make();
    Node const owner = make();
    Node const owned = make();
    Node const linked = make();
    Node const group = make();
    Node const mark = make();
    m_builder.setName(u"key").setBuddy(buddy).setLeft(left).setOwner(owner).addOwned(owned);
    m_builder.addLinks({linked}).setGroup(group).addMarks(mark);

    Node const made = build(m_builder);

    EXPECT_EQ(made->getBuddy(), buddy);
    EXPECT_EQ(made->getLeft(), left);
    EXPECT_EQ(left->getRight(), made);
    EXPECT_EQ(made->getOwner(), owner);
    EXPECT_THAT(owner->getOwned().getAllValues(), ElementsAre(made));
    EXPECT_EQ(owned->getOwner(), made);
    EXPECT_THAT(made->getOwned().getAllValues(), ElementsAre(owned));
    EXPECT_THAT(linked->getBacklinks().getAllValues(), ElementsAre(made));
    EXPECT_EQ(group->getGrouped().count(u"key"), 1u);
    EXPECT_THAT(mark->getMarkedBy().getAllValues(), ElementsAre(made));
}

TEST_F(BuiltReferences, ToAContainerPutTheElementIntoIt)
{
    Node const parent = make();
    Node const scope = make();
    m_builder.setParent(parent);
    Node::Builder scoped(m_model);
    scoped.setName(u"a").setScope(scope);

    Node const child = build(m_builder);
    Node const member = build(scoped);

    EXPECT_EQ(child->container(), parent);
    EXPECT_THAT(parent->getChildren().getAllValues(), ElementsAre(child));
    EXPECT_EQ(scope->getByName().find(u"a"), member);
    EXPECT_FALSE(member->isTopLevel());
}

TEST_F(BuiltReferences, TakeInAnElementThatIsThereAlready)
{
    Node const core = make(u"core");
    Node const body = make(u"body");
    m_builder.setCore(core).setBody(body);

    Node const made = build(m_builder);

    EXPECT_EQ(made->getCore(), core);
    EXPECT_EQ(core->container(), made);
    EXPECT_EQ(body->getHost(), made);
}

// ---------------------------------------------------------------------------- contents

TEST_F(BuiltContents, AreMadeInsideTheElement)
{
    m_builder.addChildren(named(u"c1")).addChildren(named(u"c2")).addParts(named(u"part"));
    m_builder.addByName(named(u"b")).addByName(named(u"a"));
    m_builder.setCore(named(u"core")).setBody(named(u"body"));

    Node const made = build(m_builder);

    EXPECT_THAT(names(made->getChildren()), ElementsAre(u"c1", u"c2"));
    EXPECT_THAT(names(made->getParts()), ElementsAre(u"part"));
    EXPECT_THAT(names(made->getByName()), ElementsAre(u"a", u"b"));
    EXPECT_EQ(made->getCore()->getName(), u"core");
    EXPECT_EQ(made->getBody()->getHost(), made);
    EXPECT_EQ(made->getChildren()[1]->getParent(), made);
    EXPECT_EQ(made->getParts()[0]->container(), made);
    EXPECT_THAT(m_model->getTopLevelElements(), ElementsAre(ModelElement(made)));
}

TEST_F(BuiltContents, MayBeOfASubclass)
{
    auto special = std::make_unique<SpecialNode::Builder>();
    special->setLevel(2).setName(u"special");
    m_builder.addChildren(std::move(special));

    Node const made = build(m_builder);

    EXPECT_EQ(SpecialNode::cast(made->getChildren()[0])->getLevel(), 2);
}

TEST_F(BuiltContents, NestToAnyDepthInOneTransaction)
{
    constexpr int DEPTH = 50;
    ScriptedListener listener;
    listen(m_model, listener);
    std::unique_ptr<Node::Builder> inner = named(u"50");
    for (int i = DEPTH - 1; i > 0; --i)
    {
        auto outer = std::make_unique<Node::Builder>();
        outer->setCount(i).addChildren(std::move(inner));
        inner = std::move(outer);
    }
    m_builder.addChildren(std::move(inner));

    Node last = build(m_builder);
    for (int i = 0; i < DEPTH; ++i)
        last = last->getChildren()[0];

    EXPECT_EQ(last->getName(), u"50");
    ASSERT_EQ(listener.committed.size(), 1u);
    EXPECT_EQ(listener.committed[0]->getCreated().size(), DEPTH + 1u);
    EXPECT_TRUE(listener.committed[0]->isDeep());
    m_model->removeListener(&listener);
}

TEST_F(BuiltContents, AreCreatedAfterTheirContainerInTheOrderOfTheProperties)
{
    std::vector<ustring> order;
    whenAnnounced([&](Node const& made) { order.push_back(made->getName()); });
    auto first = named(u"first");
    first->addChildren(named(u"first's child"));
    m_builder.setName(u"root").addByName(named(u"fourth")).setCore(named(u"third"));
    m_builder.addChildren(std::move(first)).addChildren(named(u"second"));

    build(m_builder);

    EXPECT_THAT(order,
                ElementsAre(u"root", u"first", u"first's child", u"second", u"third", u"fourth"));
}

TEST_F(BuiltContents, AreBuiltWhenTheReferencesAreSet)
{
    std::vector<bool> hadParent;
    Node const parent = make();
    whenAnnounced([&](Node const& made) {
        if (made->getName() == u"child")
            hadParent.push_back(parent->getChildren().size() == 1);
    });
    SpecialNode::Builder builder(m_model);
    builder.addChildren(named(u"child")).setParent(parent);

    builder.create();

    EXPECT_THAT(hadParent, ElementsAre(true));
}

TEST_F(BuiltContents, AreMadeAnewEachTime)
{
    m_builder.setName(u"twin").addChildren(named(u"child")).addNumbers({1});

    Node const first = build(m_builder);
    Node const second = build(m_builder);

    EXPECT_NE(first, second);
    EXPECT_EQ(second->getName(), u"twin");
    EXPECT_THAT(second->getNumbers().getEntries(), ElementsAre(1));
    ASSERT_EQ(second->getChildren().size(), 1u);
    EXPECT_NE(first->getChildren()[0], second->getChildren()[0]);
}

TEST_F(BuiltContents, LeaveTheContainerThatTheyWereGivenForTheOneThatBuildsThem)
{
    Node const given = make();
    auto child = named(u"child");
    child->setParent(given);
    m_builder.addChildren(std::move(child));

    Node const made = build(m_builder);

    EXPECT_EQ(made->getChildren()[0]->getParent(), made);
    EXPECT_TRUE(given->getChildren().empty());
}

TEST_F(BuiltContents, IgnoreTheBuilderThatIsNone)
{
    m_builder.addChildren(nullptr);

    EXPECT_FALSE(build(m_builder)->hasChildren());
}

// ---------------------------------------------------------------------------- orchestration

TEST_F(OrchestratedBuilding, BuildsABuilderOnce)
{
    m_builder.addChildren(named(u"child"));
    Orchestrator orchestrator(&m_builder);

    ModelElement const first = m_builder.create(uuidOf(1));
    ModelElement const second = m_builder.create(uuidOf(2));
    orchestrator.commit();

    EXPECT_EQ(first, second);
    EXPECT_EQ(second->getUuid(), uuidOf(1));
    EXPECT_EQ(m_model->getElementCount(), 2u);
}

TEST_F(OrchestratedBuilding, BuildsAnewWhatWasDestroyedMeanwhile)
{
    Orchestrator orchestrator(&m_builder);
    ModelElement const first = m_builder.create();
    first->destroy();

    ModelElement const second = m_builder.create();
    orchestrator.commit();

    EXPECT_NE(first, second);
    EXPECT_TRUE(second);
}

TEST_F(OrchestratedBuilding, KnowsTheElementWhileItsContentsAreBuilt)
{
    auto child = named(u"child");
    Node::Builder* const inner = child.get();
    m_builder.setName(u"root").addChildren(std::move(child));
    Orchestrator orchestrator(&m_builder);

    ModelElement const root = m_builder.create();

    EXPECT_EQ(orchestrator.getCreatedElement(&m_builder), root);
    EXPECT_EQ(orchestrator.getCreatedElement(inner), Node::cast(root)->getChildren()[0]);
    EXPECT_EQ(inner->getModel(), m_model);
    EXPECT_EQ(inner->getOrchestrator(), &orchestrator);
    orchestrator.commit();
    EXPECT_EQ(inner->getOrchestrator(), nullptr);
}

TEST_F(OrchestratedBuilding, JoinsTheOpenTransaction)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    m_builder.addChildren(named(u"child"));
    Node const made = build(m_builder);

    EXPECT_TRUE(made);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_FALSE(made);
    EXPECT_EQ(m_model->getElementCount(), 0u);
}

// ---------------------------------------------------------------------------- stand-ins

TEST_F(BuilderOfAStandIn, GivesItPlainValuesAndReferencesNobodyElseSees)
{
    Node const left = make();
    m_builder.setName(u"a").addNumbers({1}).setLeft(left).addChildren(named(u"child"));

    Node const proxy = Node::cast(m_builder.createProxy(ProxyId()));

    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(proxy->getName(), u"a");
    EXPECT_FALSE(left->hasRight());
    EXPECT_EQ(m_model->getElementCount(), 1u);
}

TEST_F(BuilderOfAStandIn, IsNoElementOfTheCreationThatItTakesPartIn)
{
    Orchestrator orchestrator(&m_builder);

    ModelElement const proxy = m_builder.createProxy(ProxyId());
    ModelElement const made = m_builder.create();
    orchestrator.commit();

    EXPECT_NE(proxy, made);
    EXPECT_FALSE(made->isProxy());
}
}  // namespace testkit
