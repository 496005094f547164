// What a builder does for each shape of property, given by its setters and by reflection.
#include "tests/support/NodeBuilder.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/Package.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeBuilder.h"
#include "tests/support/Uuids.h"

#include <boost/optional/optional_io.hpp>
#include <gmock/gmock.h>

#include <functional>
#include <memory>
#include <stdexcept>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Orchestrator = ModelElement::Builder::Orchestrator;

class NodeBuilding : public ::testing::Test
{
protected:
    ~NodeBuilding() override
    {
        EXPECT_THAT(m_model->checkInvariants(), IsEmpty());
        EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
    }

    static meta::Property const& property(Slot const& slot)
    {
        return NodeMetamodel::get().properties[slot.index];
    }
    template <class T> static Value plain(Slot const& slot, T const& value)
    {
        return Value::createPrimitiveValue(property(slot), value);
    }
    static Value element(Slot const& slot, Node const& node)
    {
        return Value::createElementValue(property(slot), node);
    }
    static std::unique_ptr<Node::Builder> named(ustring const& name)
    {
        auto builder = std::make_unique<Node::Builder>();
        builder->setName(name);
        return builder;
    }
    Node make(ustring const& name = {})
    {
        Node const node = Node::create(m_model);
        node->setName(name);
        return node;
    }
    Node build(ModelElement::Builder& builder) { return Node::cast(builder.create()); }
    static std::vector<ustring> names(ReferenceCollection const& collection)
    {
        std::vector<ustring> result;
        for (ModelElement const& member : collection.getAllValues())
            result.push_back(Node::cast(member)->getName());
        return result;
    }

    /// Calls `seen` for each node that the model gets from now on, before it is in a container.
    void whenAnnounced(std::function<void(Node const&)> seen)
    {
        m_model->setUsageProvider(std::make_unique<Announcements>(std::move(seen)));
    }

    Model const m_model = Model::create(ModelConstellation());
    Node::Builder m_builder{m_model};

private:
    class Announcements : public meta::DataModelUsageProvider
    {
    public:
        explicit Announcements(std::function<void(Node const&)> seen) : m_seen(std::move(seen)) {}

        std::vector<meta::Package> getUsedPackages() const override { return {}; }
        void elementCreated(ModelElement::Impl* element) override
        {
            m_seen(Node::cast(ModelElement(element)));
        }

    private:
        std::function<void(Node const&)> m_seen;
    };
};

using BuiltValues = NodeBuilding;
using BuiltReferences = NodeBuilding;
using BuiltContents = NodeBuilding;
using ReflectiveBuilding = NodeBuilding;
using FailedBuilding = NodeBuilding;
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

// ---------------------------------------------------------------------------- reflection

TEST_F(ReflectiveBuilding, GivesTheSameElementAsTheSetters)
{
    using N = Node::Impl;
    Node const other = make(u"other");
    m_builder.setOrAdd(property(N::NAME), plain(N::NAME, ustring(u"a")));
    m_builder.setOrAdd(property(N::COUNT), plain(N::COUNT, 3));
    m_builder.setOrAdd(property(N::WEIGHT), plain(N::WEIGHT, 1.5));
    m_builder.setOrAdd(property(N::IS_OPEN), plain(N::IS_OPEN, false));
    m_builder.setOrAdd(property(N::TAG), plain(N::TAG, string("red")));
    m_builder.setOrAdd(property(N::TOKEN), plain(N::TOKEN, uuidOf(7)));
    m_builder.setOrAdd(property(N::RANK), plain(N::RANK, 4));
    m_builder.setOrAdd(property(N::NOTE), plain(N::NOTE, boost::optional<ustring>(u"seen")));
    m_builder.setOrAdd(property(N::BUDDY), element(N::BUDDY, other));
    m_builder.setOrAdd(property(N::LEFT), element(N::LEFT, other));
    m_builder.setOrAdd(property(N::OWNED), element(N::OWNED, other));
    m_builder.setOrAdd(property(N::LINKS), element(N::LINKS, other));
    m_builder.setOrAdd(property(N::MARKS), element(N::MARKS, other));
    m_builder.setOrAdd(property(N::PARENT), element(N::PARENT, other));
    m_builder.setOrAdd(property(N::CHILDREN), named(u"child"));
    m_builder.setOrAdd(property(N::BY_NAME), named(u"member"));
    m_builder.setOrAdd(property(N::CORE), named(u"core"));
    m_builder.setOrAdd(property(N::NUMBERS), plain(N::NUMBERS, 5));
    m_builder.setOrAdd(property(N::WORDS), plain(N::WORDS, ustring(u"word")));

    Node const made = build(m_builder);

    EXPECT_EQ(made->getName(), u"a");
    EXPECT_EQ(made->getCount(), 3);
    EXPECT_EQ(made->getWeight(), 1.5);
    EXPECT_FALSE(made->isOpen());
    EXPECT_EQ(made->getTag(), "red");
    EXPECT_EQ(made->getToken(), uuidOf(7));
    EXPECT_EQ(made->getRank(), boost::optional<int>(4));
    EXPECT_EQ(made->getNote().value(), u"seen");
    EXPECT_EQ(made->getBuddy(), other);
    EXPECT_EQ(made->getLeft(), other);
    EXPECT_THAT(names(made->getOwned()), ElementsAre(u"other"));
    EXPECT_THAT(names(made->getLinks()), ElementsAre(u"other"));
    EXPECT_THAT(names(made->getMarks()), ElementsAre(u"other"));
    EXPECT_EQ(made->getParent(), other);
    EXPECT_THAT(names(made->getChildren()), ElementsAre(u"child"));
    EXPECT_THAT(names(made->getByName()), ElementsAre(u"member"));
    EXPECT_EQ(made->getCore()->getName(), u"core");
    EXPECT_THAT(made->getNumbers().getEntries(), ElementsAre(5));
    EXPECT_THAT(made->getWords().getEntries(), ElementsAre(u"word"));
}

TEST_F(ReflectiveBuilding, OverwritesASingleValueAndAddsToMany)
{
    using N = Node::Impl;
    m_builder.setOrAdd(property(N::COUNT), plain(N::COUNT, 1));
    m_builder.setOrAdd(property(N::COUNT), plain(N::COUNT, 2));
    m_builder.setOrAdd(property(N::CORE), named(u"first"));
    m_builder.setOrAdd(property(N::CORE), named(u"last"));
    m_builder.setOrAdd(property(N::NUMBERS), plain(N::NUMBERS, 1));
    m_builder.setOrAdd(property(N::NUMBERS), plain(N::NUMBERS, 2));
    m_builder.setOrAdd(property(N::CHILDREN), named(u"c1"));
    m_builder.setOrAdd(property(N::CHILDREN), named(u"c2"));

    Node const made = build(m_builder);

    EXPECT_EQ(made->getCount(), 2);
    EXPECT_EQ(made->getCore()->getName(), u"last");
    EXPECT_THAT(made->getNumbers().getEntries(), ElementsAre(1, 2));
    EXPECT_THAT(names(made->getChildren()), ElementsAre(u"c1", u"c2"));
}

TEST_F(ReflectiveBuilding, AddsTheEntriesOfACollection)
{
    using N = Node::Impl;

    m_builder.addNumbers(1).setOrAdd(property(N::NUMBERS), plain(N::NUMBERS, std::vector{2, 3}));

    EXPECT_THAT(build(m_builder)->getNumbers().getEntries(), ElementsAre(1, 2, 3));
}

TEST_F(ReflectiveBuilding, MarksThePropertyAsGiven)
{
    using N = Node::Impl;

    m_builder.setOrAdd(property(N::COUNT), plain(N::COUNT, 0));
    m_builder.setOrAdd(property(N::CHILDREN), named(u"c"));

    EXPECT_TRUE(m_builder.isSet(N::COUNT.index));
    EXPECT_TRUE(m_builder.isSet(N::CHILDREN.index));
    EXPECT_FALSE(m_builder.isSet(N::WEIGHT.index));
}

TEST_F(ReflectiveBuilding, ReachesThePropertiesOfSuperclasses)
{
    SpecialNode::Builder builder(m_model);
    builder.setOrAdd(property(Node::Impl::COUNT), plain(Node::Impl::COUNT, 8));
    builder.setOrAdd(property(Node::Impl::CHILDREN), named(u"child"));
    builder.setOrAdd(property(SpecialNode::Impl::LEVEL), plain(SpecialNode::Impl::LEVEL, 9));

    SpecialNode const made = SpecialNode::cast(builder.create());

    EXPECT_EQ(made->getCount(), 8);
    EXPECT_EQ(made->getLevel(), 9);
    EXPECT_EQ(made->getChildren().size(), 1u);
}

TEST_F(ReflectiveBuilding, TakesABooleanThatHoldsNothingForFalse)
{
    using N = Node::Impl;

    m_builder.setOrAdd(property(N::IS_OPEN), plain(N::IS_OPEN, boost::optional<bool>()));

    EXPECT_FALSE(build(m_builder)->isOpen());
}

TEST_F(ReflectiveBuilding, RefusesAPropertyThatNoClassOfItsKnows)
{
    using S = SpecialNode::Impl;
    meta::Property const none;

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(property(S::LEVEL), plain(S::LEVEL, 1)), u"level",
                       u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(none, plain(Node::Impl::COUNT, 1)), u"", u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, m_builder.setOrAdd(none, named(u"a")), u"",
                       u"testkit.Node");
}

TEST_F(ReflectiveBuilding, RefusesABuilderForWhatIsNotComposite)
{
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(property(Node::Impl::BUDDY), named(u"a")), u"buddy",
                       u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(property(Node::Impl::LINKS), named(u"a")), u"links",
                       u"testkit.Node");
    EXPECT_FALSE(m_builder.isSet(Node::Impl::BUDDY.index));
}

TEST_F(ReflectiveBuilding, RefusesABuilderOfAnotherClassAndNone)
{
    auto stranger = std::make_unique<meta::Class::Builder>();

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(property(Node::Impl::CHILDREN), std::move(stranger)),
                       u"children", u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       m_builder.setOrAdd(property(Node::Impl::CHILDREN),
                                          std::unique_ptr<ModelElement::Builder>()),
                       u"children", u"testkit.Node");
}

TEST_F(ReflectiveBuilding, RefusesAnElementForContentsThatAreBuilt)
{
    Node const other = make();

    EXPECT_RAISES_WITH(
        messages::NoSuchProperty,
        m_builder.setOrAdd(property(Node::Impl::CHILDREN), element(Node::Impl::CHILDREN, other)),
        u"children", u"testkit.Node");
}

TEST_F(ReflectiveBuilding, KeepsWhatItHasWhenAValueIsOfAnotherType)
{
    m_builder.setCount(4).addNumbers(1);

    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        m_builder.setOrAdd(property(Node::Impl::COUNT), plain(Node::Impl::NAME, ustring(u"x"))),
        u"String");
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        m_builder.setOrAdd(property(Node::Impl::NUMBERS), plain(Node::Impl::NAME, ustring(u"x"))),
        u"String");
    EXPECT_FALSE(m_builder.isSet(Node::Impl::NAME.index));

    Node const made = build(m_builder);
    EXPECT_EQ(made->getCount(), 4);
    EXPECT_THAT(made->getNumbers().getEntries(), ElementsAre(1));
}

TEST_F(ReflectiveBuilding, StartsFromTheClass)
{
    std::unique_ptr<ModelElement::Builder> const builder =
        Node::metaClass()->instantiateBuilder(m_model);

    ASSERT_TRUE(builder);
    EXPECT_EQ(builder->getMetaClass(), Node::metaClass());
    EXPECT_EQ(builder->getModel(), m_model);
    EXPECT_TRUE(SpecialNode::cast(SpecialNode::metaClass()->instantiate(m_model, uuidOf(1))));
    EXPECT_EQ(m_model->findElement(uuidOf(1))->getMetaClass(), SpecialNode::metaClass());
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

// ---------------------------------------------------------------------------- failures

TEST_F(FailedBuilding, RefusesASecondElementOfAKey)
{
    auto inner = named(u"inner");
    inner->addByName(named(u"same")).addByName(named(u"same"));
    m_builder.addChildren(named(u"child")).addByName(std::move(inner));

    EXPECT_RAISES(messages::UniquenessConstraint, m_builder.create());

    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_THAT(m_model->getTopLevelElements(), IsEmpty());
    EXPECT_EQ(m_builder.getOrchestrator(), nullptr);
}

TEST_F(FailedBuilding, RefusesAKeyThatTheContainerHas)
{
    Node const scope = make();
    Node::Builder(m_model).setName(u"a").setScope(scope).create();
    m_builder.setName(u"a").setScope(scope);

    EXPECT_RAISES(messages::UniquenessConstraint, m_builder.create());

    EXPECT_EQ(scope->getByName().size(), 1u);
    EXPECT_EQ(m_model->getElementCount(), 2u);
}

TEST_F(FailedBuilding, RefusesContentsOfAnotherClass)
{
    m_builder.addChildren(named(u"child")).addChildren(std::make_unique<meta::Class::Builder>());

    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, m_builder.create());

    EXPECT_EQ(m_model->getElementCount(), 0u);
}

TEST_F(FailedBuilding, RefusesContentsOfAnotherModel)
{
    Model const elsewhere = Model::create(ModelConstellation());
    m_builder.addChildren(std::make_unique<Node::Builder>(elsewhere));

    EXPECT_RAISES(messages::CannotChangeModel, m_builder.create());

    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_EQ(elsewhere->getElementCount(), 0u);
}

TEST_F(FailedBuilding, RestoresWhatTheReferencesChanged)
{
    Node const left = make();
    Node const partner = make();
    partner->setLeft(left);
    Node const parent = make();
    m_builder.setLeft(left).setParent(parent);
    m_builder.addByName(named(u"same")).addByName(named(u"same"));

    EXPECT_RAISES(messages::UniquenessConstraint, m_builder.create());

    EXPECT_EQ(left->getRight(), partner);
    EXPECT_TRUE(parent->getChildren().empty());
    EXPECT_EQ(m_model->getElementCount(), 3u);
}

TEST_F(FailedBuilding, TakesBackWhatWasBuiltBeforeTheModelRefusedAPart)
{
    long const before = Node::liveCount();
    {
        Node::Builder builder(m_model);
        builder.setName(u"root").addChildren(named(u"first")).addChildren(named(u"second"));
        whenAnnounced([](Node const& made) {
            if (made->getName() == u"second")
                throw std::runtime_error("no");
        });

        EXPECT_THROW(builder.create(), std::runtime_error);
    }

    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_THAT(m_model->getTopLevelElements(), IsEmpty());
    EXPECT_EQ(Node::liveCount(), before);
}

TEST_F(FailedBuilding, GivesADeadElementIfAListenerRefusesIt)
{
    ScriptedListener listener;
    listen(m_model, listener);
    listener.onValidate = [](Report const&) { return false; };
    m_builder.addChildren(named(u"child"));

    Node const made = build(m_builder);

    EXPECT_FALSE(made);
    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_EQ(m_builder.getOrchestrator(), nullptr);
    m_model->removeListener(&listener);
}

TEST_F(FailedBuilding, MayBeTriedAgain)
{
    m_builder.addByName(named(u"same")).addByName(named(u"same"));
    EXPECT_RAISES(messages::UniquenessConstraint, m_builder.create());

    m_builder.clearByName().addByName(named(u"same"));

    EXPECT_EQ(build(m_builder)->getByName().size(), 1u);
}

TEST_F(FailedBuilding, KeepsNoElementInMemory)
{
    long const before = Node::liveCount();
    {
        Node::Builder builder(m_model);
        builder.addChildren(named(u"child")).addByName(named(u"a")).addByName(named(u"a"));

        EXPECT_RAISES(messages::UniquenessConstraint, builder.create());
    }

    EXPECT_EQ(Node::liveCount(), before);
}

TEST_F(FailedBuilding, RefusesABuilderWithoutModel)
{
    Node::Builder builder;

    EXPECT_RAISES(messages::CannotCreateWithoutModel, builder.create());
    EXPECT_RAISES(messages::CannotCreateWithoutModel, builder.createProxy(ProxyId()));
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
