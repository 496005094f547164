// The text forms of enumerations.
#include "tarnkiln/meta/EnumPropertySerializer.h"
#include "tarnkiln/meta/ReflectiveEnumPropertySerializer.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/meta/SerializerText.h"
#include "tests/support/ExpectRaises.h"

#include <limits>
#include <tuple>

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::serializerOf;

enum class ColourValue : int
{
    None = 0,
    Blue = -1,
    Red = 3
};

/// An enumeration whose literals share a number, lack an identifier, or have the name of another's.
///
/// | Name | Value | Public identifier |
/// |---|---|---|
/// | Azure | -1 | sky |
/// | Blue | -1 | Red |
/// | Red | 3 | |
/// | Yellow | 4 | sky |
class EnumerationTexts : public MetamodelSketch
{
protected:
    EnumerationTexts()
    {
        red = literal(u"Red", 3, colour);
        blue = literal(u"Blue", -1, colour);
        azure = literal(u"Azure", -1, colour);
        yellow = literal(u"Yellow", 4, colour);
        azure->setPublicIdentifier(ustring(u"sky"));
        blue->setPublicIdentifier(ustring(u"Red"));
        yellow->setPublicIdentifier(ustring(u"sky"));
    }

    static ustring write(PropertySerializer const& serializer, Value const& value)
    {
        return serializer.serializeValue(value);
    }
    Value numbered(long number) const { return Value(colour, number); }
    long read(PropertySerializer const& serializer, ustring const& text) const
    {
        Value const value = serializer.parseValue(text, colour);
        EXPECT_EQ(value.getType(), colour);
        EXPECT_EQ(value.getFlags(), ValueFlags::Single);
        return value.getValue<long>();
    }

    void expectNames(PropertySerializer const& serializer)
    {
        EXPECT_EQ(write(serializer, numbered(3)), u"Red");
        EXPECT_EQ(write(serializer, numbered(-1)), u"Azure") << "the first of two by name";
        EXPECT_EQ(write(serializer, numbered(5)), u"");
        EXPECT_EQ(read(serializer, u"Blue"), -1);
        EXPECT_EQ(read(serializer, u"Red"), 3);
        for (ustring const text : {u"", u"red", u"sky", u"3"})
            EXPECT_THROW(serializer.parseValue(text, colour), std::bad_cast);
    }

    void expectNumbers(PropertySerializer const& serializer)
    {
        EXPECT_EQ(write(serializer, numbered(3)), u"3");
        EXPECT_EQ(write(serializer, numbered(-1)), u"-1");
        EXPECT_EQ(write(serializer, numbered(5)), u"5") << "without a literal too";
        EXPECT_EQ(read(serializer, u"-1"), -1);
        EXPECT_EQ(read(serializer, u"+3"), 3);
        for (ustring const text : {u"", u"5", u"Red", u"3 ", u"99999999999"})
            EXPECT_THROW(serializer.parseValue(text, colour), std::bad_cast);
    }

    void expectPublicIds(PropertySerializer const& serializer)
    {
        EXPECT_EQ(write(serializer, numbered(-1)), u"sky");
        EXPECT_EQ(write(serializer, numbered(3)), u"Red") << "the name, without an identifier";
        EXPECT_EQ(write(serializer, numbered(5)), u"");
        EXPECT_EQ(read(serializer, u"Red"), -1) << "which is another's identifier";
        EXPECT_EQ(read(serializer, u"sky"), -1) << "the first of two by name";
        blue->setPublicIdentifier(boost::none);
        for (ustring const text : {u"", u"Red", u"Azure", u"-1"})
            EXPECT_THROW(serializer.parseValue(text, colour), std::bad_cast);
    }

    Enum const colour = named<Enum>(u"Colour");
    EnumLiteral red;
    EnumLiteral blue;
    EnumLiteral azure;
    EnumLiteral yellow;
};

using TextOfALiteral = EnumerationTexts;
using TextOfACxxEnumerator = EnumerationTexts;
using ReflectiveEnumeration = EnumerationTexts;
using CxxEnumeration = EnumerationTexts;

TEST_F(TextOfALiteral, IsItsName)
{
    expectNames(serializerOf(colour));
}

TEST_F(TextOfALiteral, IsItsNumberInTheFlavourId)
{
    expectNumbers(serializerOf(colour, "ID"));
}

TEST_F(TextOfALiteral, IsItsPublicIdentifierInTheFlavourPublicId)
{
    expectPublicIds(serializerOf(colour, "PublicID"));
}

TEST_F(TextOfALiteral, IsWrittenInSharedSerializersOfFixedClasses)
{
    auto const is = []<class Serializer>(PropertySerializer& serializer,
                                         std::type_identity<Serializer>) {
        return dynamic_cast<Serializer*>(&serializer) != nullptr;
    };
    EXPECT_TRUE(
        is(serializerOf(colour), std::type_identity<ReflectiveEnumPropertySerializerAsName>()));
    EXPECT_TRUE(is(serializerOf(colour, "ID"),
                   std::type_identity<ReflectiveEnumPropertySerializerAsValue>()));
    EXPECT_TRUE(is(serializerOf(colour, "PublicID"),
                   std::type_identity<ReflectiveEnumPropertySerializerAsPublicId>()));
    EXPECT_EQ(PropertySerializerRegistry::getInstance().getPropertySerializer(colour, "other"),
              nullptr);
    EXPECT_EQ(&serializerOf(named<Enum>(u"Shape")), &serializerOf(colour));
}

TEST_F(TextOfACxxEnumerator, IsItsName)
{
    expectNames(EnumPropertySerializerAsName<ColourValue>(colour));
}

TEST_F(TextOfACxxEnumerator, IsItsNumber)
{
    expectNumbers(EnumPropertySerializerAsValue<ColourValue>(colour));
}

TEST_F(TextOfACxxEnumerator, IsItsPublicIdentifier)
{
    expectPublicIds(EnumPropertySerializerAsPublicId<ColourValue>(colour));
}

TEST_F(TextOfALiteral, SkipsDestroyedLiterals)
{
    PropertySerializer& serializer = serializerOf(colour);
    azure->destroy();

    EXPECT_EQ(write(serializer, numbered(-1)), u"Blue");
    EXPECT_THROW(serializer.parseValue(u"Azure", colour), std::bad_cast);
}

TEST_F(ReflectiveEnumeration, StartsWithItsFirstLiteralByName)
{
    for (char const* const flavour : {"", "ID", "PublicID"})
        EXPECT_EQ(serializerOf(colour, flavour).createDefaultValue(colour),
                  Value::createEnumValue(azure));
    Enum const empty = named<Enum>(u"Empty");
    EXPECT_THROW(serializerOf(empty).createDefaultValue(empty), std::bad_cast);
}

TEST_F(ReflectiveEnumeration, IsAbsentAsAnInteger)
{
    for (char const* const flavour : {"", "ID", "PublicID"})
    {
        Value const absent = serializerOf(colour, flavour).createEmptyOptionalValue(colour);
        EXPECT_EQ(absent.getType(), StandardTypes::integerMeta);
        EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
        EXPECT_TRUE(absent.isAbsent());
        EXPECT_FALSE(absent.getEnumNumber());
    }
}

TEST_F(ReflectiveEnumeration, HasNoLiteralsOfMoreBitsThanTheyHave)
{
    EXPECT_EQ(write(serializerOf(colour), numbered(0x100000003)), u"");
    EXPECT_EQ(write(serializerOf(colour, "PublicID"), numbered(0x100000003)), u"");
}

TEST_F(ReflectiveEnumeration, MakesNoCollections)
{
    PropertySerializer& serializer = serializerOf(colour);

    EXPECT_RAISES(messages::InvalidValue,
                  serializer.combineAsUnmanagedSequenceValue(colour, {numbered(3)}));
    EXPECT_RAISES(messages::InvalidValue,
                  serializer.combineAsUnmanagedSetValue(colour, {numbered(3)}));
}

TEST_F(ReflectiveEnumeration, RefusesValuesAndTypesThatAreNoEnumeration)
{
    PropertySerializer& serializer = serializerOf(colour);
    Type const text = StandardTypes::stringMeta;

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.serializeValue(Value(text, ustring(u"Red"))), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.serializeValue(Value(StandardTypes::integer64Meta, 3L)),
                       u"Integer64");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, serializer.parseValue(u"Red", text),
                       u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, serializer.createDefaultValue(text),
                       u"String");
}

TEST_F(CxxEnumeration, StartsWithItsZeroAndIsAbsentAsItself)
{
    EnumPropertySerializerAsName<ColourValue> const serializer(colour);

    EXPECT_EQ(serializer.createDefaultValue(colour), numbered(0));
    Value const absent = serializer.createEmptyOptionalValue(colour);
    EXPECT_EQ(absent.getType(), colour);
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_FALSE(absent.getEnumNumber());
}

TEST_F(CxxEnumeration, MakesCollectionsOfItsNumbers)
{
    EnumPropertySerializerAsName<ColourValue> const serializer(colour);
    std::vector<Value> const values = {numbered(3), numbered(-1), numbered(3)};

    Value const sequence = serializer.combineAsUnmanagedSequenceValue(colour, values);
    Value const set = serializer.combineAsUnmanagedSetValue(colour, values);

    EXPECT_EQ(sequence.getValue<std::vector<long>>(), (std::vector<long>{3, -1, 3}));
    EXPECT_EQ(sequence.extractEntryValues(), values);
    EXPECT_EQ(set.getValue<std::set<long>>(), (std::set<long>{-1, 3}));
}

TEST_F(CxxEnumeration, ReadsOptionalValuesAndRefusesOtherTypes)
{
    EnumPropertySerializerAsName<ColourValue> const serializer(colour);

    EXPECT_EQ(serializer.parseOptionalValue(u"Red", colour), numbered(3));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.parseOptionalValue(u"Red", StandardTypes::stringMeta), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.serializeValue(Value(StandardTypes::integerMeta, 3)), u"Integer");
}
}  // namespace
}  // namespace tarn::kiln::meta
