// How values look in streams and in the messages of GoogleTest.
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/PrintTo.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/Language.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/RuntimeMetamodel.h"
#include "tests/support/Uuids.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <gtest/gtest-spi.h>

namespace testkit {

using ::testing::PrintToString;

string streamed(Value const& value)
{
    std::ostringstream out;
    out << value;
    return out.str();
}

/// A value of the standard type of `T`.
template <class T> Value valueOf(T const& payload)
{
    return Value(meta::standardTypeOf<T>(), payload);
}

Value integers(std::vector<int> const& numbers)
{
    return Value(StandardTypes::integerMeta, numbers);
}

class APrintedValue : public ::testing::Test
{
protected:
    Model const model = Model::create(ModelConstellation());
    RuntimeMetamodel metamodel;
};

TEST_F(APrintedValue, ShowsTypeAndTextForm)
{
    EXPECT_EQ(streamed(valueOf(42)), "Integer 42");
    EXPECT_EQ(streamed(valueOf(-3L)), "Integer64 -3");
    EXPECT_EQ(streamed(valueOf(static_cast<signed char>(65))), "Integer8 65");
    EXPECT_EQ(streamed(valueOf(true)), "Boolean true");
    EXPECT_EQ(streamed(valueOf(1.5)), "Real 1.5");
    EXPECT_EQ(streamed(valueOf(uuidOf(7))), "UUID 00000007-0000-0000-0000-000000000001");
    EXPECT_EQ(streamed(valueOf(boost::posix_time::ptime())).substr(0, 9), "DateTime ");
}

TEST_F(APrintedValue, ShowsTextsInQuotes)
{
    EXPECT_EQ(streamed(valueOf(ustring(u"caf\u00e9"))), "String \"caf\xC3\xA9\"");
    EXPECT_EQ(streamed(valueOf(string("a \"b\""))), "StdString \"a \\\"b\\\"\"");
}

TEST_F(APrintedValue, IsTheSameInMessagesOfGoogleTest)
{
    EXPECT_EQ(PrintToString(valueOf(42)), "Integer 42");
    EXPECT_NONFATAL_FAILURE(EXPECT_EQ(valueOf(42), valueOf(ustring(u"b"))), "Integer 42");
    EXPECT_NONFATAL_FAILURE(EXPECT_EQ(valueOf(42), valueOf(ustring(u"b"))), "String \"b\"");
}

TEST_F(APrintedValue, ShowsTheShapeOfAnOptionalOne)
{
    meta::Type const& integer = StandardTypes::integerMeta;

    EXPECT_EQ(streamed(Value(integer, boost::optional<int>(5))), "OptionalSingle of Integer 5");
    EXPECT_EQ(streamed(Value(integer, boost::optional<int>())),
              "OptionalSingle of Integer, absent");
}

TEST_F(APrintedValue, ShowsAnElementAsItsHandle)
{
    Node const node = Node::create(model, uuidOf(7));
    node->setName(u"alpha");

    EXPECT_EQ(streamed(Value(Node::metaClass(), node)),
              "Node Node \"alpha\" 00000007-0000-0000-0000-000000000001");
    EXPECT_EQ(streamed(Value(Node::metaClass(), Node())), "Node empty handle");
    EXPECT_EQ(streamed(valueOf(model)), "TarnModel " + PrintToString(model));
}

TEST_F(APrintedValue, ShowsALiteralByItsName)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"green"});

    EXPECT_EQ(streamed(Value(colour, 1L)), "Colour green");
    EXPECT_EQ(streamed(Value(colour, -7L)), "Colour -7") << "no literal has that number";
    EXPECT_EQ(streamed(valueOf(meta::Language::Unknown)), "Language Unknown");
}

TEST_F(APrintedValue, ShowsTheFieldsOfADataType)
{
    meta::DataType const address = metamodel.makeDataType(u"Address");
    meta::DataType const place = metamodel.makeDataType(u"Place");
    meta::Property const city = metamodel.field(address, u"city", StandardTypes::stringMeta);
    metamodel.field(address, u"number", StandardTypes::integerMeta);
    metamodel.field(address, u"place", place).required();
    metamodel.field(place, u"x", StandardTypes::realMeta).required();
    ReflectiveDataType object(address);
    object.setPropertyValue(city, valueOf(ustring(u"Bath")));

    EXPECT_EQ(streamed(Value::createReflectiveDataTypeValue(object)),
              "Address {city: \"Bath\", number: absent, place: {x: 0}}");
    EXPECT_EQ(streamed(Value::createReflectiveDataTypeValue(address, /*required=*/false)),
              "OptionalSingle of Address, absent");
    EXPECT_EQ(streamed(valueOf(meta::ExtensionPrototype())),
              "ExtensionPrototype {isOrdered: false, isUnique: true, lower: 0, name: \"\", "
              "typeName: \"\", upper: 1}");
}

TEST_F(APrintedValue, ShowsTheEntriesOfAContainer)
{
    EXPECT_EQ(streamed(integers({3, 5})), "Sequence of Integer {3, 5}");
    EXPECT_EQ(streamed(Value(StandardTypes::stringMeta, std::set<ustring>{u"b", u"a"})),
              "Set of String {\"a\", \"b\"}");
    EXPECT_EQ(streamed(integers({})), "Sequence of Integer {}");
}

TEST_F(APrintedValue, CutsALongContainer)
{
    string const text = streamed(integers(std::vector<int>(40, 1)));

    EXPECT_TRUE(text.ends_with(", 1, and 8 more}")) << text;
    EXPECT_EQ(std::count(text.begin(), text.end(), '1'), 32);
}

TEST_F(APrintedValue, ShowsTheEntriesOfAnElementsCollection)
{
    Node const node = Node::create(model);
    node->getNumbers().push_back(3);
    node->getNumbers().push_back(5);
    meta::Property const numbers = Node::metaClass()->getPropertyByName(u"numbers");

    EXPECT_EQ(streamed(node->getPropertyValue(numbers, ModelElement::Impl::PUBLIC_ACCESS)),
              "Sequence of Integer {3, 5}");
    EXPECT_EQ(streamed(Value::createCollectionValue(numbers, nullptr)),
              "Sequence of Integer, absent");
}

TEST_F(APrintedValue, CanBeShownThoughAssignmentLostItsEntries)
{
    Value value = valueOf(1);
    value = integers({3, 5});

    EXPECT_EQ(streamed(value), "Sequence of Integer {something that can't be taken out}");
}

TEST_F(APrintedValue, CanBeShownThoughItsTypeIsGone)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red"});
    Value const red(colour, 0L);
    meta::DataType const address = metamodel.makeDataType(u"Address");
    Value const home = Value::createReflectiveDataTypeValue(address, /*required=*/true);
    colour->destroy();
    address->destroy();

    EXPECT_EQ(streamed(red), "Colour something without a text form");
    EXPECT_EQ(streamed(home), "Address something without a text form");
}

TEST_F(APrintedValue, WasMovedFrom)
{
    Value value = valueOf(42);
    Value const moved = std::move(value);

    EXPECT_EQ(streamed(moved), "Integer 42");
    EXPECT_EQ(streamed(value), "Integer, absent");
}

TEST(APrintedShape, IsTheNameOfTheShape)
{
    EXPECT_EQ(PrintToString(ValueFlags::OptionalSingle), "OptionalSingle");
    EXPECT_EQ(PrintToString(ValueFlags::Single), "Single");
    EXPECT_EQ(PrintToString(ValueFlags::Sequence), "Sequence");
    EXPECT_EQ(PrintToString(ValueFlags::Set), "Set");
    EXPECT_EQ(PrintToString(ValueFlags::Map), "Map");
    EXPECT_EQ(PrintToString(ValueFlags::Multimap), "Multimap");
    EXPECT_EQ(PrintToString(static_cast<ValueFlags>(4)), "4");
}
}  // namespace testkit
