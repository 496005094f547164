#include "tarnkiln/kernel/Value.h"

#include "tarnkiln/collections/MetaCollections.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/Catalogue.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tests/kernel/ValueFixture.h"
#include "tests/support/ExpectRaises.h"

#include <set>
#include <utility>
#include <vector>

namespace {
using namespace tarnkiln::tests;
using meta::StandardTypes;

/// A handle class that knows enumerations for its elements, and of which a test says whether and
/// where it stands in the metamodel.
class Shelf : public ModelElement
{
public:
    Shelf() = default;
    explicit Shelf(ModelElement const& element) : ModelElement(element) {}

    static inline meta::Class itsClass;
    static meta::Class const& metaClass() { return itsClass; }
    static Shelf cast(ModelElement const& element)
    {
        return meta::Enum::cast(element).getElementImpl() ? Shelf(element) : Shelf();
    }
};

class ValueOfAnElement : public ValueFixture
{
protected:
    ~ValueOfAnElement() override { Shelf::itsClass = meta::Class(); }

    /// What `book` may stand for: an element of any class will do.
    ModelElement const element = person;
};

class ValueOfAnEnumeration : public ValueFixture
{};
class ValueOfACollection : public ValueFixture
{};
class ValueInGeneral : public ValueFixture
{};
class ValueWithoutPayload : public ValueFixture
{};
class ValueForAProperty : public ValueFixture
{};

// Elements

TEST_F(ValueOfAnElement, IsReadAsItWasMade)
{
    Value const value(book, element);

    EXPECT_EQ(value.getValue<ModelElement>(), element);
    EXPECT_EQ(value.getType(), book);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_TRUE(value.isManaged());
    EXPECT_FALSE(value.isReflective());
}

TEST_F(ValueOfAnElement, HasTheTypeOfTheProperty)
{
    meta::Property const property = makeProperty(book, 0, 1);

    Value const value = Value::createElementValue(property, element);

    EXPECT_EQ(value.getType(), book);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_EQ(value.getValue<ModelElement>(), element);
    EXPECT_TRUE(value == Value::createElementValue(property, element));
    EXPECT_FALSE(value == Value(novel, element));
}

TEST_F(ValueOfAnElement, KeepsTheElementInMemory)
{
    auto const countBefore = element.getElementImpl()->getRefCount();
    {
        Value const value(book, element);
        EXPECT_EQ(element.getElementImpl()->getRefCount(), countBefore + 1);
        Value const copy = value;
        EXPECT_EQ(element.getElementImpl()->getRefCount(), countBefore + 2);
    }
    EXPECT_EQ(element.getElementImpl()->getRefCount(), countBefore);
}

TEST_F(ValueOfAnElement, MayHoldAnEmptyHandle)
{
    Value const value(book, ModelElement());

    EXPECT_EQ(value.getValue<ModelElement>(), ModelElement());
    EXPECT_FALSE(value.isAbsent());
    EXPECT_TRUE(value == Value(book, ModelElement()));
    EXPECT_FALSE(value == Value(book, element));
    EXPECT_TRUE(value.isCompatibleWithProperty(makeProperty(book, 1, 1)));
}

TEST_F(ValueOfAnElement, KeepsADestroyedElement)
{
    Value const value(book, element);
    element->destroy();

    EXPECT_EQ(value.getValue<ModelElement>(), element);
    EXPECT_FALSE(value.getValue<ModelElement>());
}

TEST_F(ValueOfAnElement, NeedsAClassForItsType)
{
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(StandardTypes::stringMeta, element), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(address, element), u"Address");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(meta::Type(), element), u"");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value::createElementValue(makeProperty(colour, 1, 1), element), u"Colour");
}

TEST_F(ValueOfAnElement, NeedsALiveClass)
{
    Value const value(book, element);
    book->destroy();

    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, value.getValue<ModelElement>());
}

TEST_F(ValueOfAnElement, NeedsAClassOfElements)
{
    meta::Class const orphan = makeClass(u"Orphan", meta::Class());

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(orphan, element), u"Orphan");
}

TEST_F(ValueOfAnElement, IsReadAsAHandleOfASuperclass)
{
    Shelf::itsClass = book;

    EXPECT_EQ(Value(book, Shelf(colour)).getValue<Shelf>(), colour);
    EXPECT_EQ(Value(novel, Shelf(colour)).getValue<Shelf>(), colour);
    EXPECT_EQ(Value(novel, Shelf()).getValue<Shelf>(), Shelf());
}

TEST_F(ValueOfAnElement, IsNotReadAsAHandleOfAnotherClass)
{
    Shelf::itsClass = novel;
    Value const value(book, ModelElement(colour));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<Shelf>(), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.checkCompatible<Shelf>(),
                       u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(book, Shelf(colour)), u"Book");
}

TEST_F(ValueOfAnElement, IsNeverReadAsWhatTheElementIsNot)
{
    Shelf::itsClass = book;
    Value const value(book, ModelElement(person));

    value.checkCompatible<Shelf>();
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<Shelf>(), u"Book");
}

TEST_F(ValueOfAnElement, IsToldByTheElementWhileTheHandleHasNoClass)
{
    EXPECT_EQ(Value(book, ModelElement(colour)).getValue<Shelf>(), colour);
    EXPECT_EQ(Value(book, ModelElement()).getValue<Shelf>(), Shelf());
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(book, ModelElement(person)).checkCompatible<Shelf>(), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(book, ModelElement(person)).getValue<Shelf>(), u"Book");
}

TEST_F(ValueOfAnElement, ReadsAsAnEmptyHandleOnceItWasMovedFrom)
{
    Value source(book, element);
    Value const target = std::move(source);

    EXPECT_EQ(source.getValue<ModelElement>(), ModelElement());
    EXPECT_EQ(target.getValue<ModelElement>(), element);
}

TEST_F(ValueOfAnElement, IsStillReadOnceItIsReflective)
{
    Value value(novel, element);
    value.setReflective();

    EXPECT_EQ(value.getType(), ModelElement::metaClass());
    EXPECT_EQ(value.getValue<ModelElement>(), element);
}

TEST_F(ValueOfAnElement, IsNoModel)
{
    Value const ofAnElement(book, element);
    Value const ofAModel(Model::metaClass(), model);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, ofAnElement.getValue<Model>(),
                       u"Book");
    EXPECT_EQ(ofAModel.getValue<Model>(), model);
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, ofAModel.getValue<ModelElement>());
}

// Enumerations

TEST_F(ValueOfAnEnumeration, HoldsTheNumberOfTheLiteral)
{
    Value const value = Value::createEnumValue(red);

    EXPECT_EQ(value.getType(), colour);
    EXPECT_EQ(value.getFlags(), ValueFlags::Single);
    EXPECT_EQ(value.getValue<long>(), 3);
    EXPECT_TRUE(value.getEnumNumber() == 3L);
}

TEST_F(ValueOfAnEnumeration, KeepsTheSign)
{
    Value const value = Value::createEnumValue(blue);

    EXPECT_EQ(value.getValue<long>(), -1);
    EXPECT_TRUE(value.getEnumNumber() == -1L);
}

TEST_F(ValueOfAnEnumeration, EqualsAnotherOfTheSameNumber)
{
    EXPECT_TRUE(Value::createEnumValue(red) == Value(colour, 3L));
    EXPECT_FALSE(Value::createEnumValue(red) == Value::createEnumValue(blue));
    EXPECT_FALSE(Value::createEnumValue(red) == Value(StandardTypes::integer64Meta, 3L));
}

TEST_F(ValueOfAnEnumeration, IsReadAsNothingButLong)
{
    Value const value = Value::createEnumValue(red);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<unsigned long>(),
                       u"Colour");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<int>(), u"Colour");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.getValue<boost::optional<long>>(), u"Colour");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<ModelElement>(),
                       u"Colour");
}

TEST_F(ValueOfAnEnumeration, IsNotWhatAnIntegerOfItsNumberIs)
{
    Value const number(StandardTypes::integer64Meta, 3L);

    EXPECT_FALSE(number.isCompatibleWithProperty(makeProperty(colour, 1, 1)));
    EXPECT_TRUE(Value::createEnumValue(red).isCompatibleWithProperty(makeProperty(colour, 1, 1)));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, number.getEnumNumber(), u"Integer64");
}

TEST_F(ValueOfAnEnumeration, NeedsALiteralOfAnEnumeration)
{
    meta::EnumLiteral const loose = meta::EnumLiteral::create(model);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value::createEnumValue(loose), u"");
}

TEST_F(ValueOfAnEnumeration, CanBeOptional)
{
    meta::Property const property = makeProperty(colour, 0, 1);

    Value const present = Value::createOptionalEnumValue(property, -1L);
    Value const absent = Value::createOptionalEnumValue(property, boost::none);

    EXPECT_EQ(present.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_EQ(present.getType(), colour);
    EXPECT_TRUE(present.getEnumNumber() == -1L);
    EXPECT_FALSE(present.isAbsent());
    EXPECT_EQ(absent.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_TRUE(absent.getEnumNumber() == boost::none);
    EXPECT_TRUE(absent.isAbsent());
    EXPECT_FALSE(absent == present);
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, present.getValue<long>());
}

TEST_F(ValueOfAnEnumeration, IsNotOptionalOfAnotherType)
{
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        Value::createOptionalEnumValue(makeProperty(StandardTypes::integerMeta, 0, 1), boost::none),
        u"Integer");
}

TEST_F(ValueOfAnEnumeration, MayBeStoodForByAnInteger)
{
    Value const required(StandardTypes::integerMeta, -2);
    Value const optional(StandardTypes::integerMeta, boost::optional<int>(4));
    Value const absent(StandardTypes::integerMeta, boost::optional<int>());

    EXPECT_TRUE(required.getEnumNumber() == -2L);
    EXPECT_TRUE(optional.getEnumNumber() == 4L);
    EXPECT_TRUE(absent.getEnumNumber() == boost::none);
}

TEST_F(ValueOfAnEnumeration, HasOneNumber)
{
    Value const many(colour, std::vector<long>{1, 2});

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, many.getEnumNumber(), u"Colour");
    ASSERT_EQ(many.extractEntryValues().size(), 2u);
    EXPECT_TRUE(many.extractEntryValues()[1].getEnumNumber() == 2L);
}

// Collections

TEST_F(ValueOfACollection, SharesTheCollectionOfAnElement)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    sequence.push_back(5);

    Value const value = Value::createCollectionValue(property, &sequence);
    Value const copy = value;

    EXPECT_EQ(value.getFlags(), ValueFlags::Sequence);
    EXPECT_EQ(value.getType(), StandardTypes::integerMeta);
    EXPECT_TRUE(value.isManaged());
    EXPECT_EQ(&value.getValue<AbstractPrimitiveCollection&>(), &sequence);
    EXPECT_EQ(&copy.getValue<AbstractPrimitiveCollection&>(), &sequence);
    EXPECT_TRUE(copy == value);
}

TEST_F(ValueOfACollection, IsEqualOnlyForTheSameObject)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    PrimitiveSequence<int> alike(nullptr, /*unique=*/false, Feature(property));

    EXPECT_FALSE(Value::createCollectionValue(property, &sequence) ==
                 Value::createCollectionValue(property, &alike));
}

TEST_F(ValueOfACollection, GivesTheEntriesOfAPrimitiveCollection)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    sequence.push_back(5);
    sequence.push_back(4);

    std::vector<Value> const entries =
        Value::createCollectionValue(property, &sequence).extractEntryValues();

    ASSERT_EQ(entries.size(), 2u);
    EXPECT_EQ(entries[0].getValue<int>(), 5);
    EXPECT_EQ(entries[1].getValue<int>(), 4);
}

TEST_F(ValueOfACollection, IsReadAsWhatItsTypeSays)
{
    meta::Property const property = makeProperty(book, 0, MANY);
    UnorderedElementSet<meta::Class> set(nullptr, Feature(property), Feature());

    Value const value = Value::createCollectionValue(property, &set);

    EXPECT_EQ(value.getFlags(), ValueFlags::Set);
    EXPECT_EQ(&value.getValue<ReferenceCollection&>(), &set);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.getValue<AbstractPrimitiveCollection&>(), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<ModelElement>(),
                       u"Book");
}

TEST_F(ValueOfACollection, OfPlainValuesIsNoneOfReferences)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    Value const value = Value::createCollectionValue(property, &sequence);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       value.getValue<ReferenceCollection&>(), u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<std::vector<int>>(),
                       u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<int>(), u"Integer");
}

TEST_F(ValueOfACollection, OfReferencesHasNoEntriesToGive)
{
    meta::Property const property = makeProperty(book, 0, MANY);
    UnorderedElementSet<meta::Class> set(nullptr, Feature(property), Feature());

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value::createCollectionValue(property, &set).extractEntryValues(), u"Book");
}

TEST_F(ValueOfACollection, MustHaveACollectionToBeRead)
{
    meta::Property const plain = makeProperty(StandardTypes::integerMeta, 0, MANY);
    meta::Property const references = makeProperty(book, 0, MANY);
    Value const noPlain = Value::createCollectionValue(plain, nullptr);
    Value const noReferences = Value::createCollectionValue(references, nullptr);

    noPlain.checkCompatible<AbstractPrimitiveCollection&>();
    noReferences.checkCompatible<ReferenceCollection&>();
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       noPlain.getValue<AbstractPrimitiveCollection&>(), u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, noPlain.extractEntryValues(),
                       u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       noReferences.getValue<ReferenceCollection&>(), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, noReferences.extractEntryValues(),
                       u"Book");
}

TEST_F(ValueOfACollection, IsManagedOrNot)
{
    Value const unmanaged(StandardTypes::integerMeta, std::vector<int>{1});

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       unmanaged.getValue<AbstractPrimitiveCollection&>(), u"Integer");
}

TEST_F(ValueOfACollection, IsNotReadAsAContainerWhenDeclaredOne)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    Value value = Value::createCollectionValue(property, &sequence);
    value.setUnmanaged();

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<std::vector<int>>(),
                       u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.extractEntryValues(),
                       u"Integer");
}

TEST_F(ValueOfACollection, IsNotComparedAsAContainer)
{
    meta::Property const property = makeProperty(StandardTypes::integerMeta, 0, MANY, true);
    PrimitiveSequence<int> sequence(nullptr, /*unique=*/false, Feature(property));
    Value const managed = Value::createCollectionValue(property, &sequence);
    Value const unmanaged(StandardTypes::integerMeta, std::vector<int>());

    EXPECT_FALSE(unmanaged == managed);
    EXPECT_FALSE(managed == unmanaged);
}

TEST_F(ValueOfACollection, HasTheKeyTypeOfItsProperty)
{
    Value const value = Value::createCollectionValue(
        makeQualifiedProperty(StandardTypes::integerMeta, /*uniqueKeys=*/true), nullptr);

    EXPECT_EQ(value.getKeyType(), StandardTypes::stringMeta);
    EXPECT_EQ(value.getFlags(), ValueFlags::Map);
}

TEST_F(ValueOfACollection, MayBeAMapOfTexts)
{
    meta::Property const property = makeProperty(StandardTypes::stringToStringMapMeta, 1, 1);
    StringToStringMap map(nullptr, Feature(property));
    Value const value = Value::createCollectionValue(property, &map);

    EXPECT_EQ(&value.getValue<StringToStringMap&>(), &map);
    EXPECT_RAISES_WITH(
        messages::CannotCastIncompatibleTypes,
        Value::createCollectionValue(property, nullptr).getValue<StringToStringMap&>(),
        u"StringToStringMap");
}

TEST_F(ValueOfACollection, IsSingleForAnOptionalMapOfTexts)
{
    meta::Property const optional = makeProperty(StandardTypes::stringToStringMapMeta, 0, 1);
    StringToStringMap map(nullptr, Feature(optional));
    Value const value = Value::createCollectionValue(optional, &map);

    EXPECT_EQ(ValueFlags::Single, value.getFlags());
    EXPECT_EQ(&map, &value.getValue<StringToStringMap&>());
}

TEST_F(ValueOfACollection, OfTextsMustBeOfThatType)
{
    Value const text(StandardTypes::stringMeta, ustring(u"x"));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, text.getValue<StringToStringMap&>(),
                       u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       text.getValue<AbstractPrimitiveCollection&>(), u"String");
}

TEST_F(ValueOfACollection, MayHoldOperations)
{
    meta::Class const operations = makeClass(
        u"Operations", meta::Operation::metaClass() ? meta::Operation::metaClass() : root);
    meta::Operation const open = meta::Operation::create(model);
    meta::Operation const close = meta::Operation::create(model);

    Value const sequence(operations, std::vector<meta::Operation>{open, close});
    Value const set(operations, std::set<meta::Operation>{open, close});

    EXPECT_EQ(sequence.getValue<std::vector<meta::Operation>>().at(1), close);
    EXPECT_EQ(set.getValue<std::set<meta::Operation>>().count(open), 1u);
    ASSERT_EQ(sequence.extractEntryValues().size(), 2u);
    EXPECT_EQ(sequence.extractEntryValues()[0].getValue<meta::Operation>(), open);
    EXPECT_EQ(set.extractEntryValues().size(), 2u);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(colour, std::vector<meta::Operation>()), u"Colour");
}

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
