// How serializers are entered and found.
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/ReflectiveEnumPropertySerializer.h"
#include "tarnkiln/meta/StringPropertySerializer.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/meta/SerializerText.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::serializerOf;
using ::testing::ElementsAre;
using ::testing::IsNull;
using ::testing::NotNull;

PropertySerializerRegistry& registry()
{
    return PropertySerializerRegistry::getInstance();
}

/// Reads one text only, as a text of its own choice.
class OneTextSerializer final : public StringPropertySerializer
{
public:
    OneTextSerializer(Type const& type, ustring const& read, ustring const& result)
        : StringPropertySerializer(type),
          m_read(read),
          m_result(result)
    {}

protected:
    ustring doParseValue(ustring const& text) const override
    {
        if (text != m_read)
            throw std::runtime_error("neither text nor number");
        return m_result;
    }

private:
    ustring const m_read;
    ustring const m_result;
};

class EmptyDatatypeSerializer final : public DatatypeSerializer
{
public:
    Value getPropertyValue(Value const& value, Property const&) const override { return value; }
    Value setPropertyValue(Value const& value, Property const&, Value const&) const override
    {
        return value;
    }
    Value createEmptyOptionalValue() const override { return createDefaultValue(); }
    Value createDefaultValue() const override { return Value(StandardTypes::integerMeta, 0); }
    Value combineAsUnmanagedSequenceValue(Type const&, std::vector<Value> const&) const override
    {
        return createDefaultValue();
    }
    Value combineAsUnmanagedSetValue(Type const&, std::vector<Value> const&) const override
    {
        return createDefaultValue();
    }
};

/// A primitive type and a data type that nobody else has; they leave the registry with the test.
class SerializerRegistry : public MetamodelSketch
{
protected:
    ~SerializerRegistry() override
    {
        registry().unregisterSerializers(word);
        registry().unregisterSerializers(record);
    }

    /// Enters a serializer; returns it.
    PropertySerializer* enter(char const* flavour, ustring const& read = u"",
                              ustring const& result = u"")
    {
        auto serializer = std::make_unique<OneTextSerializer>(word, read, result);
        PropertySerializer* const entered = serializer.get();
        registry().registerPropertySerializer(word, std::move(serializer), flavour);
        return entered;
    }

    /// Words carry a `ustring`, as their namesakes would.
    static ustring textOf(Value const& value)
    {
        return serializerOf(value.getType()).serializeValue(value);
    }

    PrimitiveType const word = named<PrimitiveType>(u"Word");
    DataType const record = named<DataType>(u"Record");
};

TEST_F(SerializerRegistry, HasOneOfEachFlavourOfTheStandardTypes)
{
    using Types = StandardTypes;
    for (Type const& type : std::initializer_list<Type>{
             Types::stdstringMeta, Types::integerMeta, Types::integer8Meta, Types::integer16Meta,
             Types::integer64Meta, Types::realMeta, Types::booleanMeta, Types::unlimitedNaturalMeta,
             Types::uinteger8Meta, Types::uinteger16Meta, Types::uinteger64Meta, Types::uuidMeta,
             Types::stringMeta, Types::dateTimeMeta})
    {
        EXPECT_THAT(registry().getPropertySerializer(type, ""), NotNull());
        EXPECT_THAT(registry().getPropertySerializer(type, "other"), IsNull());
    }
    EXPECT_NE(&serializerOf(Types::realMeta, "doubleBackwardsCompatible"),
              &serializerOf(Types::realMeta));
    EXPECT_NE(&serializerOf(Types::booleanMeta, "numeric"), &serializerOf(Types::booleanMeta));
    EXPECT_NE(&serializerOf(Types::dateTimeMeta, "Rev17"), &serializerOf(Types::dateTimeMeta));
    EXPECT_THAT(registry().getPropertySerializer(Types::integerMeta, "numeric"), IsNull());
}

TEST_F(SerializerRegistry, HasNoneForOpaqueTypes)
{
    for (Type const& type :
         {Type(StandardTypes::hostArrayMeta), Type(StandardTypes::jsonValueMeta),
          Type(StandardTypes::stringToStringMapMeta), Type(cls(u"Book")), Type()})
    {
        EXPECT_THAT(registry().getPropertySerializer(type, ""), IsNull());
        EXPECT_THAT(registry().getPropertySerializerForTypeOnly(type, ""), IsNull());
    }
    EXPECT_THAT(registry().getDatatypeSerializer(DataType()), IsNull());
}

TEST_F(SerializerRegistry, FindsWhatWasEnteredByTypeAndFlavour)
{
    EXPECT_THAT(registry().getPropertySerializer(word, ""), IsNull());

    PropertySerializer* const ordinary = enter("");
    PropertySerializer* const loud = enter("loud");

    EXPECT_EQ(registry().getPropertySerializer(word, ""), ordinary);
    EXPECT_EQ(registry().getPropertySerializer(word, "loud"), loud);
    EXPECT_EQ(registry().getPropertySerializerForTypeOnly(word, "loud"), loud);
    EXPECT_THAT(registry().getPropertySerializer(word, "Loud"), IsNull());
}

TEST_F(SerializerRegistry, RefusesASecondOneOfAFlavourAndKeepsTheFirst)
{
    word->setOwningPackage(package(u"books"));
    PropertySerializer* const first = enter("loud");

    EXPECT_RAISES_WITH(messages::DuplicateTypeInRegistry, enter("loud"), u"books.Word");

    EXPECT_EQ(registry().getPropertySerializer(word, "loud"), first);
}

TEST_F(SerializerRegistry, RefusesASecondOneOfADataTypeAndKeepsTheFirst)
{
    record->setOwningPackage(package(u"books"));
    EXPECT_THAT(registry().getDatatypeSerializer(record), IsNull());
    auto serializer = std::make_unique<EmptyDatatypeSerializer>();
    DatatypeSerializer* const first = serializer.get();
    registry().registerDatatypeSerializer(record, std::move(serializer));

    EXPECT_RAISES_WITH(
        messages::DuplicateTypeInRegistry,
        registry().registerDatatypeSerializer(record, std::make_unique<EmptyDatatypeSerializer>()),
        u"books.Record");

    EXPECT_EQ(registry().getDatatypeSerializer(record), first);
}

TEST_F(SerializerRegistry, LetsOneFlavourGo)
{
    PropertySerializer* const ordinary = enter("");
    enter("loud");

    registry().unregisterPropertySerializer(word, "loud");
    registry().unregisterPropertySerializer(word, "loud");

    EXPECT_THAT(registry().getPropertySerializer(word, "loud"), IsNull());
    EXPECT_EQ(registry().getPropertySerializer(word, ""), ordinary);
    enter("loud");
    EXPECT_THAT(registry().getPropertySerializer(word, "loud"), NotNull());
}

TEST_F(SerializerRegistry, LetsAllFlavoursAndTheDataTypeGo)
{
    enter("");
    enter("loud");
    registry().registerDatatypeSerializer(record, std::make_unique<EmptyDatatypeSerializer>());
    registry().registerPropertySerializer(record,
                                          std::make_unique<OneTextSerializer>(word, u"", u""), "");

    registry().unregisterSerializers(word);
    registry().unregisterSerializers(record);
    registry().unregisterSerializers(record);

    EXPECT_THAT(registry().getPropertySerializer(word, ""), IsNull());
    EXPECT_THAT(registry().getPropertySerializer(word, "loud"), IsNull());
    EXPECT_THAT(registry().getPropertySerializer(record, ""), IsNull());
    EXPECT_THAT(registry().getDatatypeSerializer(record), IsNull());
}

TEST_F(SerializerRegistry, LetsATypeTakeThePlaceOfADeadOneWithItsUuid)
{
    UUID const id = word.getImpl()->getUuid();
    enter("");
    DataType const destroyed = record;
    registry().registerDatatypeSerializer(record, std::make_unique<EmptyDatatypeSerializer>());
    UUID const recordId = record.getImpl()->getUuid();
    word.getImpl()->destroy();
    destroyed.getImpl()->destroy();
    PrimitiveType const again = PrimitiveType::create(m_model, id);
    DataType const recordAgain = DataType::create(m_model, recordId);

    auto serializer = std::make_unique<OneTextSerializer>(word, u"", u"");
    PropertySerializer* const entered = serializer.get();
    registry().registerPropertySerializer(again, std::move(serializer), "");
    auto ofRecord = std::make_unique<EmptyDatatypeSerializer>();
    DatatypeSerializer* const enteredForRecord = ofRecord.get();
    registry().registerDatatypeSerializer(recordAgain, std::move(ofRecord));

    EXPECT_EQ(registry().getPropertySerializer(again, ""), entered);
    EXPECT_EQ(registry().getDatatypeSerializer(recordAgain), enteredForRecord);
}

TEST_F(SerializerRegistry, LendsThoseOfAStandardTypeToANamesake)
{
    PrimitiveType const truth = named<PrimitiveType>(u"Boolean");

    for (char const* const flavour : {"", "numeric"})
    {
        EXPECT_EQ(registry().getPropertySerializer(truth, flavour),
                  &serializerOf(StandardTypes::booleanMeta, flavour));
        EXPECT_THAT(registry().getPropertySerializerForTypeOnly(truth, flavour), IsNull());
    }
    EXPECT_THAT(registry().getPropertySerializer(truth, "loud"), IsNull());
}

TEST_F(SerializerRegistry, LendsThoseOfAStandardTypeToPrimitiveTypesOfItsQualifiedNameOnly)
{
    PrimitiveType const inside = named<PrimitiveType>(u"Boolean");
    inside->setOwningPackage(package(u"books"));
    DataType const structured = named<DataType>(u"Boolean");

    EXPECT_THAT(registry().getPropertySerializer(inside, ""), IsNull());
    EXPECT_THAT(registry().getPropertySerializer(structured, ""), IsNull());
}

TEST_F(SerializerRegistry, LendsSerializersThatMakeAndReadValuesOfTheNamesake)
{
    PrimitiveType const truth = named<PrimitiveType>(u"Boolean");
    PropertySerializer& serializer = serializerOf(truth);

    Value const value = serializer.parseValue(u"true", truth);

    EXPECT_EQ(value.getType(), truth);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_EQ(serializer.serializeValue(value), u"true");
    EXPECT_EQ(serializer.parseOptionalValue(u"true", truth), value);
    EXPECT_EQ(serializer.serializeValue(serializer.createDefaultValue(truth)), u"false");
    EXPECT_EQ(serializer.createEmptyOptionalValue(truth).getType(), truth);
    Value const both = serializer.combineAsUnmanagedSequenceValue(truth, {value, value});
    EXPECT_EQ(both.getType(), truth);
    EXPECT_EQ(both.getFlags(), ValueFlags::Sequence);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.serializeValue(serializer.createEmptyOptionalValue(truth)),
                       u"Boolean");
}

TEST_F(SerializerRegistry, LendsSerializersWhoseCollectionsGiveValuesOfTheNamesakeBack)
{
    PrimitiveType const number = named<PrimitiveType>(u"Integer");
    PropertySerializer& serializer = serializerOf(number);
    Value const two = serializer.parseValue(u"2", number);
    Value const one = serializer.parseValue(u"1", number);

    Value const sequence = serializer.combineAsUnmanagedSequenceValue(number, {two, one, two});
    Value const set = serializer.combineAsUnmanagedSetValue(number, {two, one, two});

    EXPECT_THAT(sequence.extractEntryValues(), ElementsAre(two, one, two));
    EXPECT_THAT(set.extractEntryValues(), ElementsAre(one, two));
    EXPECT_EQ(serializer.serializeValue(sequence.extractEntryValues()[0]), u"2");
}

TEST_F(SerializerRegistry, ReadsATextInTheFirstFlavourThatKnowsIt)
{
    enter("zebra", u"both", u"first");
    enter("loud", u"LOUD", u"second");
    PropertySerializer* const ordinary = enter("", u"quiet", u"third");
    enter("ant", u"both", u"fourth");

    auto const both = registry().parseInAnyFlavour(u"both", word);
    auto const quiet = registry().parseInAnyFlavour(u"quiet", word);

    ASSERT_TRUE(both && quiet);
    EXPECT_EQ(textOf(both->first), u"first") << "in order of entering";
    EXPECT_EQ(textOf(quiet->first), u"third");
    EXPECT_EQ(quiet->second, ordinary);
    EXPECT_FALSE(registry().parseInAnyFlavour(u"other", word));
}

TEST_F(SerializerRegistry, ReadsATextAsTheRegisteredNamesakeWould)
{
    PrimitiveType const truth = named<PrimitiveType>(u"Boolean");

    for (ustring const text : {u"true", u"1"})
    {
        auto const parsed = registry().parseInAnyFlavour(text, truth);
        ASSERT_TRUE(parsed);
        EXPECT_EQ(parsed->first, Value(StandardTypes::booleanMeta, true));
    }
    EXPECT_FALSE(registry().parseInAnyFlavour(u"yes", truth));
    EXPECT_FALSE(registry().parseInAnyFlavour(u"yes", word)) << "nobody reads words";
}
}  // namespace
}  // namespace tarn::kiln::meta
