// Where generated classes say that they keep their values, for readers of many elements.
#include "tarnkiln/kernel/StoredField.h"
#include "shapes/NodeImpl.h"
#include "shapes/OptionalsImpl.h"
#include "shapes/ScalarsImpl.h"
#include "shapes/ValuesImpl.h"
#include "shapes/VaultImpl.h"
#include "tests/generated/ShapesFixture.h"

#include <boost/optional.hpp>

#include <type_traits>
#include <typeinfo>

namespace testkit::shapes {
namespace {

/// A class of a client, which could override anything.
class OwnScalars : public Scalars::Impl
{
public:
    using Scalars::Impl::Impl;
};

class StoredFields : public ShapesTest
{
protected:
    static StoredField find(ModelElement const& element, ustring const& name)
    {
        return element->findStoredField(property(element->getMetaClass(), name));
    }
    /// What lies at the place of a plain field.
    template <class T> static T valueAt(ModelElement const& element, StoredField const& field)
    {
        auto const* const begin = reinterpret_cast<char const*>(element.getImpl());
        return *reinterpret_cast<T const*>(begin + field.offset);
    }
    static void expectNone(StoredField const& field)
    {
        EXPECT_EQ(field.type, nullptr);
        EXPECT_EQ(field.target, nullptr);
    }
};

TEST_F(StoredFields, LeadToRequiredValues)
{
    Scalars const scalars = Scalars::create(m_model);
    scalars->setText(u"word");
    scalars->setInteger(-7);

    StoredField const text = find(scalars, u"text");
    ASSERT_TRUE(text.type && *text.type == typeid(ustring));
    EXPECT_EQ(valueAt<ustring>(scalars, text), u"word");
    StoredField const integer = find(scalars, u"integer");
    ASSERT_TRUE(integer.type && *integer.type == typeid(int));
    EXPECT_FALSE(integer.isLiteral);
    EXPECT_EQ(integer.target, nullptr);
    EXPECT_EQ(valueAt<int>(scalars, integer), -7);
    StoredField const money = find(scalars, u"money");
    EXPECT_TRUE(money.type && *money.type == typeid(Money));
}

TEST_F(StoredFields, LeadToOptionalValues)
{
    Optionals const optionals = Optionals::create(m_model);
    StoredField const integer = find(optionals, u"integer");
    ASSERT_TRUE(integer.type && *integer.type == typeid(boost::optional<int>));

    EXPECT_FALSE(valueAt<boost::optional<int>>(optionals, integer));
    optionals->setInteger(3);
    EXPECT_TRUE(valueAt<boost::optional<int>>(optionals, integer) == 3);
}

TEST_F(StoredFields, TellLiteralsFromNumbers)
{
    Scalars const scalars = Scalars::create(m_model);
    scalars->setColour(Colour::Red);

    StoredField const colour = find(scalars, u"colour");
    EXPECT_TRUE(colour.isLiteral);
    ASSERT_TRUE(colour.type && *colour.type == typeid(std::underlying_type_t<Colour>));
    EXPECT_EQ(valueAt<Colour>(scalars, colour), Colour::Red);
}

TEST_F(StoredFields, GiveTargetsAsTheyAre)
{
    Node const node = Node::create(m_model);
    Node const buddy = Node::create(m_model);
    StoredField const field = find(node, u"buddy");
    ASSERT_NE(field.target, nullptr);
    EXPECT_EQ(field.type, nullptr);
    EXPECT_EQ(field.target(*node.getImpl()), nullptr);

    node->setBuddy(buddy);
    EXPECT_EQ(field.target(*node.getImpl()), buddy.getImpl());

    ModelElement const proxy = ModelElement::createProxy(
        m_model, Node::metaClass(), ProxyId(ElementId::UUID_TYPE, u"nobody", boost::none));
    node->setBuddy(Node::cast(proxy));
    EXPECT_EQ(field.target(*node.getImpl()), proxy.getImpl());
}

TEST_F(StoredFields, GiveContainersLikeReferences)
{
    Node const node = Node::create(m_model);
    Node const parent = Node::create(m_model);
    StoredField const field = find(node, u"parent");
    ASSERT_NE(field.target, nullptr);
    EXPECT_EQ(field.target(*node.getImpl()), nullptr);

    parent->getChildren().push_back(node);
    EXPECT_EQ(field.target(*node.getImpl()), parent.getImpl());
}

TEST_F(StoredFields, AreMissingForAllElse)
{
    Scalars const scalars = Scalars::create(m_model);
    expectNone(find(Values::create(m_model), u"numbers"));
    expectNone(find(Node::create(m_model), u"children"));
    expectNone(find(Vault::create(m_model), u"summary"));
    expectNone(scalars->findStoredField(property(Optionals::metaClass(), u"integer")));
    expectNone(scalars->findStoredField(meta::Property()));
}

TEST_F(StoredFields, AreTrustedInGeneratedClassesOnly)
{
    EXPECT_TRUE(Scalars::create(m_model)->isReadByFields());
    EXPECT_TRUE(Node::create(m_model)->isReadByFields());

    ModelElement const own(new OwnScalars(m_model, UUID{{1}}));
    own->notifyCreated();
    EXPECT_FALSE(own->isReadByFields());
}
}  // namespace
}  // namespace testkit::shapes
