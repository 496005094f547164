// The text forms of the primitive types.
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/TransientOnlyPropertySerializer.h"
#include "tests/meta/SerializerText.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <boost/date_time/posix_time/posix_time.hpp>

#include <cmath>
#include <limits>
#include <tuple>
#include <typeinfo>

namespace tarn::kiln::meta {
namespace {

using boost::posix_time::ptime;
using boost::posix_time::time_duration;
using tarnkiln::tests::read;
using tarnkiln::tests::serializerOf;
using tarnkiln::tests::write;
using Types = StandardTypes;

class TextForm : public ::testing::Test
{
protected:
    TextForm() { Types::ensureInitialized(); }
};

using TextOfAnInteger = TextForm;
using TextOfAByte = TextForm;
using TextOfATruthValue = TextForm;
using TextOfAText = TextForm;
using TextOfAUuid = TextForm;
using TextOfARealNumber = TextForm;
using TextOfADateTime = TextForm;
using TextOfATransientValue = TextForm;
using PrimitiveSerializer = TextForm;

template <class T>
void expectIntegralText(Type const& type, ustring const& least, ustring const& greatest)
{
    using Limits = std::numeric_limits<T>;
    EXPECT_EQ(write<T>(type, Limits::min()), least);
    EXPECT_EQ(write<T>(type, Limits::max()), greatest);
    EXPECT_EQ(read<T>(type, least), Limits::min());
    EXPECT_EQ(read<T>(type, greatest), Limits::max());
    EXPECT_EQ(read<T>(type, u"+7"), T(7));
    EXPECT_EQ(read<T>(type, u"007"), T(7));
    for (ustring const text : {u"", u" ", u"-", u"+", u" 7", u"7 ", u"7.0", u"1e2", u"0x7",
                               u"seven", u"+-7", u"\u0667", u"99999999999999999999"})
        EXPECT_UNREADABLE(text, type);
    EXPECT_UNREADABLE(greatest + u"0", type);
}

TEST_F(TextOfAnInteger, IsDecimalWithinTheLimitsOfTheType)
{
    expectIntegralText<int>(Types::integerMeta, u"-2147483648", u"2147483647");
    expectIntegralText<short>(Types::integer16Meta, u"-32768", u"32767");
    expectIntegralText<long>(Types::integer64Meta, u"-9223372036854775808", u"9223372036854775807");
    expectIntegralText<unsigned int>(Types::unlimitedNaturalMeta, u"0", u"4294967295");
    expectIntegralText<unsigned short>(Types::uinteger16Meta, u"0", u"65535");
    expectIntegralText<unsigned long>(Types::uinteger64Meta, u"0", u"18446744073709551615");
}

TEST_F(TextOfAnInteger, IsRefusedOneBeyondTheLimits)
{
    EXPECT_UNREADABLE(u"2147483648", Types::integerMeta);
    EXPECT_UNREADABLE(u"-2147483649", Types::integerMeta);
    EXPECT_UNREADABLE(u"32768", Types::integer16Meta);
    EXPECT_UNREADABLE(u"-32769", Types::integer16Meta);
    EXPECT_UNREADABLE(u"9223372036854775808", Types::integer64Meta);
    EXPECT_UNREADABLE(u"-9223372036854775809", Types::integer64Meta);
    EXPECT_UNREADABLE(u"4294967296", Types::unlimitedNaturalMeta);
    EXPECT_UNREADABLE(u"65536", Types::uinteger16Meta);
    EXPECT_UNREADABLE(u"18446744073709551616", Types::uinteger64Meta);
}

TEST_F(TextOfAnInteger, TakesAMinusSignForSignedTypes)
{
    EXPECT_EQ(read<int>(Types::integerMeta, u"-7"), -7);
    EXPECT_EQ(read<short>(Types::integer16Meta, u"-7"), -7);
    EXPECT_EQ(read<long>(Types::integer64Meta, u"-7"), -7);
}

TEST_F(TextOfAnInteger, CountsDownFromBeyondTheGreatestForUnsignedTypes)
{
    EXPECT_EQ(read<unsigned int>(Types::unlimitedNaturalMeta, u"-1"), 4294967295u);
    EXPECT_EQ(read<unsigned short>(Types::uinteger16Meta, u"-1"), 65535u);
    EXPECT_EQ(read<unsigned long>(Types::uinteger64Meta, u"-1"), 18446744073709551615ul);
}

TEST_F(TextOfAByte, IsANumberAndNoLetter)
{
    EXPECT_EQ(write<signed char>(Types::integer8Meta, 65), u"65");
    EXPECT_EQ(write<unsigned char>(Types::uinteger8Meta, 65), u"65");
    EXPECT_EQ(read<signed char>(Types::integer8Meta, u"65"), 65);
    EXPECT_EQ(read<unsigned char>(Types::uinteger8Meta, u"7"), 7);
    EXPECT_UNREADABLE(u"A", Types::integer8Meta);
    EXPECT_UNREADABLE(u"A", Types::uinteger8Meta);
}

TEST_F(TextOfAByte, StaysWithinTheLimitsOfTheType)
{
    expectIntegralText<signed char>(Types::integer8Meta, u"-128", u"127");
    expectIntegralText<unsigned char>(Types::uinteger8Meta, u"0", u"255");
    for (ustring const text : {u"300", u"128", u"-129"})
        EXPECT_UNREADABLE(text, Types::integer8Meta);
    for (ustring const text : {u"300", u"256", u"-1"})
        EXPECT_UNREADABLE(text, Types::uinteger8Meta);
}

TEST_F(TextOfATruthValue, IsAWordInLowerCase)
{
    EXPECT_EQ(write(Types::booleanMeta, true), u"true");
    EXPECT_EQ(write(Types::booleanMeta, false), u"false");
    EXPECT_TRUE(read<bool>(Types::booleanMeta, u"true"));
    EXPECT_FALSE(read<bool>(Types::booleanMeta, u"false"));
    for (ustring const text :
         {u"", u"True", u"TRUE", u"False", u"1", u"0", u" true", u"true ", u"t"})
        EXPECT_UNREADABLE(text, Types::booleanMeta);
}

TEST_F(TextOfATruthValue, IsADigitInTheNumericFlavour)
{
    EXPECT_EQ(write(Types::booleanMeta, true, "numeric"), u"1");
    EXPECT_EQ(write(Types::booleanMeta, false, "numeric"), u"0");
    for (ustring const text : {u"1", u"+1", u"001"})
        EXPECT_TRUE(read<bool>(Types::booleanMeta, text, "numeric"));
    for (ustring const text : {u"0", u"-0", u"000"})
        EXPECT_FALSE(read<bool>(Types::booleanMeta, text, "numeric"));
    for (ustring const text : {u"", u"true", u"false", u"2", u"-1", u" 1", u"1 ", u"10"})
        EXPECT_UNREADABLE(text, Types::booleanMeta, "numeric");
}

TEST_F(TextOfAText, IsTheTextUnchanged)
{
    ustring const texts[] = {u"", u"  Emma\n", u"\u00e9\U0001F600", ustring(u"a\0b", 3),
                             ustring(1, u'\xD800')};
    for (ustring const& text : texts)
    {
        EXPECT_EQ(write(Types::stringMeta, text), text);
        EXPECT_EQ(read<ustring>(Types::stringMeta, text), text);
    }
}

TEST_F(TextOfAText, IsUtf8ForStringsOfBytes)
{
    EXPECT_EQ(write(Types::stdstringMeta, string("\xC3\xA9 x")), u"\u00e9 x");
    EXPECT_EQ(read<string>(Types::stdstringMeta, u"\u00e9 x"), "\xC3\xA9 x");
    EXPECT_EQ(read<string>(Types::stdstringMeta, u""), "");
    EXPECT_EQ(read<string>(Types::stdstringMeta, u" a b "), " a b ");
    EXPECT_EQ(read<string>(Types::stdstringMeta, write(Types::stdstringMeta, string("\xFF\xC3"))),
              "\xFF\xC3");
}

TEST_F(TextOfAUuid, HasLowerCaseDigitsAndDashes)
{
    UUID const id = read<UUID>(Types::uuidMeta, u"27118326-006D-3829-A67A-400AD23D5D98");

    EXPECT_EQ(write(Types::uuidMeta, id), u"27118326-006d-3829-a67a-400ad23d5d98");
    EXPECT_EQ(write(Types::uuidMeta, UUID{}), u"00000000-0000-0000-0000-000000000000");
}

TEST_F(TextOfAUuid, TakesNoOtherForm)
{
    for (ustring const text :
         {u"", u"27118326006d3829a67a400ad23d5d98", u"{27118326-006d-3829-a67a-400ad23d5d98}",
          u"27118326-006d-3829-a67a-400ad23d5d9", u"27118326-006d-3829-a67a-400ad23d5d98 ",
          u" 27118326-006d-3829-a67a-400ad23d5d98", u"27118326-006d-3829-a67a-400ad23d5d9g",
          u"2711832-6006d-3829-a67a-400ad23d5d98"})
        EXPECT_UNREADABLE(text, Types::uuidMeta);
}

TEST_F(TextOfARealNumber, IsTheShortestThatReadsBackAsTheSame)
{
    EXPECT_EQ(write(Types::realMeta, 0.1), u"0.1");
    EXPECT_EQ(write(Types::realMeta, -0.0), u"-0");
    EXPECT_EQ(write(Types::realMeta, std::numeric_limits<double>::max()),
              u"1.7976931348623157e+308");
    EXPECT_EQ(read<double>(Types::realMeta, u"-1.5e3"), -1500);
}

TEST_F(TextOfARealNumber, NamesTheSpecialValues)
{
    double const infinity = std::numeric_limits<double>::infinity();

    EXPECT_TRUE(std::isnan(read<double>(Types::realMeta, write(Types::realMeta, std::nan("")))));
    EXPECT_EQ(read<double>(Types::realMeta, write(Types::realMeta, infinity)), infinity);
    EXPECT_EQ(read<double>(Types::realMeta, write(Types::realMeta, -infinity)), -infinity);
}

TEST_F(TextOfARealNumber, IsReadAsAWholeOrNotAtAll)
{
    for (ustring const text : {u"", u" 1", u"1 ", u"1,5", u"1/5", u"1.5x", u".", u"1e400"})
        EXPECT_UNREADABLE(text, Types::realMeta);
}

TEST_F(TextOfARealNumber, HasACommaOrSlashInOldDocuments)
{
    char const* const old = "doubleBackwardsCompatible";

    EXPECT_EQ(read<double>(Types::realMeta, u"1,5", old), 1.5);
    EXPECT_EQ(read<double>(Types::realMeta, u"1/5", old), 1.5);
    EXPECT_EQ(read<double>(Types::realMeta, u"-2,5e1", old), -25);
    EXPECT_EQ(read<double>(Types::realMeta, u",5", old), 0.5);
    EXPECT_EQ(write(Types::realMeta, 1.5, old), u"1.5") << "as today";
}

TEST_F(TextOfARealNumber, IsRefusedWithAPointWhereOldDocumentsAreRead)
{
    char const* const old = "doubleBackwardsCompatible";

    for (ustring const text : {u"1.5", u"15", u"NaN", u"", u"1,5,5", u"1/5/5", u"a,b"})
        EXPECT_UNREADABLE(text, Types::realMeta, old);
}

TEST_F(TextOfARealNumber, HasItsFirstCommaReplacedEvenBehindASlash)
{
    EXPECT_UNREADABLE(u"1/5,5", Types::realMeta, "doubleBackwardsCompatible");
    EXPECT_UNREADABLE(u"1,5/5", Types::realMeta, "doubleBackwardsCompatible");
}

TEST_F(TextOfADateTime, IsExtendedIso)
{
    ptime const time(boost::gregorian::date(2024, 2, 29), time_duration(23, 59, 58, 1));

    EXPECT_EQ(write(Types::dateTimeMeta, time), u"2024-02-29T23:59:58.000001");
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"2024-02-29T23:59:58.000001"), time);
    for (ustring const text : {u"", u"2023-02-29T00:00:00", u"2024-02-29", u"20240229T235958",
                               u"2024-02-29T24:00:00", u"yesterday"})
        EXPECT_UNREADABLE(text, Types::dateTimeMeta);
}

TEST_F(TextOfADateTime, IsBasicIsoInTheOldFlavour)
{
    ptime const whole(boost::gregorian::date(2024, 2, 29), time_duration(23, 59, 58));
    ptime const fraction = whole + boost::posix_time::microseconds(1500);

    EXPECT_EQ(write(Types::dateTimeMeta, whole, "Rev17"), u"20240229T235958");
    EXPECT_EQ(write(Types::dateTimeMeta, fraction, "Rev17"), u"20240229T235958.001500");
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"20240229T235958", "Rev17"), whole);
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"20240229T235958,0015", "Rev17"), fraction);
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"20240229T235958.001500", "Rev17"), fraction);
}

TEST_F(TextOfADateTime, OfNoDateIsRefusedInTheOldFlavour)
{
    for (ustring const text : {u"", u"T", u"20241301T000000", u"20240230T000000", u"20240229",
                               u"2024022xT000000", u"20240229Tnoon", u"nonsense", u"\u0662024"})
        EXPECT_UNREADABLE(text, Types::dateTimeMeta, "Rev17");
}

TEST_F(TextOfADateTime, CanBeASpecialValueInBothFlavours)
{
    struct
    {
        boost::posix_time::special_values value;
        ustring text;
    } const specials[] = {{boost::posix_time::not_a_date_time, u"not-a-date-time"},
                          {boost::posix_time::pos_infin, u"+infinity"},
                          {boost::posix_time::neg_infin, u"-infinity"}};
    for (char const* const flavour : {"", "Rev17"})
    {
        for (auto const& special : specials)
        {
            EXPECT_EQ(write(Types::dateTimeMeta, ptime(special.value), flavour), special.text);
            ptime const back = read<ptime>(Types::dateTimeMeta, special.text, flavour);
            EXPECT_TRUE(back.is_special());
            EXPECT_EQ(write(Types::dateTimeMeta, back, flavour), special.text);
        }
    }
}

TEST_F(TextOfADateTime, CanBeTheFirstOrLastOneInTheOldFlavour)
{
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"maximum-date-time", "Rev17"),
              ptime(boost::posix_time::max_date_time));
    EXPECT_EQ(read<ptime>(Types::dateTimeMeta, u"minimum-date-time", "Rev17"),
              ptime(boost::posix_time::min_date_time));
}

TEST_F(TextOfATransientValue, IsEmptyAndReadsAsAnEmptyHandle)
{
    Type const type = Model::metaClass();
    TransientOnlyPropertySerializer<Model> const serializer(type);
    Model const model = Model::createRegistryModel(u"transient");

    EXPECT_EQ(serializer.serializeValue(Value(type, model)), u"");
    for (ustring const text : {u"", u"transient"})
    {
        Value const value = serializer.parseValue(text, type);
        EXPECT_EQ(value.getFlags(), ValueFlags::Single);
        EXPECT_FALSE(value.getValue<Model>());
    }
}

/// What all serializers of a primitive type have in common.
template <class T>
void expectOrdinaryBehaviour(Type const& type, T const& example, char const* flavour = "")
{
    PropertySerializer& serializer = serializerOf(type, flavour);
    Value const value(type, example);

    EXPECT_EQ(serializer.createDefaultValue(type), Value(type, T()));
    Value const absent = serializer.createEmptyOptionalValue(type);
    EXPECT_EQ(absent.getType(), type);
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.isAbsent());
    EXPECT_FALSE(absent.getValue<boost::optional<T>>());

    EXPECT_FALSE(serializer.serializeOptionalValue(value));
    EXPECT_EQ(serializer.toOptionalValue(value), value);
    Value released = value;
    serializer.releaseValue(std::move(released), type);
    EXPECT_EQ(value, Value(type, example));

    Value const sequence = serializer.combineAsUnmanagedSequenceValue(type, {value, value});
    EXPECT_EQ(sequence.getFlags(), ValueFlags::Sequence);
    EXPECT_FALSE(sequence.isManaged());
    EXPECT_EQ(sequence.getValue<std::vector<T>>(), (std::vector<T>{example, example}));
    EXPECT_EQ(sequence.extractEntryValues(), (std::vector<Value>{value, value}));
    Value const set = serializer.combineAsUnmanagedSetValue(type, {value, value});
    EXPECT_EQ(set.getFlags(), ValueFlags::Set);
    EXPECT_FALSE(set.isManaged());
    EXPECT_EQ(set.getValue<std::set<T>>(), std::set<T>{example});
    EXPECT_TRUE(
        serializer.combineAsUnmanagedSequenceValue(type, {}).getValue<std::vector<T>>().empty());
}

template <class T> void expectRefusal(Type const& type, char const* flavour = "")
{
    PropertySerializer& serializer = serializerOf(type, flavour);
    Type const other = type == Types::booleanMeta ? Types::realMeta : Types::booleanMeta;
    Value const foreign = serializerOf(other).createDefaultValue(other);
    Value const absent = serializer.createEmptyOptionalValue(type);
    ustring const name = foreign.getType()->getQualifiedName();

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, serializer.serializeValue(foreign),
                       name);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.combineAsUnmanagedSequenceValue(type, {foreign}), name);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.combineAsUnmanagedSetValue(type, {foreign}), name);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, serializer.serializeValue(absent),
                       type->getQualifiedName());
}

template <class T>
void expectSerializer(Type const& type, T const& example, char const* flavour = "")
{
    SCOPED_TRACE(::testing::PrintToString(type->getName()) + " " + flavour);
    expectOrdinaryBehaviour(type, example, flavour);
    expectRefusal<T>(type, flavour);
}

TEST_F(PrimitiveSerializer, MakesAndCombinesValuesOfItsTypeAndRefusesOthers)
{
    ptime const time(boost::gregorian::date(2024, 2, 29), time_duration(1, 2, 3));
    expectSerializer<string>(Types::stdstringMeta, "text");
    expectSerializer<int>(Types::integerMeta, -7);
    expectSerializer<signed char>(Types::integer8Meta, -7);
    expectSerializer<short>(Types::integer16Meta, -7);
    expectSerializer<long>(Types::integer64Meta, -7);
    expectSerializer<double>(Types::realMeta, 1.5);
    expectSerializer<double>(Types::realMeta, 1.5, "doubleBackwardsCompatible");
    expectSerializer<bool>(Types::booleanMeta, true);
    expectSerializer<bool>(Types::booleanMeta, true, "numeric");
    expectSerializer<unsigned int>(Types::unlimitedNaturalMeta, 7);
    expectSerializer<unsigned char>(Types::uinteger8Meta, 7);
    expectSerializer<unsigned short>(Types::uinteger16Meta, 7);
    expectSerializer<unsigned long>(Types::uinteger64Meta, 7);
    expectSerializer<UUID>(Types::uuidMeta, testkit::uuidOf(7));
    expectSerializer<ustring>(Types::stringMeta, u"text");
}

TEST_F(PrimitiveSerializer, ReadsOptionalValuesAsRequiredOnes)
{
    Value const value =
        serializerOf(Types::integerMeta).parseOptionalValue(u"7", Types::integerMeta);

    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_EQ(value.getValue<boost::optional<int>>().value_or(0), 7);
    EXPECT_THROW(serializerOf(Types::integerMeta).parseOptionalValue(u"x", Types::integerMeta),
                 std::bad_cast);
}

TEST_F(PrimitiveSerializer, StartsDateTimesAsNoDateTime)
{
    for (char const* const flavour : {"", "Rev17"})
    {
        PropertySerializer& serializer = serializerOf(Types::dateTimeMeta, flavour);
        Value const start = serializer.createDefaultValue(Types::dateTimeMeta);

        EXPECT_EQ(start.getFlags(), ValueFlags::Single);
        EXPECT_TRUE(start.getValue<ptime>().is_not_a_date_time());
        EXPECT_TRUE(serializer.createEmptyOptionalValue(Types::dateTimeMeta).isAbsent());
    }
}

TEST_F(PrimitiveSerializer, WritesAValueWithoutPayloadAsTheDefault)
{
    Value value(Types::integerMeta, 7);
    Value const taken = std::move(value);

    EXPECT_EQ(serializerOf(Types::integerMeta).serializeValue(value), u"0");
}

/// Overrides no more than it must.
class PlainSerializer final : public PropertySerializer
{
public:
    ustring serializeValue(Value const&) const override { return u"text"; }
    Value parseValue(ustring const&, Type const&) const override
    {
        return Value(Types::integerMeta, 7);
    }
    Value createEmptyOptionalValue(Type const& type) const override
    {
        return createDefaultValue(type);
    }
    Value createDefaultValue(Type const&) const override { return Value(Types::integerMeta, 0); }
};

TEST_F(PrimitiveSerializer, MakesNoCollectionsUnlessItKnowsHow)
{
    PlainSerializer const serializer;
    Value const value(Types::integerMeta, 7);

    EXPECT_RAISES(messages::InvalidValue,
                  serializer.combineAsUnmanagedSequenceValue(Types::integerMeta, {value}));
    EXPECT_RAISES(messages::InvalidValue,
                  serializer.combineAsUnmanagedSetValue(Types::integerMeta, {}));
    EXPECT_EQ(serializer.parseOptionalValue(u"", Types::integerMeta), value) << "asks parseValue";
    EXPECT_FALSE(serializer.serializeOptionalValue(value));
    EXPECT_EQ(serializer.toOptionalValue(value), value);
}
}  // namespace
}  // namespace tarn::kiln::meta
