#include "tarnkiln/kernel/Value.h"

#include "tarnkiln/collections/MetaCollections.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tests/kernel/ValueFixture.h"
#include "tests/support/ExpectRaises.h"

#include <set>
#include <utility>
#include <vector>

namespace {
using namespace tarnkiln::tests;
using meta::StandardTypes;

class ValueInGeneral : public ValueFixture
{};
class ValueWithoutPayload : public ValueFixture
{};
class ValueForAProperty : public ValueFixture
{};

// Values as objects

TEST_F(ValueInGeneral, ComparesTypeAndShape)
{
    Value const required(StandardTypes::integerMeta, 1);
    Value const optional(StandardTypes::integerMeta, boost::optional<int>(1));

    EXPECT_FALSE(required == optional);
    EXPECT_FALSE(optional == required);
    EXPECT_FALSE(required == Value(StandardTypes::integer64Meta, 1L));
}

TEST_F(ValueInGeneral, DoesNotCompareHowItTravels)
{
    Value const plain(StandardTypes::integerMeta, 1);
    Value marked = plain;
    marked.setReflective();
    marked.setUnmanaged();

    EXPECT_TRUE(plain == marked);
    EXPECT_TRUE(marked == plain);
}

TEST_F(ValueInGeneral, IsEqualToAnotherThatWasMovedFrom)
{
    Value first(StandardTypes::stringMeta, ustring(u"a"));
    Value second(StandardTypes::stringMeta, ustring(u"b"));
    Value const firstTarget = std::move(first);
    Value const secondTarget = std::move(second);

    EXPECT_TRUE(first == second);
    EXPECT_FALSE(first == firstTarget);
    EXPECT_FALSE(secondTarget == second);
}

TEST_F(ValueInGeneral, CanBeCopiedAndAssignedAfterItWasMovedFrom)
{
    Value source(StandardTypes::stringMeta, ustring(u"a"));
    Value const target = std::move(source);

    Value const copy = source;
    EXPECT_TRUE(copy == source);

    source = Value(StandardTypes::integerMeta, 7);
    EXPECT_EQ(source.getValue<int>(), 7);
}

TEST_F(ValueInGeneral, TakesTypeAndShapeOverInAnAssignment)
{
    Value const source =
        Value::createCollectionValue(makeQualifiedProperty(book, /*uniqueKeys=*/false), nullptr);
    Value target(StandardTypes::integerMeta, std::vector<int>{1});
    target.setReflective();

    target = source;

    EXPECT_EQ(target.getType(), book);
    EXPECT_EQ(target.getKeyType(), StandardTypes::stringMeta);
    EXPECT_EQ(target.getFlags(), ValueFlags::Multimap);
    EXPECT_FALSE(target.isReflective());
    EXPECT_TRUE(target.isManaged());
    EXPECT_TRUE(target == source);
}

TEST_F(ValueInGeneral, SurvivesItsOwnAssignment)
{
    Value value(StandardTypes::stringMeta, ustring(u"a"));
    Value& same = value;

    value = same;
    EXPECT_EQ(value.getValue<ustring>(), u"a");
    value = std::move(same);
    EXPECT_EQ(value.getValue<ustring>(), u"a");
}

TEST_F(ValueInGeneral, SwapsThePayloadInAMovingAssignment)
{
    Value source(StandardTypes::integerMeta, 1);
    Value target(StandardTypes::integerMeta, 2);

    target = std::move(source);

    EXPECT_EQ(target.getValue<int>(), 1);
    EXPECT_EQ(source.getValue<int>(), 2);
}

TEST_F(ValueInGeneral, KeepsTheOldPayloadWithTheSourceUntilThatDies)
{
    auto const countBefore = person.getElementImpl()->getRefCount();
    Value target(book, ModelElement(person));
    {
        Value source(StandardTypes::integerMeta, 1);
        target = std::move(source);

        EXPECT_EQ(person.getElementImpl()->getRefCount(), countBefore + 1);
        EXPECT_EQ(target.getType(), StandardTypes::integerMeta);
        EXPECT_EQ(source.getType(), StandardTypes::integerMeta);
        // Now it has the type of the one payload and the other payload.
        EXPECT_RAISES(messages::CannotCastIncompatibleTypes, source.getValue<int>());
    }
    EXPECT_EQ(person.getElementImpl()->getRefCount(), countBefore);
    EXPECT_EQ(target.getValue<int>(), 1);
}

TEST_F(ValueInGeneral, CopiesTheWayToItsEntriesOnlyInConstructors)
{
    Value const sequence(StandardTypes::integerMeta, std::vector<int>{1, 2});
    Value const copy = sequence;
    Value assigned(StandardTypes::integerMeta, 0);
    assigned = sequence;

    EXPECT_EQ(copy.extractEntryValues().size(), 2u);
    EXPECT_TRUE(assigned == sequence);
    EXPECT_EQ(assigned.getValue<std::vector<int>>().size(), 2u);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, assigned.extractEntryValues(),
                       u"Integer");
}

TEST_F(ValueInGeneral, KeepsTheWayToEntriesOfItsFormerKind)
{
    Value value(StandardTypes::integerMeta, std::vector<int>{1, 2});

    value = Value(StandardTypes::integerMeta, std::vector<int>{3});
    ASSERT_EQ(value.extractEntryValues().size(), 1u);
    EXPECT_EQ(value.extractEntryValues()[0].getValue<int>(), 3);

    value = Value(StandardTypes::stringMeta, std::vector<ustring>{u"a"});
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.extractEntryValues(),
                       u"String");
}

TEST_F(ValueInGeneral, ChangesNothingWhenItIsMisread)
{
    Value const value(StandardTypes::stringMeta, ustring(u"a"));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.checkCompatible<int>(),
                       u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.checkCompatible<string>(),
                       u"String");
    EXPECT_EQ(value.getValue<ustring>(), u"a");
}

TEST_F(ValueInGeneral, CanLiveInAContainer)
{
    std::vector<Value> values;
    for (int number = 0; number < 100; ++number)
        values.emplace_back(StandardTypes::integerMeta, number);
    values.erase(values.begin(), values.begin() + 50);

    EXPECT_EQ(values.front().getValue<int>(), 50);
    EXPECT_EQ(values.back().getValue<int>(), 99);
}

// Empty values

TEST_F(ValueWithoutPayload, OfAClassIsAnEmptyHandle)
{
    for (bool const required : {false, true})
    {
        Value const value = Value::createEmptyValue(book, required);

        EXPECT_EQ(value.getType(), book);
        EXPECT_EQ(value.getFlags(), ValueFlags::Single);
        EXPECT_EQ(value.getValue<ModelElement>(), ModelElement());
        EXPECT_TRUE(value == Value(book, ModelElement()));
    }
}

TEST_F(ValueWithoutPayload, IsMadeForASingleReference)
{
    Value const value = Value::createEmptyValue(makeProperty(novel, 1, 1));

    EXPECT_EQ(value.getType(), novel);
    EXPECT_EQ(value.getValue<ModelElement>(), ModelElement());
}

TEST_F(ValueWithoutPayload, IsRefusedForManyValues)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value::createEmptyValue(makeProperty(book, 0, 2)), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value::createEmptyValue(makeProperty(StandardTypes::integerMeta, 0, MANY)),
                       u"Integer");
}

TEST_F(ValueWithoutPayload, IsRefusedWithoutAType)
{
    EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(meta::Type(), true));
    EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(meta::Property()));
    EXPECT_RAISES(messages::InvalidValue, Value::createEmptyValue(makeProperty({}, 0, 1)));
}

// Properties

TEST_F(ValueForAProperty, MustHaveALivePropertyAndType)
{
    Value const value(StandardTypes::integerMeta, 1);
    meta::Property const dead = makeProperty(StandardTypes::integerMeta, 1, 1);
    dead->destroy();

    EXPECT_RAISES(messages::InvalidValue, value.checkCompatibleWithProperty(meta::Property()));
    EXPECT_RAISES(messages::InvalidValue, value.checkCompatibleWithProperty(dead));
    EXPECT_RAISES(messages::InvalidValue,
                  value.checkCompatibleWithProperty(makeProperty(meta::Type(), 1, 1)));
    EXPECT_FALSE(value.isCompatibleWithProperty(dead));
}

TEST_F(ValueForAProperty, MayHaveASubclass)
{
    Value const value(novel, ModelElement());

    value.checkCompatibleWithProperty(makeProperty(book, 0, 1));
    EXPECT_TRUE(value.isCompatibleWithProperty(makeProperty(novel, 1, 1)));
    EXPECT_TRUE(value.isCompatibleWithProperty(makeProperty(root, 1, 1)));
}

TEST_F(ValueForAProperty, MustNotHaveAnotherClass)
{
    Value const value(book, ModelElement());

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.checkCompatibleWithProperty(makeProperty(novel, 0, 1)), u"Novel");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.checkCompatibleWithProperty(makeProperty(person, 0, 1)), u"Person");
    EXPECT_FALSE(value.isCompatibleWithProperty(makeProperty(novel, 0, 1)));
}

TEST_F(ValueForAProperty, MustHaveTheVeryTypeUnlessThatIsAClass)
{
    Value const value(StandardTypes::integerMeta, 1);

    EXPECT_TRUE(value.isCompatibleWithProperty(makeProperty(StandardTypes::integerMeta, 1, 1)));
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        value.checkCompatibleWithProperty(makeProperty(StandardTypes::integer64Meta, 1, 1)),
        u"Integer64");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.checkCompatibleWithProperty(makeProperty(book, 1, 1)), u"Book");
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        Value(book, ModelElement()).checkCompatibleWithProperty(makeProperty(address, 1, 1)),
        u"Address");
}

TEST_F(ValueForAProperty, MustHaveTheShape)
{
    Value const single(StandardTypes::integerMeta, 1);
    Value const sequence(StandardTypes::integerMeta, std::vector<int>{1});
    meta::Property const ordered = makeProperty(StandardTypes::integerMeta, 0, MANY, true);

    EXPECT_TRUE(sequence.isCompatibleWithProperty(ordered));
    EXPECT_RAISES(messages::InvalidValue, single.checkCompatibleWithProperty(ordered));
    EXPECT_RAISES(messages::InvalidValue, sequence.checkCompatibleWithProperty(
                                              makeProperty(StandardTypes::integerMeta, 0, MANY)));
    EXPECT_RAISES(messages::InvalidValue, sequence.checkCompatibleWithProperty(
                                              makeProperty(StandardTypes::integerMeta, 0, 1)));
    EXPECT_FALSE(single.isCompatibleWithProperty(ordered));
}

TEST_F(ValueForAProperty, MayBeSingleWhereItMayBeAbsent)
{
    meta::Property const optional = makeProperty(StandardTypes::integerMeta, 0, 1);
    meta::Property const required = makeProperty(StandardTypes::integerMeta, 1, 1);
    Value const present(StandardTypes::integerMeta, boost::optional<int>(1));

    EXPECT_TRUE(Value(StandardTypes::integerMeta, 1).isCompatibleWithProperty(optional));
    EXPECT_TRUE(present.isCompatibleWithProperty(optional));
    EXPECT_RAISES(messages::InvalidValue, present.checkCompatibleWithProperty(required));
}

TEST_F(ValueForAProperty, MayClearAnOptionalEnumerationWhateverItsType)
{
    meta::Property const optional = makeProperty(colour, 0, 1);
    Value const absent(StandardTypes::integerMeta, boost::optional<int>());

    EXPECT_TRUE(absent.isCompatibleWithProperty(optional));
    EXPECT_TRUE(
        Value::createOptionalEnumValue(optional, boost::none).isCompatibleWithProperty(optional));
    EXPECT_TRUE(Value::createOptionalEnumValue(optional, 3L).isCompatibleWithProperty(optional));
}

TEST_F(ValueForAProperty, MayNotSetAnEnumerationByAnInteger)
{
    meta::Property const optional = makeProperty(colour, 0, 1);
    meta::Property const required = makeProperty(colour, 1, 1);
    Value const absent(StandardTypes::integerMeta, boost::optional<int>());
    Value const present(StandardTypes::integerMeta, boost::optional<int>(3));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       present.checkCompatibleWithProperty(optional), u"Colour");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       absent.checkCompatibleWithProperty(required), u"Colour");
}
}  // namespace
