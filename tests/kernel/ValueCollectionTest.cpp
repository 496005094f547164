// Values that hold collections.
#include "tarnkiln/collections/MetaCollections.h"
#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/collections/StringToStringMap.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tests/kernel/ValueFixture.h"
#include "tests/support/ExpectRaises.h"

#include <set>
#include <vector>

namespace {
using namespace tarnkiln::tests;
using meta::StandardTypes;

class ValueOfACollection : public ValueFixture
{};

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
    meta::Class const operations = makeClass(u"Operations", meta::Operation::metaClass());
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
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(book, std::vector<meta::Operation>()), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       Value(root, std::set<meta::Operation>()), u"ModelElement");
}
}  // namespace
