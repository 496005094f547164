#include "tarnkiln/kernel/ValueMeta.h"

#include "tests/kernel/ValueFixture.h"

#include <utility>

namespace {
using namespace tarnkiln::tests;
using meta::StandardTypes;

class ShapeOfAProperty : public ValueFixture
{
protected:
    ValueFlags shape(meta::Type const& type, std::uint32_t lower, std::uint32_t upper,
                     bool ordered = false)
    {
        return ValueMeta::doGetFlags(makeProperty(type, lower, upper, ordered));
    }
};

class DescriptionOfAValue : public ValueFixture
{};

TEST(ShapeOfAValue, HasThePublishedNumbers)
{
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::OptionalSingle), 0u);
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::Single), 1u);
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::Sequence), 2u);
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::Set), 3u);
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::Map), 5u);
    EXPECT_EQ(static_cast<unsigned int>(ValueFlags::Multimap), 7u);
}

TEST_F(ShapeOfAProperty, IsSingleIfAValueIsRequired)
{
    EXPECT_EQ(shape(StandardTypes::integerMeta, 1, 1), ValueFlags::Single);
    EXPECT_EQ(shape(colour, 1, 1), ValueFlags::Single);
    EXPECT_EQ(shape(address, 1, 1), ValueFlags::Single);
    EXPECT_EQ(shape(book, 1, 1), ValueFlags::Single);
    EXPECT_EQ(shape(StandardTypes::integerMeta, 2, 1), ValueFlags::Single);
}

TEST_F(ShapeOfAProperty, IsOptionalIfThereMayBeNoValue)
{
    EXPECT_EQ(shape(StandardTypes::integerMeta, 0, 1), ValueFlags::OptionalSingle);
    EXPECT_EQ(shape(colour, 0, 1), ValueFlags::OptionalSingle);
    EXPECT_EQ(shape(address, 0, 1), ValueFlags::OptionalSingle);
    EXPECT_EQ(shape(StandardTypes::integerMeta, 0, 0), ValueFlags::OptionalSingle);
}

TEST_F(ShapeOfAProperty, IsSingleForAnOptionalReference)
{
    EXPECT_EQ(shape(book, 0, 1), ValueFlags::Single);
    EXPECT_EQ(shape(novel, 0, 0), ValueFlags::Single);
}

TEST_F(ShapeOfAProperty, FollowsTheOrderOfManyValues)
{
    EXPECT_EQ(shape(StandardTypes::integerMeta, 0, MANY, true), ValueFlags::Sequence);
    EXPECT_EQ(shape(StandardTypes::integerMeta, 0, MANY, false), ValueFlags::Set);
    EXPECT_EQ(shape(book, 1, 2, true), ValueFlags::Sequence);
    EXPECT_EQ(shape(book, 1, 2, false), ValueFlags::Set);
}

TEST_F(ShapeOfAProperty, IsKeyedByALiveQualifier)
{
    EXPECT_EQ(ValueMeta::doGetFlags(makeQualifiedProperty(book, /*uniqueKeys=*/true)),
              ValueFlags::Map);
    EXPECT_EQ(ValueMeta::doGetFlags(makeQualifiedProperty(book, /*uniqueKeys=*/false)),
              ValueFlags::Multimap);

    meta::Property const ordered = makeQualifiedProperty(book, /*uniqueKeys=*/true);
    ordered->setIsOrdered(true);
    EXPECT_EQ(ValueMeta::doGetFlags(ordered), ValueFlags::Map);
}

TEST_F(ShapeOfAProperty, IgnoresTheQualifierOfASingleValue)
{
    meta::Property const property = makeQualifiedProperty(book, /*uniqueKeys=*/true);
    property->setUpper(1);

    EXPECT_EQ(ValueMeta::doGetFlags(property), ValueFlags::Single);
}

TEST_F(ShapeOfAProperty, IgnoresADestroyedQualifier)
{
    meta::Property const property = makeQualifiedProperty(book, /*uniqueKeys=*/true);
    property->getQualifiedBy()->destroy();

    EXPECT_EQ(ValueMeta::doGetFlags(property), ValueFlags::Set);
}

TEST_F(DescriptionOfAValue, IsTakenFromAProperty)
{
    ValueMeta const description(makeProperty(StandardTypes::integerMeta, 0, 1));

    EXPECT_EQ(description.getType(), StandardTypes::integerMeta);
    EXPECT_FALSE(description.getKeyType());
    EXPECT_EQ(description.getFlags(), ValueFlags::OptionalSingle);
    EXPECT_FALSE(description.isReflective());
    EXPECT_TRUE(description.isManaged());
}

TEST_F(DescriptionOfAValue, HasTheKeyTypeOfALiveQualifier)
{
    meta::Property const property = makeQualifiedProperty(book, /*uniqueKeys=*/false);

    EXPECT_EQ(ValueMeta(property).getKeyType(), StandardTypes::stringMeta);
    EXPECT_EQ(ValueMeta(property).getType(), book);

    property->getQualifiedBy()->destroy();
    EXPECT_FALSE(ValueMeta(property).getKeyType());
}

TEST_F(DescriptionOfAValue, IsTakenFromAType)
{
    ValueMeta const description(book);

    EXPECT_EQ(description.getType(), book);
    EXPECT_FALSE(description.getKeyType());
    EXPECT_EQ(description.getFlags(), ValueFlags::Single);
    EXPECT_FALSE(description.isReflective());
    EXPECT_TRUE(description.isManaged());
}

TEST_F(DescriptionOfAValue, GetsTheClassOfAllElementsWhenItBecomesReflective)
{
    ValueMeta description(novel);
    description.setReflective();

    EXPECT_TRUE(description.isReflective());
    EXPECT_EQ(description.getType(), ModelElement::metaClass());
}

TEST_F(DescriptionOfAValue, KeepsAnyOtherTypeWhenItBecomesReflective)
{
    ValueMeta data(address);
    data.setReflective();
    ValueMeta scalar(StandardTypes::integerMeta);
    scalar.setReflective();

    EXPECT_TRUE(data.isReflective());
    EXPECT_EQ(data.getType(), address);
    EXPECT_TRUE(scalar.isReflective());
    EXPECT_EQ(scalar.getType(), StandardTypes::integerMeta);
}

TEST_F(DescriptionOfAValue, CanBeDeclaredUnmanaged)
{
    ValueMeta description(makeProperty(StandardTypes::integerMeta, 0, MANY));
    description.setUnmanaged();

    EXPECT_FALSE(description.isManaged());
}

TEST_F(DescriptionOfAValue, StaysAsItIsWhenMoved)
{
    ValueMeta source(makeQualifiedProperty(book, /*uniqueKeys=*/true));
    ValueMeta const target = std::move(source);

    for (ValueMeta const* const description : {&std::as_const(source), &target})
    {
        EXPECT_EQ(description->getType(), book);
        EXPECT_EQ(description->getKeyType(), StandardTypes::stringMeta);
        EXPECT_EQ(description->getFlags(), ValueFlags::Map);
    }
}
}  // namespace
