// Values that hold elements and literals of enumerations.
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/Catalogue.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tests/kernel/ValueFixture.h"
#include "tests/support/ExpectRaises.h"

#include <utility>

namespace {
using namespace tarnkiln::tests;
using meta::StandardTypes;

/// A handle class that knows enumerations for its elements, and of which a test says where it
/// stands in the metamodel; nowhere at first.
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

TEST_F(ValueOfAnElement, IsNotReadAsAHandleWithoutAClass)
{
    Value const value(book, ModelElement(colour));

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.checkCompatible<Shelf>(),
                       u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, value.getValue<Shelf>(), u"Book");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, Value(book, Shelf()), u"Book");
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

    EXPECT_NO_THROW(value.checkCompatible<long>());
    EXPECT_EQ(value.getValue<long>(), 3);
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
}  // namespace
