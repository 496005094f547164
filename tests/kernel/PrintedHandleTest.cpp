// How handles and identifiers look in streams and in the messages of GoogleTest.
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/PrintTo.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/Operation.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/PlainElement.h"
#include "tests/support/RuntimeMetamodel.h"
#include "tests/support/Uuids.h"

#include <gtest/gtest-spi.h>

namespace testkit {

using ::testing::PrintToString;

constexpr char const* ID = "00000007-0000-0000-0000-000000000001";

template <class T> string streamed(T const& value)
{
    std::ostringstream out;
    out << value;
    return out.str();
}

/// Makes elements whose UUID is `ID`.
class APrintedHandle : public ::testing::Test
{
protected:
    Node node(ustring const& name) const
    {
        Node const made = Node::create(model, uuidOf(7));
        made->setName(name);
        return made;
    }
    ModelElement reflective(meta::Class const& metaClass) const
    {
        return ModelElement::createReflective(model, metaClass, uuidOf(7));
    }

    Model const model = Model::create(uuidOf(9), ModelConstellation());
    RuntimeMetamodel metamodel;
};

TEST_F(APrintedHandle, ShowsClassNameAndUuid)
{
    EXPECT_EQ(streamed(node(u"alpha")), string("Node \"alpha\" ") + ID);
}

TEST_F(APrintedHandle, IsTheSameInMessagesOfGoogleTest)
{
    Node const made = node(u"alpha");

    EXPECT_EQ(PrintToString(made), streamed(made));
    EXPECT_EQ(PrintToString(ModelElement(made)), streamed(made));
}

TEST_F(APrintedHandle, LetsAFailureTellItsElements)
{
    Node const made = node(u"alpha");
    string const expected = streamed(made);

    EXPECT_NONFATAL_FAILURE(EXPECT_EQ(made, Node()), expected);
    EXPECT_NONFATAL_FAILURE(EXPECT_EQ(made, Node()), "empty handle");
}

TEST_F(APrintedHandle, SaysThatItIsEmpty)
{
    EXPECT_EQ(streamed(Node()), "empty handle");
    EXPECT_EQ(streamed(Model()), "empty handle");
    EXPECT_EQ(streamed(ModelConstellation()), "empty handle");
}

TEST_F(APrintedHandle, SaysThatItsElementIsDestroyed)
{
    Node const made = node(u"alpha");

    made->destroy();

    EXPECT_EQ(streamed(made), string("Node ") + ID + " (destroyed)");
}

TEST_F(APrintedHandle, ShowsWhatAProxyStandsInFor)
{
    Node const proxy = Node::createProxy(model, ProxyId(ElementId::UUID_TYPE,
                                                        u"00000001-0000-4000-8000-000000000001",
                                                        ustring(u"file:other")));

    EXPECT_TRUE(streamed(proxy).ends_with(
        " (stands in for uuid:00000001-0000-4000-8000-000000000001 in file:other)"))
        << streamed(proxy);
}

TEST_F(APrintedHandle, ShowsNoNameWhereTheClassHasNone)
{
    meta::Class const shelf = metamodel.makeClass(u"Shelf");

    EXPECT_EQ(streamed(reflective(shelf)), string("Shelf ") + ID);
}

TEST_F(APrintedHandle, ShowsTheNameOfAReflectiveElementToo)
{
    meta::Class const shelf = metamodel.makeClass(u"Shelf");
    meta::Property const name =
        metamodel.property(shelf, u"name", StandardTypes::stringMeta).notReadable();
    ModelElement const made = reflective(shelf);

    EXPECT_EQ(streamed(made), string("Shelf ") + ID) << "an optional name that is not set";
    set(made, name, u"a \"quoted\" one");
    EXPECT_EQ(streamed(made), string("Shelf \"a \\\"quoted\\\" one\" ") + ID);
}

TEST_F(APrintedHandle, TakesNothingForANameButASingleText)
{
    meta::Class const number = metamodel.makeClass(u"Number");
    metamodel.property(number, u"name", StandardTypes::integerMeta);
    meta::Class const many = metamodel.makeClass(u"Many");
    metamodel.property(many, u"name", StandardTypes::stringMeta).many();
    meta::Class const derived = metamodel.makeClass(u"Derived");
    metamodel.property(derived, u"name", StandardTypes::stringMeta).derived();

    EXPECT_EQ(streamed(reflective(number)), string("Number ") + ID);
    model->findElement(uuidOf(7))->destroy();
    EXPECT_EQ(streamed(reflective(many)), string("Many ") + ID);
    model->findElement(uuidOf(7))->destroy();
    EXPECT_EQ(streamed(reflective(derived)), string("Derived ") + ID);
}

TEST_F(APrintedHandle, ShowsMetamodelElementsByTheirNames)
{
    EXPECT_EQ(streamed(StandardTypes::stringMeta).substr(0, 22), "PrimitiveType \"String\"");
    EXPECT_EQ(streamed(meta::Operation::metaClass()).substr(0, 17), "Class \"Operation\"");
}

TEST_F(APrintedHandle, ShowsAnElementWhoseClassIsNotThere)
{
    EXPECT_EQ(streamed(Plain::create(model, uuidOf(7))), string("element ") + ID);
}

TEST_F(APrintedHandle, ShowsAModelByItsUri)
{
    EXPECT_EQ(streamed(Model::createTransientModel(uuidOf(9))),
              "Model 00000009-0000-0000-0000-000000000001");
    model->setModelURI(u"file:books");
    EXPECT_EQ(streamed(model), "Model \"file:books\" 00000009-0000-0000-0000-000000000001");
    EXPECT_EQ(streamed(ModelConstellation::create()).substr(0, 19), "ModelConstellation ");
}

TEST_F(APrintedHandle, ChangesAndResolvesNothing)
{
    Node const target = node(u"alpha");
    Node const holder = Node::create(model);
    Node const proxy = Node::createProxy(model, target->getPersistentProxyId(/*omitModel=*/true));
    holder->setBuddy(proxy);

    streamed(holder);
    streamed(proxy);

    EXPECT_EQ(holder->getBuddyImpl(), proxy.getImpl());
}

// ---------------------------------------------------------------------------- identifiers

TEST(APrintedIdentifier, ShowsItsParts)
{
    EXPECT_EQ(streamed(ElementId(u"uuid", u"12")), "uuid:12");
    EXPECT_EQ(streamed(ProxyId(u"uuid", u"12")), "uuid:12");
    EXPECT_EQ(streamed(ProxyId(u"uuid", u"12", ustring())), "uuid:12");
    EXPECT_EQ(streamed(ProxyId(u"uuid", u"12", ustring(u"file:a"))), "uuid:12 in file:a");
    EXPECT_EQ(streamed(ModelId::parse(u"me@file:books")), "me@file:books");
    EXPECT_EQ(streamed(ModelId::parse(u"file:books")), "file:books");
}

TEST(APrintedIdentifier, IsTheSameInMessagesOfGoogleTest)
{
    EXPECT_EQ(PrintToString(ElementId(u"uuid", u"12")), "uuid:12");
    EXPECT_EQ(PrintToString(ProxyId(u"uuid", u"12")), "uuid:12");
    EXPECT_EQ(PrintToString(ModelId::parse(u"file:books")), "file:books");
    std::ostringstream uuid;
    PrintTo(uuidOf(7), &uuid);
    EXPECT_EQ(uuid.str(), ID);
}

TEST(APrintedResult, IsTheNameOfTheResult)
{
    EXPECT_EQ(streamed(TransactionResult::NotCompleted), "NotCompleted");
    EXPECT_EQ(streamed(TransactionResult::Committed), "Committed");
    EXPECT_EQ(streamed(TransactionResult::RolledBack), "RolledBack");
    EXPECT_EQ(streamed(TransactionResult::NotRevertible), "NotRevertible");
    EXPECT_EQ(streamed(static_cast<TransactionResult>(9)), "9");
}
}  // namespace testkit
