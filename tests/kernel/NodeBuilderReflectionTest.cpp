// What a builder does with the values that it gets by reflection.
#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/kernel/NodeBuildingFixture.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/SpecialNodeBuilder.h"
#include "tests/support/Uuids.h"

#include <boost/optional/optional_io.hpp>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ReflectiveBuilding = NodeBuilding;

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
}  // namespace testkit
