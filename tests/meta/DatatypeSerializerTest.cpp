// The fields of data types that have a C++ class.
#include "tarnkiln/meta/EnumPropertySerializer.h"
#include "tarnkiln/meta/ExtensionPrototypeDatatypeSerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/ReflectiveDataType.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/TransactionOriginDatatypeSerializer.h"
#include "tarnkiln/support/ValueAccess.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <compare>

namespace testkit {

enum class Tint : int
{
    Pale = 0,
    Dark = -2
};

/// A data type inside another one.
struct Spot
{
    int getColumn() const { return column; }
    void setColumn(int value) { column = value; }
    std::strong_ordering operator<=>(Spot const&) const = default;

    int column = 0;
};

/// A data type of a client, with fields of all kinds.
struct Mark
{
    Tint getTint() const { return tint; }
    void setTint(Tint value) { tint = value; }
    boost::optional<Tint> const& getOther() const { return other; }
    void setOther(boost::optional<Tint> const& value) { other = value; }
    Spot const& getSpot() const { return spot; }
    void setSpot(Spot const& value) { spot = value; }
    boost::optional<Spot> const& getEnd() const { return end; }
    void setEnd(boost::optional<Spot> const& value) { end = value; }

    bool operator==(Mark const& mark) const
    {
        return tint == mark.tint && other == mark.other && spot == mark.spot && end == mark.end;
    }
    bool operator<(Mark const& mark) const { return spot < mark.spot; }

    Tint tint = Tint::Dark;
    boost::optional<Tint> other;
    Spot spot;
    boost::optional<Spot> end;
};

/// The types of the running test.
tarn::kiln::meta::Type spotType;
tarn::kiln::meta::Type markType;
}  // namespace testkit

namespace tarn::kiln {
namespace support {
template <> inline constexpr bool isDataType<testkit::Spot> = true;
template <> inline constexpr bool isDataType<testkit::Mark> = true;
}  // namespace support
namespace meta {
template <> Type const& standardTypeOf<testkit::Spot>()
{
    return testkit::spotType;
}
template <> Type const& standardTypeOf<testkit::Mark>()
{
    return testkit::markType;
}
}  // namespace meta

TARNKILN_VALUE_ACCESS(testkit::Spot)
TARNKILN_VALUE_ACCESS(testkit::Mark)

namespace meta {
namespace {

using testkit::Mark;
using testkit::Spot;
using testkit::Tint;
using Types = StandardTypes;

class SpotSerializer final : public DefaultDatatypeSerializer<Spot>
{
public:
    explicit SpotSerializer(DataType const& type)
        : DefaultDatatypeSerializer(type, {field<&Spot::getColumn, &Spot::setColumn>(u"column")})
    {}
};

class MarkSerializer final : public DefaultDatatypeSerializer<Mark>
{
public:
    explicit MarkSerializer(DataType const& type)
        : DefaultDatatypeSerializer(type, {field<&Mark::getTint, &Mark::setTint>(u"tint"),
                                           field<&Mark::getOther, &Mark::setOther>(u"other"),
                                           field<&Mark::getSpot, &Mark::setSpot>(u"spot"),
                                           field<&Mark::getEnd, &Mark::setEnd>(u"end")})
    {}
};

class DatatypeFields : public OrdinarySketch
{
protected:
    DatatypeFields() { Types::ensureInitialized(); }

    Property field(ustring const& name, DataType const& owner, Type const& type, unsigned int lower)
    {
        Property const made = property(name, owner);
        made->setType(type);
        made->setLower(lower);
        made->setUpper(1);
        return made;
    }
    /// What `serializer` reads of the value that it makes of a default one and the field.
    template <class Serializer>
    static Value changed(Serializer const& serializer, Property const& property, Value const& field)
    {
        Value const value =
            serializer.setPropertyValue(serializer.createDefaultValue(), property, field);
        return serializer.getPropertyValue(value, property);
    }
};

class ClientDataType : public DatatypeFields
{
protected:
    ClientDataType()
    {
        literal(u"Pale", 0, tints);
        literal(u"Dark", -2, tints);
        column = field(u"column", spots, Types::integerMeta, 1);
        tint = field(u"tint", marks, tints, 1);
        other = field(u"other", marks, tints, 0);
        spot = field(u"spot", marks, spots, 1);
        end = field(u"end", marks, spots, 0);
        testkit::spotType = spots;
        testkit::markType = marks;
        registry.registerDatatypeSerializer(spots, std::make_unique<SpotSerializer>(spots));
        registry.registerDatatypeSerializer(marks, std::make_unique<MarkSerializer>(marks));
    }
    ~ClientDataType() override
    {
        registry.unregisterSerializers(spots);
        registry.unregisterSerializers(marks);
        testkit::spotType = Type();
        testkit::markType = Type();
    }

    Value at(int place) const { return Value(spots, Spot{place}); }

    PropertySerializerRegistry& registry = PropertySerializerRegistry::getInstance();
    Enum const tints = named<Enum>(u"Tint");
    DataType const spots = named<DataType>(u"Spot");
    DataType const marks = named<DataType>(u"Mark");
    Property column;
    Property tint;
    Property other;
    Property spot;
    Property end;
};

using FieldsOfAnOrigin = DatatypeFields;
using FieldsOfAPrototype = DatatypeFields;

TEST_F(FieldsOfAPrototype, HasSixFieldsWithTheirDefaults)
{
    DataType const type = named<DataType>(u"ExtensionPrototype");
    Property const lower = field(u"lower", type, Types::unlimitedNaturalMeta, 1);
    Property const upper = field(u"upper", type, Types::unlimitedNaturalMeta, 1);
    Property const isOrdered = field(u"isOrdered", type, Types::booleanMeta, 1);
    Property const isUnique = field(u"isUnique", type, Types::booleanMeta, 1);
    Property const name = field(u"name", type, Types::stringMeta, 1);
    Property const typeName = field(u"typeName", type, Types::stringMeta, 1);
    ExtensionPrototypeDatatypeSerializer const serializer(type);

    Value const start = serializer.createDefaultValue();

    EXPECT_EQ(start.getType(), type);
    EXPECT_EQ(start.getFlags(), ValueFlags::Single);
    EXPECT_EQ(serializer.getPropertyValue(start, lower), Value(Types::unlimitedNaturalMeta, 0u));
    EXPECT_EQ(serializer.getPropertyValue(start, upper), Value(Types::unlimitedNaturalMeta, 1u));
    EXPECT_EQ(serializer.getPropertyValue(start, isOrdered), Value(Types::booleanMeta, false));
    EXPECT_EQ(serializer.getPropertyValue(start, isUnique), Value(Types::booleanMeta, true));
    EXPECT_EQ(serializer.getPropertyValue(start, name), Value(Types::stringMeta, ustring()));
    EXPECT_EQ(serializer.getPropertyValue(start, typeName), Value(Types::stringMeta, ustring()));
    for (auto const& [property, value] : std::initializer_list<std::pair<Property, Value>>{
             {lower, Value(Types::unlimitedNaturalMeta, 7u)},
             {upper, Value(Types::unlimitedNaturalMeta, 0xFFFFFFFFu)},
             {isOrdered, Value(Types::booleanMeta, true)},
             {isUnique, Value(Types::booleanMeta, false)},
             {name, Value(Types::stringMeta, ustring(u"note"))},
             {typeName, Value(Types::stringMeta, ustring(u"String"))}})
        EXPECT_EQ(changed(serializer, property, value), value);
}

TEST_F(FieldsOfAnOrigin, HasFourFieldsWithTheirDefaults)
{
    Enum const language = named<Enum>(u"Language");
    DataType const type = named<DataType>(u"TransactionOrigin");
    Property const model = field(u"model", type, Types::uuidMeta, 1);
    Property const spoken = field(u"language", type, language, 1);
    Property const transactionId = field(u"transactionId", type, Types::uuidMeta, 1);
    Property const synchronizer = field(u"synchronizer", type, Types::uuidMeta, 0);
    TransactionOriginDatatypeSerializer const serializer(type);
    Value const id(Types::uuidMeta, testkit::uuidOf(7));

    Value const start = serializer.createDefaultValue();

    EXPECT_EQ(serializer.getPropertyValue(start, model), Value(Types::uuidMeta, UUID{}));
    EXPECT_EQ(serializer.getPropertyValue(start, spoken), Value(language, 0L));
    EXPECT_EQ(serializer.getPropertyValue(start, transactionId), Value(Types::uuidMeta, UUID{}));
    Value const absent = serializer.getPropertyValue(start, synchronizer);
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.isAbsent());

    EXPECT_EQ(changed(serializer, model, id), id);
    EXPECT_EQ(changed(serializer, transactionId, id), id);
    EXPECT_EQ(changed(serializer, spoken, Value(language, 2L)), Value(language, 2L));
    Value const present(Types::uuidMeta, boost::optional<UUID>(testkit::uuidOf(7)));
    EXPECT_EQ(changed(serializer, synchronizer, id), present);
    EXPECT_EQ(changed(serializer, synchronizer, present), present);
    EXPECT_EQ(changed(serializer, synchronizer, absent), absent);
}

TEST_F(ClientDataType, MakesValuesOfItsClass)
{
    MarkSerializer const serializer(marks);

    EXPECT_EQ(serializer.createDefaultValue(), Value(marks, Mark()));
    Value const absent = serializer.createEmptyOptionalValue();
    EXPECT_EQ(absent.getType(), marks);
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_FALSE(absent.getValue<boost::optional<Mark>>());
    EXPECT_FALSE(serializer.fromOptionalValue(absent));
    EXPECT_EQ(serializer.toOptionalValue(serializer.createDefaultValue()), Value(marks, Mark()));
    EXPECT_EQ(Value::createEmptyValue(marks, true), Value(marks, Mark()));
    EXPECT_TRUE(Value::createEmptyValue(marks, false).isAbsent());
}

TEST_F(ClientDataType, ReadsAndChangesFieldsOfAllKinds)
{
    MarkSerializer const serializer(marks);

    EXPECT_EQ(serializer.getPropertyValue(Value(marks, Mark()), tint), Value(tints, -2L));
    EXPECT_EQ(changed(serializer, tint, Value(tints, 0L)), Value(tints, 0L));
    EXPECT_EQ(changed(serializer, other, Value(tints, -2L)),
              Value::createOptionalEnumValue(other, -2L));
    EXPECT_TRUE(changed(serializer, other, Value::createEmptyValue(other)).isAbsent());
    EXPECT_EQ(changed(serializer, spot, at(3)), at(3));
    EXPECT_EQ(changed(serializer, end, at(3)), Value(spots, boost::optional<Spot>(Spot{3})));
    EXPECT_TRUE(changed(serializer, end, Value::createEmptyValue(end)).isAbsent());
}

TEST_F(ClientDataType, LeavesTheValueAsItIsWhenItMakesAChangedOne)
{
    SpotSerializer const serializer(spots);
    Value const before = at(1);

    Value const after = serializer.setPropertyValue(before, column, Value(Types::integerMeta, 2));

    EXPECT_EQ(before, at(1));
    EXPECT_EQ(after, at(2));
}

TEST_F(ClientDataType, RefusesPropertiesOfOthers)
{
    spots->setOwningPackage(package(u"maps"));
    SpotSerializer const serializer(spots);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, serializer.getPropertyValue(at(1), tint), u"tint",
                       u"maps.Spot");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, serializer.setPropertyValue(at(1), tint, at(1)),
                       u"tint", u"maps.Spot");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, serializer.getPropertyValue(at(1), Property()),
                       u"", u"maps.Spot");
}

TEST_F(ClientDataType, RefusesValuesAndFieldsOfAnotherType)
{
    MarkSerializer const serializer(marks);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.getPropertyValue(at(1), tint), u"Spot");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.setPropertyValue(at(1), tint, Value(tints, 0L)), u"Spot");
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        serializer.setPropertyValue(Value(marks, Mark()), spot, Value(Types::integerMeta, 1)),
        u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.getPropertyValue(serializer.createEmptyOptionalValue(), tint),
                       u"Mark");
}

TEST_F(ClientDataType, MakesCollectionsAndSetsInItsOwnOrder)
{
    SpotSerializer const serializer(spots);
    std::vector<Value> const values = {at(3), at(1), at(3)};

    Value const sequence = serializer.combineAsUnmanagedSequenceValue(spots, values);
    Value const set = serializer.combineAsUnmanagedSetValue(spots, values);

    EXPECT_EQ(sequence.getValue<std::vector<Spot>>(), (std::vector<Spot>{{3}, {1}, {3}}));
    EXPECT_EQ(sequence.extractEntryValues(), values);
    EXPECT_EQ(set.extractEntryValues(), (std::vector<Value>{at(1), at(3)}));
    EXPECT_FALSE(set.isManaged());
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       serializer.combineAsUnmanagedSetValue(spots, {Value(marks, Mark())}),
                       u"Mark");
}

TEST_F(ClientDataType, TurnsIntoItsReflectiveFormAndBack)
{
    Mark mark;
    mark.tint = Tint::Pale;
    mark.spot = Spot{3};
    mark.end = Spot{4};
    Value const value(marks, mark);

    ReflectiveDataType const reflective = value.toReflectiveDataType();

    EXPECT_EQ(reflective.getPropertyValue(tint), Value(tints, 0L));
    EXPECT_TRUE(reflective.getPropertyValue(other).isAbsent());
    EXPECT_EQ(reflective.getPropertyValue(spot), at(3));
    EXPECT_EQ(reflective.toNonReflectiveDataTypeValue().value(), value);
}

TEST_F(ClientDataType, TakesReflectiveValuesForItsFields)
{
    ReflectiveDataType place(spots);
    place.setPropertyValue(column, Value(Types::integerMeta, 5));
    ReflectiveDataType mark(marks);
    mark.setPropertyValue(spot, Value::createReflectiveDataTypeValue(place));
    mark.setPropertyValue(end, Value::createReflectiveDataTypeValue(place));

    boost::optional<Value> const value = mark.toNonReflectiveDataTypeValue();

    ASSERT_TRUE(value);
    EXPECT_EQ(value->getValue<Mark>().spot, Spot{5});
    EXPECT_TRUE(value->getValue<Mark>().end == Spot{5});
}

TEST_F(ClientDataType, ComparesBothFormsOfAField)
{
    ReflectiveDataType place(spots);
    place.setPropertyValue(column, Value(Types::integerMeta, 5));
    ReflectiveDataType left(marks);
    ReflectiveDataType right(marks);
    left.setPropertyValue(spot, Value::createReflectiveDataTypeValue(place));
    right.setPropertyValue(spot, at(5));

    EXPECT_EQ(left, right);
    right.setPropertyValue(spot, at(6));
    EXPECT_EQ(left.compareWith(right), -1);
}
}  // namespace
}  // namespace meta
}  // namespace tarn::kiln
