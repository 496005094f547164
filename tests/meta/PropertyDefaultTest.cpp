// What new elements start with.
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/internal/LocalTime.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"

#include <boost/date_time/posix_time/posix_time.hpp>

#include <cstdlib>
#include <limits>
#include <optional>

namespace tarn::kiln::meta {
namespace {

using boost::posix_time::ptime;
using tarnkiln::tests::RegistryElement;
using Types = StandardTypes;

class DefaultOfAProperty : public OrdinarySketch
{
protected:
    DefaultOfAProperty() { Types::ensureInitialized(); }

    Property single(Type const& type, std::optional<ustring> const& text = {},
                    unsigned int lower = 1)
    {
        Property const made = named<Property>(u"property");
        made->setType(type);
        made->setLower(lower);
        made->setUpper(1);
        if (text)
            made->setDefaultValue(*text);
        return made;
    }

    Enum colour()
    {
        Enum const made = named<Enum>(u"Colour");
        literal(u"Red", 3, made);
        literal(u"Blue", -1, made)->setPublicIdentifier(ustring(u"b"));
        return made;
    }
};

using DynamicDefault = DefaultOfAProperty;
using EmptyValue = DefaultOfAProperty;

/// Sets the time zone of the process, and sets it back.
class TimeZone
{
public:
    explicit TimeZone(char const* name)
    {
        if (char const* const former = std::getenv("TZ"))
            m_former = former;
        setenv("TZ", name, 1);
        tzset();
    }
    ~TimeZone()
    {
        if (m_former)
            setenv("TZ", m_former->c_str(), 1);
        else
            unsetenv("TZ");
        tzset();
    }

private:
    std::optional<std::string> m_former;
};

TEST_F(DynamicDefault, IsARandomUuidOrThePresentTime)
{
    EXPECT_TRUE(single(Types::uuidMeta, u"random")->isDynamicDefault());
    EXPECT_TRUE(single(Types::dateTimeMeta, u"now")->isDynamicDefault());
}

TEST_F(DynamicDefault, IsNoOtherTextAndOfNoOtherType)
{
    for (Property const& property :
         {single(Types::uuidMeta), single(Types::dateTimeMeta), single(Types::uuidMeta, u"now"),
          single(Types::uuidMeta, u"Random"), single(Types::dateTimeMeta, u"random"),
          single(Types::stringMeta, u"random"), single(Types::stringMeta, u"now"),
          single(named<PrimitiveType>(u"UUID"), u"random"), single(Type(), u"random")})
        EXPECT_FALSE(property->isDynamicDefault());
}

TEST_F(DefaultOfAProperty, IsNoneForManyValues)
{
    for (std::uint32_t const upper : {2u, 0xFFFFFFFFu})
    {
        Property const many = single(Types::integerMeta, u"7");
        many->setUpper(upper);
        EXPECT_FALSE(many->defaultValue());
    }
}

TEST_F(DefaultOfAProperty, IsNoneWithoutALiveType)
{
    PrimitiveType const type = named<PrimitiveType>(u"Integer");
    Property const orphan = single(type, u"7");
    type->destroy();

    EXPECT_FALSE(orphan->defaultValue());
    EXPECT_FALSE(single(Type(), u"7")->defaultValue());
}

TEST_F(DefaultOfAProperty, IsNoneForClassesDataTypesAndHostArraysEvenWithAText)
{
    for (Type const& type :
         {Type(cls(u"Book")), Type(named<DataType>(u"Isbn")), Type(Types::hostArrayMeta)})
    {
        EXPECT_FALSE(single(type)->defaultValue());
        EXPECT_FALSE(single(type, u"7")->defaultValue());
        EXPECT_FALSE(single(type, u"7", 0)->defaultValue());
    }
}

TEST_F(DefaultOfAProperty, IsTheEmptyValueWithoutAText)
{
    EXPECT_EQ(single(Types::integerMeta)->defaultValue().value(), Value(Types::integerMeta, 0));
    boost::optional<Value> const absent = single(Types::integerMeta, {}, 0)->defaultValue();
    ASSERT_TRUE(absent);
    EXPECT_EQ(absent->getType(), Types::integerMeta);
    EXPECT_EQ(absent->getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent->isAbsent());
}

TEST_F(DefaultOfAProperty, IsNoneWithoutATextIfThereIsNoEmptyValue)
{
    EXPECT_FALSE(single(Types::jsonValueMeta)->defaultValue());
    EXPECT_FALSE(single(Types::stringToStringMapMeta, {}, 0)->defaultValue());
    EXPECT_FALSE(single(named<Enum>(u"Empty"))->defaultValue());
}

TEST_F(DefaultOfAProperty, IsReadInAnyFlavourOfTheType)
{
    EXPECT_EQ(single(Types::booleanMeta, u"true")->defaultValue().value(),
              Value(Types::booleanMeta, true));
    EXPECT_EQ(single(Types::booleanMeta, u"1")->defaultValue().value(),
              Value(Types::booleanMeta, true));
    EXPECT_EQ(single(Types::realMeta, u"1.5")->defaultValue().value(), Value(Types::realMeta, 1.5));
    EXPECT_EQ(single(Types::realMeta, u"1,5")->defaultValue().value(), Value(Types::realMeta, 1.5));
    ptime const time(boost::gregorian::date(2024, 2, 29));
    for (ustring const text : {u"2024-02-29T00:00:00", u"20240229T000000"})
        EXPECT_EQ(single(Types::dateTimeMeta, text)->defaultValue().value(),
                  Value(Types::dateTimeMeta, time));
}

TEST_F(DefaultOfAProperty, IsARequiredValueForAnOptionalPropertyToo)
{
    Property const optional = single(Types::integerMeta, u"7", 0);

    EXPECT_EQ(optional->defaultValue().value(), Value(Types::integerMeta, 7));
    EXPECT_TRUE(optional->defaultValue()->isCompatibleWithProperty(optional));
}

TEST_F(DefaultOfAProperty, IsNoneIfTheTextIsUnreadable)
{
    EXPECT_FALSE(single(Types::integerMeta, u"seven")->defaultValue());
    EXPECT_FALSE(single(Types::booleanMeta, u"yes", 0)->defaultValue());
    EXPECT_FALSE(single(Types::uuidMeta, u"now")->defaultValue());
    EXPECT_FALSE(single(Types::jsonValueMeta, u"{}")->defaultValue());
}

TEST_F(DefaultOfAProperty, IsTheEmptyTextIfThatIsTheText)
{
    EXPECT_EQ(single(Types::stringMeta, u"")->defaultValue().value(),
              Value(Types::stringMeta, ustring()));
    EXPECT_FALSE(single(Types::integerMeta, u"")->defaultValue());
}

TEST_F(DefaultOfAProperty, IsReadByTheRegisteredTypeOfTheSameName)
{
    PrimitiveType const truth = named<PrimitiveType>(u"Boolean");

    EXPECT_EQ(single(truth, u"1")->defaultValue().value(), Value(Types::booleanMeta, true));
    EXPECT_FALSE(single(truth, u"yes")->defaultValue());
    EXPECT_FALSE(single(named<PrimitiveType>(u"Word"), u"yes")->defaultValue());
}

TEST_F(DefaultOfAProperty, IsTheNameOfALiteralAndNothingElse)
{
    Enum const enumeration = colour();

    boost::optional<Value> const blue = single(enumeration, u"Blue")->defaultValue();

    ASSERT_TRUE(blue);
    EXPECT_EQ(*blue, Value(enumeration, -1L));
    for (ustring const text : {u"Green", u"blue", u"-1", u"b", u""})
        EXPECT_FALSE(single(enumeration, text)->defaultValue());
}

TEST_F(DefaultOfAProperty, IsTheFirstLiteralOrNoneWithoutAText)
{
    Enum const enumeration = colour();

    EXPECT_EQ(single(enumeration)->defaultValue().value(), Value(enumeration, -1L));
    boost::optional<Value> const absent = single(enumeration, {}, 0)->defaultValue();
    ASSERT_TRUE(absent);
    EXPECT_TRUE(absent->isAbsent());
    EXPECT_EQ(absent->getType(), Types::integerMeta);
}

TEST_F(DefaultOfAProperty, IsAnotherRandomUuidEachTime)
{
    Property const id = single(Types::uuidMeta, u"random");

    UUID const first = id->defaultValue()->getValue<UUID>();
    UUID const second = id->defaultValue()->getValue<UUID>();

    EXPECT_NE(first, second);
    EXPECT_FALSE(first.is_nil());
    EXPECT_EQ(first.version(), UUID::version_random_number_based);
}

TEST_F(DefaultOfAProperty, IsTheLocalTimeInWholeSeconds)
{
    TimeZone const farEast("FAR-13:30");
    auto const utc = boost::posix_time::second_clock::universal_time;

    ptime const before = utc();
    ptime const now = single(Types::dateTimeMeta, u"now")->defaultValue()->getValue<ptime>();
    ptime const after = utc();

    boost::posix_time::time_duration const ahead(13, 30, 0);
    EXPECT_GE(now - ahead, before);
    EXPECT_LE(now - ahead, after);
    EXPECT_EQ(now.time_of_day().fractional_seconds(), 0);
}

TEST(LocalTime, FailsForAYearThatDoesNotFit)
{
    try
    {
        internal::toLocalTime(std::numeric_limits<std::time_t>::max());
        FAIL() << "did not fail";
    }
    catch (std::runtime_error const& failure)
    {
        EXPECT_STREQ(failure.what(), "could not convert calendar time to local time");
    }
}

TEST(LocalTime, IsTheClockOfThisPlace)
{
    TimeZone const place("HERE+2");

    EXPECT_EQ(
        internal::toLocalTime(1709251199),
        ptime(boost::gregorian::date(2024, 2, 29), boost::posix_time::time_duration(21, 59, 59)));
}

TEST_F(EmptyValue, IsMadeByTheSerializerOfTheType)
{
    EXPECT_EQ(Value::createEmptyValue(Types::stringMeta, true),
              Value(Types::stringMeta, ustring()));
    EXPECT_TRUE(Value::createEmptyValue(Types::stringMeta, false).isAbsent());
    EXPECT_EQ(Value::createEmptyValue(single(Types::booleanMeta)),
              Value(Types::booleanMeta, false));
    Value const absent = Value::createEmptyValue(single(Types::booleanMeta, u"true", 0));
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.isAbsent()) << "the text is not asked";
}

TEST_F(EmptyValue, IsRequiredOnlyIfTheLowerBoundIsOne)
{
    Property const odd = single(Types::integerMeta, {}, 2);

    EXPECT_TRUE(Value::createEmptyValue(odd).isAbsent());
}

TEST_F(EmptyValue, IsRefusedForTypesWithoutASerializer)
{
    for (Type const& type :
         {Types::hostArrayMeta, Types::jsonValueMeta, Types::stringToStringMapMeta})
    {
        EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(type, true));
        EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(type, false));
    }
}

TEST_F(EmptyValue, IsTheFirstLiteralOrAnAbsentInteger)
{
    Enum const enumeration = colour();

    EXPECT_EQ(Value::createEmptyValue(enumeration, true), Value(enumeration, -1L));
    EXPECT_EQ(Value::createEmptyValue(enumeration, false).getType(), Types::integerMeta);
    EXPECT_THROW(Value::createEmptyValue(named<Enum>(u"Empty"), true), std::bad_cast);
}

TEST_F(EmptyValue, IsReflectiveForADataTypeOfAnotherModelThanTheRegistrys)
{
    DataType const isbn = named<DataType>(u"Isbn");

    Value const required = Value::createEmptyValue(isbn, true);
    Value const absent = Value::createEmptyValue(isbn, false);

    EXPECT_TRUE(required.isReflective());
    EXPECT_EQ(required.getType(), isbn);
    EXPECT_EQ(required.getFlags(), ValueFlags::Single);
    EXPECT_EQ(required.toReflectiveDataType(), ReflectiveDataType(isbn));
    EXPECT_TRUE(absent.isReflective());
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.isAbsent());
    EXPECT_FALSE(absent == required);
}

TEST_F(EmptyValue, IsRefusedForADataTypeOfTheRegistryWithoutASerializer)
{
    RegistryElement<DataType> const isbn(u"Isbn");

    EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(isbn.get(), true));
    EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(isbn.get(), false));
}
}  // namespace
}  // namespace tarn::kiln::meta
