// Values of data types without a C++ class.
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/internal/compareValues.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <rapidcheck.h>

#include <cmath>

namespace tarn::kiln::meta {
namespace {

using tarn::kiln::internal::compareValues;
using Types = StandardTypes;

/// | Type | Field | Its type | Lower | Upper | Default |
/// |---|---|---|---|---|---|
/// | Address | city | String | 1 | 1 | Bath |
/// |         | number | Integer | 0 | 1 | |
/// |         | colour | Colour: Red 3, Blue -1 | 0 | 1 | |
/// |         | place | Point | 1 | 1 | |
/// |         | second | Point | 0 | 1 | |
/// |         | keeper | the class Person | 0 | 1 | |
/// | Point | x, y | Integer, Real | 1 | 1 | |
class StructuredValues : public OrdinarySketch
{
protected:
    StructuredValues()
    {
        Types::ensureInitialized();
        colour = named<Enum>(u"Colour");
        red = literal(u"Red", 3, colour);
        blue = literal(u"Blue", -1, colour);
        x = field(u"x", point, Types::integerMeta, 1);
        y = field(u"y", point, Types::realMeta, 1);
        city = field(u"city", address, Types::stringMeta, 1);
        city->setDefaultValue(ustring(u"Bath"));
        number = field(u"number", address, Types::integerMeta, 0);
        hue = field(u"colour", address, colour, 0);
        place = field(u"place", address, point, 1);
        second = field(u"second", address, point, 0);
        keeper = field(u"keeper", address, person, 0);
    }

    Property field(ustring const& name, DataType const& owner, Type const& type, unsigned int lower,
                   unsigned int upper = 1)
    {
        Property const made = property(name, owner);
        made->setType(type);
        made->setLower(lower);
        made->setUpper(upper);
        return made;
    }
    ReflectiveDataType pointAt(int abscissa, double ordinate) const
    {
        ReflectiveDataType made(point);
        made.setPropertyValue(x, Value(Types::integerMeta, abscissa));
        made.setPropertyValue(y, Value(Types::realMeta, ordinate));
        return made;
    }
    static Value text(ustring const& text) { return Value(Types::stringMeta, text); }

    DataType const point = named<DataType>(u"Point");
    DataType const address = named<DataType>(u"Address");
    Class const person = cls(u"Person");
    Enum colour;
    EnumLiteral red;
    EnumLiteral blue;
    Property x;
    Property y;
    Property city;
    Property number;
    Property hue;
    Property place;
    Property second;
    Property keeper;
};

using ReflectiveDataTypeValue = StructuredValues;
using ReflectiveDataTypeField = StructuredValues;
using ReflectiveDataTypeOrder = StructuredValues;
using ReflectiveDataTypeInAValue = StructuredValues;
using OrderOfValues = StructuredValues;

TEST_F(ReflectiveDataTypeValue, NeedsALiveType)
{
    address->setOwningPackage(package(u"post"));
    DataType const dead = named<DataType>(u"Dead");
    dead->destroy();

    EXPECT_RAISES_WITH(messages::NoSuchType, ReflectiveDataType{DataType()}, u"");
    EXPECT_RAISES(messages::NoSuchType, ReflectiveDataType{dead});
    EXPECT_RAISES(messages::NoSuchType, Value::createReflectiveDataTypeValue(dead, true));
    EXPECT_EQ(ReflectiveDataType(address).getDataType(), address);
}

TEST_F(ReflectiveDataTypeValue, IsCopiedWithItsFields)
{
    ReflectiveDataType const first = pointAt(1, 2);
    ReflectiveDataType second = first;

    second.setPropertyValue(x, Value(Types::integerMeta, 5));

    EXPECT_EQ(first.getPropertyValue(x).getValue<int>(), 1);
    EXPECT_EQ(second.getPropertyValue(x).getValue<int>(), 5);
    EXPECT_EQ(second.getPropertyValue(y).getValue<double>(), 2);
}

TEST_F(ReflectiveDataTypeField, HasItsDefaultUntilItIsSet)
{
    ReflectiveDataType value(address);

    EXPECT_EQ(value.getPropertyValue(city), text(u"Bath"));
    EXPECT_TRUE(value.getPropertyValue(number).isAbsent());
    EXPECT_TRUE(value.getPropertyValue(hue).isAbsent());
    EXPECT_EQ(value.getPropertyValue(keeper), Value::createEmptyValue(keeper));
    value.setPropertyValue(city, text(u"York"));
    EXPECT_EQ(value.getPropertyValue(city), text(u"York"));
}

TEST_F(ReflectiveDataTypeField, OfADataTypeStartsAsAReflectiveValue)
{
    ReflectiveDataType const value(address);

    Value const required = value.getPropertyValue(place);
    Value const optional = value.getPropertyValue(second);

    EXPECT_TRUE(required.isReflective());
    EXPECT_EQ(required.toReflectiveDataType(), pointAt(0, 0));
    EXPECT_TRUE(optional.isReflective());
    EXPECT_EQ(optional.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(optional.isAbsent());
    EXPECT_EQ(value.getDefaultValue(second), optional);
}

TEST_F(ReflectiveDataTypeField, KeepsADynamicDefaultOnceRead)
{
    Property const id = field(u"id", address, Types::uuidMeta, 1);
    id->setDefaultValue(ustring(u"random"));
    ReflectiveDataType const value(address);

    Value const first = value.getPropertyValue(id);

    EXPECT_EQ(value.getPropertyValue(id), first);
    EXPECT_FALSE(ReflectiveDataType(address).getPropertyValue(id) == first);
    EXPECT_EQ(ReflectiveDataType(value).getPropertyValue(id), first);
}

TEST_F(ReflectiveDataTypeField, MustBelongToTheDataType)
{
    address->setOwningPackage(package(u"post"));
    ReflectiveDataType value(address);
    Property const dead = field(u"dead", address, Types::stringMeta, 1);
    dead->destroy();

    EXPECT_RAISES_WITH(messages::NoSuchProperty, value.getPropertyValue(x), u"x", u"post.Address");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       value.setPropertyValue(x, Value(Types::integerMeta, 1)), u"x",
                       u"post.Address");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, value.getPropertyValue(Property()), u"",
                       u"post.Address");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, value.getPropertyValue(dead), u"dead",
                       u"post.Address");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, value.setPropertyValue(dead, text(u"x")), u"dead",
                       u"post.Address");
}

TEST_F(ReflectiveDataTypeField, MustHaveAType)
{
    Property const untyped = field(u"untyped", address, Type(), 1);

    EXPECT_RAISES_WITH(messages::CannotUsePropertyWithoutType,
                       ReflectiveDataType(address).getPropertyValue(untyped), u"untyped");
}

TEST_F(ReflectiveDataTypeField, TakesValuesOfItsTypeOnly)
{
    colour->setOwningPackage(package(u"post"));
    ReflectiveDataType value(address);
    value.setPropertyValue(city, text(u"York"));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.setPropertyValue(city, Value(Types::integerMeta, 1)), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.setPropertyValue(hue, Value(Types::integerMeta, 1)), u"post.Colour");
    EXPECT_EQ(value.getPropertyValue(city), text(u"York"));
}

TEST_F(ReflectiveDataTypeField, OfAnOptionalEnumerationTakesItsEmptyValue)
{
    ReflectiveDataType value(address);
    value.setPropertyValue(hue, Value::createEnumValue(red));

    value.setPropertyValue(hue, Value::createEmptyValue(hue));

    EXPECT_TRUE(value.getPropertyValue(hue).isAbsent());
    EXPECT_EQ(value, ReflectiveDataType(address));
}

TEST_F(ReflectiveDataTypeField, GoesBackToItsDefaultIfWhatWasSetHasAWrongShape)
{
    ReflectiveDataType value(address);
    value.setPropertyValue(city, Value(Types::stringMeta, std::vector<ustring>{u"York", u"Bath"}));

    EXPECT_EQ(value.getPropertyValue(city), text(u"Bath"));
}

TEST_F(ReflectiveDataTypeField, OfManyValuesStartsAsAnEmptyCollection)
{
    Property const list = field(u"list", address, Types::integerMeta, 0, 5);
    list->setIsOrdered(true);
    Property const set = field(u"set", address, Types::stringMeta, 0, 0xFFFFFFFF);
    ReflectiveDataType value(address);

    EXPECT_EQ(value.getPropertyValue(list).getValue<std::vector<int>>(), std::vector<int>());
    EXPECT_EQ(value.getPropertyValue(set).getValue<std::set<ustring>>(), std::set<ustring>());
    value.setPropertyValue(list, Value(Types::integerMeta, std::vector<int>{3, 1}));
    EXPECT_EQ(value.getPropertyValue(list).getValue<std::vector<int>>(), (std::vector<int>{3, 1}));
    EXPECT_EQ(value.getPropertyValue(list).extractEntryValues().size(), 2u);
}

TEST_F(ReflectiveDataTypeField, OfManyValuesNeedsATypeWithCollections)
{
    point->setOwningPackage(package(u"post"));
    Property const points = field(u"points", address, point, 0, 5);
    Property const people = field(u"people", address, person, 0, 5);
    Property const colours = field(u"colours", address, colour, 0, 5);
    Property const arrays = field(u"arrays", address, Types::hostArrayMeta, 0, 5);
    Property const keyed = field(u"keyed", address, Types::integerMeta, 0, 5);
    keyed->setQualifiedBy(x);
    ReflectiveDataType const value(address);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getPropertyValue(points),
                       u"post.Point");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getPropertyValue(people),
                       u"Person");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getPropertyValue(colours),
                       u"Colour");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getPropertyValue(arrays),
                       u"HostArray");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getPropertyValue(keyed),
                       u"Integer");
}

TEST_F(ReflectiveDataTypeOrder, TakesAFieldNeverSetForOneSetToItsDefault)
{
    ReflectiveDataType const untouched(address);
    ReflectiveDataType set(address);

    set.setPropertyValue(city, text(u"Bath"));
    set.setPropertyValue(number, Value::createEmptyValue(number));
    set.setPropertyValue(place, Value::createReflectiveDataTypeValue(pointAt(0, 0)));

    EXPECT_EQ(untouched, set);
    EXPECT_EQ(untouched.compareWith(set), 0);
    EXPECT_FALSE(untouched < set || set < untouched);
}

TEST_F(ReflectiveDataTypeOrder, IsDecidedByTheFirstFieldInTheOrderOfNames)
{
    ReflectiveDataType north(address);
    ReflectiveDataType south(address);

    north.setPropertyValue(number, Value(Types::integerMeta, 1));
    south.setPropertyValue(number, Value(Types::integerMeta, 2));
    EXPECT_EQ(north.compareWith(south), -1);
    EXPECT_EQ(south.compareWith(north), 1);

    north.setPropertyValue(city, text(u"York"));
    EXPECT_EQ(north.compareWith(south), 1) << "city comes before number";
    EXPECT_TRUE(south < north);
    EXPECT_FALSE(south == north);
}

TEST_F(ReflectiveDataTypeOrder, GoesThroughFieldsOfADataType)
{
    ReflectiveDataType left(address);
    ReflectiveDataType right(address);
    left.setPropertyValue(place, Value::createReflectiveDataTypeValue(pointAt(1, 2)));
    right.setPropertyValue(place, Value::createReflectiveDataTypeValue(pointAt(1, 2)));
    EXPECT_EQ(left, right);

    right.setPropertyValue(place, Value::createReflectiveDataTypeValue(pointAt(1, 3)));

    EXPECT_EQ(left.compareWith(right), -1);
    EXPECT_FALSE(left == right);
}

TEST_F(ReflectiveDataTypeOrder, PassesOverFieldsWithoutAType)
{
    field(u"another", address, Type(), 1);
    ReflectiveDataType left(address);
    ReflectiveDataType right(address);

    EXPECT_EQ(left.compareWith(right), 0);
    right.setPropertyValue(city, text(u"Aachen"));
    EXPECT_EQ(left.compareWith(right), 1);
}

TEST_F(ReflectiveDataTypeOrder, IsOfOneDataType)
{
    point->setOwningPackage(package(u"post"));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       ReflectiveDataType(address).compareWith(ReflectiveDataType(point)),
                       u"post.Point");
    EXPECT_FALSE(ReflectiveDataType(address) == ReflectiveDataType(point));
}

TEST_F(ReflectiveDataTypeOrder, MakesAKeyOfAMap)
{
    std::map<ReflectiveDataType, int> map;
    map[pointAt(1, 2)] = 12;
    map[pointAt(2, 1)] = 21;
    map[pointAt(1, 2)] = 112;

    EXPECT_EQ(map.size(), 2u);
    EXPECT_EQ(map.at(pointAt(1, 2)), 112);
    EXPECT_EQ(map.begin()->first, pointAt(1, 2));
}

TEST_F(ReflectiveDataTypeOrder, IsStrictAndWeakForRandomPoints)
{
    auto const random = [&] {
        return pointAt(*rc::gen::inRange(0, 3), *rc::gen::element(0.0, -0.0, 1.5, std::nan("")));
    };
    EXPECT_TRUE(rc::check([&] {
        ReflectiveDataType const a = random();
        ReflectiveDataType const b = random();
        ReflectiveDataType const c = random();
        RC_ASSERT(a.compareWith(a) == 0);
        RC_ASSERT(a.compareWith(b) == -b.compareWith(a));
        RC_ASSERT((a == b) == (a.compareWith(b) == 0));
        RC_PRE(a.compareWith(b) <= 0 && b.compareWith(c) <= 0);
        RC_ASSERT(a.compareWith(c) <= 0);
    }));
}

TEST_F(ReflectiveDataTypeInAValue, IsMarkedAndCopied)
{
    ReflectiveDataType held = pointAt(1, 2);
    Value const value = Value::createReflectiveDataTypeValue(held);
    held.setPropertyValue(x, Value(Types::integerMeta, 9));
    Value const copy = value;

    EXPECT_EQ(value.getType(), point);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_TRUE(value.isReflective());
    EXPECT_TRUE(value.isManaged());
    EXPECT_EQ(value.toReflectiveDataType(), pointAt(1, 2));
    EXPECT_EQ(copy, value);
    EXPECT_EQ(Value::createReflectiveDataTypeValue(pointAt(1, 2)), value);
    EXPECT_FALSE(Value::createReflectiveDataTypeValue(pointAt(1, 3)) == value);
}

TEST_F(ReflectiveDataTypeInAValue, IsTheDefaultOneIfRequiredAndElseAbsent)
{
    Value const required = Value::createReflectiveDataTypeValue(point, true);
    Value const absent = Value::createReflectiveDataTypeValue(point, false);

    EXPECT_EQ(required.toReflectiveDataType(), ReflectiveDataType(point));
    EXPECT_EQ(required.getFlags(), ValueFlags::Single);
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.isReflective());
    EXPECT_TRUE(absent.isAbsent());
    EXPECT_FALSE(absent == required) << "another shape";
}

TEST_F(ReflectiveDataTypeInAValue, IsReadOnlyFromPresentValuesOfADataType)
{
    ustring const dataTypes =
        DataType::metaClass() ? DataType::metaClass()->getQualifiedName() : u"";

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(Types::integerMeta, 1).toReflectiveDataType(), dataTypes);
    EXPECT_RAISES(messages::InvalidValue,
                  Value::createReflectiveDataTypeValue(point, false).toReflectiveDataType());
}

TEST_F(ReflectiveDataTypeInAValue, HasNoCxxFormWithoutASerializer)
{
    EXPECT_FALSE(pointAt(1, 2).toNonReflectiveDataTypeValue());
}

/// Points as integers: a value of `x` alone.
class PointSerializer final : public DatatypeSerializer
{
public:
    PointSerializer(DataType const& type, Property const& x) : m_type(type), m_x(x) {}

    Value getPropertyValue(Value const& value, Property const& property) const override
    {
        if (property == m_x)
            return value;
        return Value(Types::realMeta, 0.5);
    }
    Value setPropertyValue(Value const& value, Property const& property,
                           Value const& field) const override
    {
        return property == m_x ? field : value;
    }
    Value createEmptyOptionalValue() const override
    {
        return Value::createReflectiveDataTypeValue(m_type, false);
    }
    Value createDefaultValue() const override { return Value(Types::integerMeta, -1); }
    Value combineAsUnmanagedSequenceValue(Type const&,
                                          std::vector<Value> const& values) const override
    {
        return Value(Types::integerMeta, std::vector<int>(values.size()));
    }
    Value combineAsUnmanagedSetValue(Type const&, std::vector<Value> const&) const override
    {
        return Value(Types::integerMeta, std::set<int>());
    }

private:
    DataType const m_type;
    Property const m_x;
};

TEST_F(ReflectiveDataTypeInAValue, TakesTheFormThatTheSerializerGives)
{
    auto& registry = PropertySerializerRegistry::getInstance();
    registry.registerDatatypeSerializer(point, std::make_unique<PointSerializer>(point, x));
    ReflectiveDataType onlyOrdinate(point);
    onlyOrdinate.setPropertyValue(y, Value(Types::realMeta, 2.0));

    EXPECT_EQ(pointAt(7, 2).toNonReflectiveDataTypeValue().value(), Value(Types::integerMeta, 7));
    EXPECT_EQ(onlyOrdinate.toNonReflectiveDataTypeValue().value(), Value(Types::integerMeta, -1))
        << "fields that were not touched stay as the serializer's default has them";
    EXPECT_EQ(Value::createEmptyValue(point, true), Value(Types::integerMeta, -1));
    EXPECT_TRUE(Value::createEmptyValue(point, false).isAbsent());
    registry.unregisterSerializers(point);
}

TEST_F(OrderOfValues, PutsAbsentOnesFirst)
{
    Value const absent = Value::createEmptyValue(Types::integerMeta, false);

    EXPECT_EQ(compareValues(absent, Value(Types::integerMeta, -5)), -1);
    EXPECT_EQ(compareValues(Value(Types::integerMeta, -5), absent), 1);
    EXPECT_EQ(compareValues(absent, absent), 0);
}

TEST_F(OrderOfValues, IsTheNaturalOneOfEachType)
{
    using boost::posix_time::ptime;
    std::pair<Value, Value> const ascending[] = {
        {Value(Types::booleanMeta, false), Value(Types::booleanMeta, true)},
        {Value(Types::integerMeta, -1), Value(Types::integerMeta, 1)},
        {Value(Types::uinteger8Meta, static_cast<unsigned char>(1)),
         Value(Types::uinteger8Meta, static_cast<unsigned char>(200))},
        {Value(Types::uinteger64Meta, 1ul), Value(Types::uinteger64Meta, ~0ul)},
        {Value(Types::realMeta, -0.5), Value(Types::realMeta, 0.5)},
        {Value(Types::realMeta, 1e300), Value(Types::realMeta, std::nan(""))},
        {Value(Types::stringMeta, ustring(u"Z")), Value(Types::stringMeta, ustring(u"a"))},
        {Value(Types::stdstringMeta, string("a")), Value(Types::stdstringMeta, string("ab"))},
        {Value(Types::uuidMeta, testkit::uuidOf(1)), Value(Types::uuidMeta, testkit::uuidOf(2))},
        {Value(Types::dateTimeMeta, ptime(boost::posix_time::not_a_date_time)),
         Value(Types::dateTimeMeta, ptime(boost::gregorian::date(2024, 1, 1)))},
        {Value::createEnumValue(blue), Value::createEnumValue(red)},
        {Value(Types::integerMeta, std::vector<int>{1, 2}),
         Value(Types::integerMeta, std::vector<int>{1, 3})},
        {Value(Types::integerMeta, std::vector<int>{1}),
         Value(Types::integerMeta, std::vector<int>{1, 0})},
        {Value::createReflectiveDataTypeValue(pointAt(1, 0)),
         Value::createReflectiveDataTypeValue(pointAt(2, 0))},
    };
    for (auto const& [less, greater] : ascending)
    {
        EXPECT_EQ(compareValues(less, greater), -1);
        EXPECT_EQ(compareValues(greater, less), 1);
        EXPECT_EQ(compareValues(less, Value(less)), 0);
        EXPECT_EQ(compareValues(greater, Value(greater)), 0);
    }
}

TEST_F(OrderOfValues, OfElementsIsThatOfTheirUuids)
{
    Class const root = ModelElement::metaClass();
    Class const first = Class::create(m_model, testkit::uuidOf(1));
    Class const last = Class::create(m_model, testkit::uuidOf(2));

    EXPECT_EQ(compareValues(Value(root, ModelElement(first)), Value(root, ModelElement(last))), -1);
    EXPECT_EQ(compareValues(Value(root, ModelElement()), Value(root, ModelElement(first))), -1);
    EXPECT_EQ(compareValues(Value(root, ModelElement(last)), Value(root, ModelElement(last))), 0);
}

TEST_F(OrderOfValues, TellsShapesAndTypesApartWhereThePayloadDoesNot)
{
    Value const required(Types::integerMeta, 1);
    Value const optional(Types::integerMeta, boost::optional<int>(1));

    EXPECT_EQ(compareValues(optional, required), -1);
    EXPECT_EQ(compareValues(required, optional), 1);
    Value const absent = Value::createEmptyValue(Types::integerMeta, false);
    Value const absentText = Value::createEmptyValue(Types::stringMeta, false);
    EXPECT_NE(compareValues(absent, absentText), 0);
    EXPECT_EQ(compareValues(absent, absentText), -compareValues(absentText, absent));
}
}  // namespace
}  // namespace tarn::kiln::meta
