// What a builder refuses, and what is left of a failed creation.
#include "tarnkiln/meta/ClassBuilder.h"
#include "tests/kernel/NodeBuildingFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/ScriptedListener.h"
#include "tests/support/SpecialNodeBuilder.h"
#include "tests/support/Uuids.h"

#include <stdexcept>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using FailedBuilding = NodeBuilding;

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
}  // namespace testkit
