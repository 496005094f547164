// Plain properties of generated classes.
#include "shapes/DefaultsImpl.h"
#include "shapes/OptionalsImpl.h"
#include "shapes/Price.h"
#include "shapes/ScalarsImpl.h"
#include "shapes/ValuesImpl.h"
#include "tests/generated/ShapesFixture.h"

#include <boost/date_time/posix_time/posix_time.hpp>

#include <limits>

namespace testkit::shapes {
namespace {

boost::posix_time::ptime noon()
{
    return boost::posix_time::from_iso_string("20261121T120000");
}

Money twoDollars()
{
    Money money;
    money.setCurrency(u"USD");
    money.setAmount(2);
    return money;
}

/// A value other than the initial one for each property.
void fill(auto const& element)
{
    element->setText(ustring(u"text"));
    element->setBytes(string("bytes"));
    element->setInteger(-32);
    element->setInteger8(-8);
    element->setInteger16(-16);
    element->setInteger64(-64);
    element->setNatural(32);
    element->setUnsigned8(8);
    element->setUnsigned16(16);
    element->setUnsigned64(64);
    element->setReal(0.5);
    element->setIsSet(true);
    element->setId(UUID{{1, 2, 3}});
    element->setTime(noon());
    element->setColour(Colour::Green);
    element->setMoney(twoDollars());
}

std::vector<meta::Property> propertiesOf(meta::Class const& owner)
{
    std::vector<meta::Property> result;
    for (auto const& [name, property] : owner->getOwnedAttributes())
        result.push_back(property);
    return result;
}

using PlainProperty = ShapesTest;

TEST_F(PlainProperty, StartsEmptyIfItIsRequired)
{
    Scalars const element = Scalars::create(m_model);

    EXPECT_EQ(element->getText(), u"");
    EXPECT_EQ(element->getBytes(), "");
    EXPECT_EQ(element->getInteger(), 0);
    EXPECT_EQ(element->getInteger8(), 0);
    EXPECT_EQ(element->getInteger16(), 0);
    EXPECT_EQ(element->getInteger64(), 0);
    EXPECT_EQ(element->getNatural(), 0u);
    EXPECT_EQ(element->getUnsigned8(), 0u);
    EXPECT_EQ(element->getUnsigned16(), 0u);
    EXPECT_EQ(element->getUnsigned64(), 0u);
    EXPECT_EQ(element->getReal(), 0.0);
    EXPECT_FALSE(element->isSet());
    EXPECT_TRUE(element->getId().is_nil());
    EXPECT_TRUE(element->getTime().is_not_a_date_time());
    EXPECT_EQ(element->getColour(), Colour::None);
    EXPECT_EQ(element->getMoney(), Money());
}

TEST_F(PlainProperty, StartsAbsentIfItIsOptional)
{
    Optionals const element = Optionals::create(m_model);

    for (meta::Property const& property : propertiesOf(Optionals::metaClass()))
    {
        EXPECT_FALSE(element->hasPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS));
        EXPECT_TRUE(
            element->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS).isAbsent());
    }
}

TEST_F(PlainProperty, StartsWithItsDefault)
{
    Defaults const element = Defaults::create(m_model);

    EXPECT_EQ(element->getText(), u"a \"quoted\" \u00e4");
    EXPECT_EQ(element->getBytes(), "bytes");
    EXPECT_EQ(element->getInteger(), std::numeric_limits<int>::min());
    EXPECT_EQ(element->getUnsigned64(), std::numeric_limits<unsigned long>::max());
    EXPECT_EQ(element->getNatural(), std::numeric_limits<std::uint32_t>::max());
    EXPECT_EQ(element->getReal(), 1.5);
    EXPECT_TRUE(element->isSet());
    EXPECT_EQ(element->getId(), (UUID{{0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15}}));
    EXPECT_EQ(element->getTime(), boost::posix_time::from_iso_string("20261121T083000"));
    EXPECT_EQ(element->getColour(), Colour::BrandNew);
    EXPECT_TRUE(element->getRank() == 7);
}

TEST_F(PlainProperty, HasAFreshDynamicDefaultInEachElement)
{
    auto const before = boost::posix_time::second_clock::local_time();
    Defaults const first = Defaults::create(m_model);
    Defaults const second = Defaults::create(m_model);
    auto const after = boost::posix_time::second_clock::local_time();

    EXPECT_NE(first->getFreshId(), second->getFreshId());
    EXPECT_FALSE(first->getFreshId().is_nil());
    EXPECT_LE(before, first->getStartTime());
    EXPECT_LE(first->getStartTime(), after);
}

TEST_F(PlainProperty, IsReadByReflectionAsItsGetterGivesIt)
{
    Scalars const element = Scalars::create(m_model);
    fill(element);

    EXPECT_EQ(read(element, u"text").getValue<ustring>(), u"text");
    EXPECT_EQ(read(element, u"bytes").getValue<string>(), "bytes");
    EXPECT_EQ(read(element, u"integer").getValue<int>(), -32);
    EXPECT_EQ(read(element, u"integer8").getValue<signed char>(), -8);
    EXPECT_EQ(read(element, u"integer16").getValue<short>(), -16);
    EXPECT_EQ(read(element, u"integer64").getValue<long>(), -64);
    EXPECT_EQ(read(element, u"natural").getValue<unsigned int>(), 32u);
    EXPECT_EQ(read(element, u"unsigned8").getValue<unsigned char>(), 8u);
    EXPECT_EQ(read(element, u"unsigned16").getValue<unsigned short>(), 16u);
    EXPECT_EQ(read(element, u"unsigned64").getValue<unsigned long>(), 64u);
    EXPECT_EQ(read(element, u"real").getValue<double>(), 0.5);
    EXPECT_TRUE(read(element, u"isSet").getValue<bool>());
    EXPECT_EQ(read(element, u"id").getValue<UUID>(), (UUID{{1, 2, 3}}));
    EXPECT_EQ(read(element, u"time").getValue<boost::posix_time::ptime>(), noon());
    EXPECT_TRUE(read(element, u"colour").getEnumNumber() == static_cast<long>(Colour::Green));
    EXPECT_EQ(read(element, u"money").getValue<Money>(), twoDollars());
}

TEST_F(PlainProperty, GivesValuesThatSuitIt)
{
    Scalars const required = Scalars::create(m_model);
    Optionals const optional = Optionals::create(m_model);
    fill(required);
    fill(optional);

    for (ModelElement const& element : {ModelElement(required), ModelElement(optional)})
        for (meta::Property const& property : propertiesOf(element->getMetaClass()))
            EXPECT_TRUE(element->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS)
                            .isCompatibleWithProperty(property));
}

TEST_F(PlainProperty, IsCopiedByReflectionFromOneElementToAnother)
{
    Optionals const from = Optionals::create(m_model);
    Optionals const to = Optionals::create(m_model);
    fill(from);

    for (meta::Property const& property : propertiesOf(Optionals::metaClass()))
        to->setPropertyValue(property,
                             from->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS),
                             ModelElement::Impl::PUBLIC_ACCESS);

    EXPECT_TRUE(to->getText() == ustring(u"text"));
    EXPECT_TRUE(to->getColour() == Colour::Green);
    EXPECT_TRUE(to->getMoney() == twoDollars());
    EXPECT_TRUE(to->getTime() == noon());
    EXPECT_TRUE(to->getUnsigned8() == static_cast<unsigned char>(8));
}

TEST_F(PlainProperty, TakesNumbersOfItsOwnEnumerationOnly)
{
    Scalars const element = Scalars::create(m_model);
    meta::Enum const colour = ShapesMetaPackage::getInstance().getEnum(rows::enumerations::Colour);

    write(element, u"colour", Value(colour, 3L));

    EXPECT_EQ(element->getColour(), Colour::Red);
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  write(element, u"colour", Value(meta::StandardTypes::integer64Meta, 3L)));
    EXPECT_EQ(element->getColour(), Colour::Red);
}

TEST_F(PlainProperty, IsClearedByTheEmptyValueOfAnOptionalEnumeration)
{
    Optionals const element = Optionals::create(m_model);
    element->setColour(Colour::Red);

    write(element, u"colour", Value::createEmptyValue(property(Optionals::metaClass(), u"colour")));

    EXPECT_FALSE(element->getColour());
}

TEST_F(PlainProperty, IsBroughtBackByARollback)
{
    Scalars const element = Scalars::create(m_model);
    fill(element);

    takeBack([&] {
        element->setText(u"other");
        element->setReal(2);
        element->setColour(Colour::Red);
        element->setMoney(Money());
    });

    EXPECT_EQ(element->getText(), u"text");
    EXPECT_EQ(element->getReal(), 0.5);
    EXPECT_EQ(element->getColour(), Colour::Green);
    EXPECT_EQ(element->getMoney(), twoDollars());
}

TEST_F(PlainProperty, OfManyValuesKeepsItsCollection)
{
    Values const element = Values::create(m_model);

    for (int const number : {3, 1, 3})
        element->getNumbers().push_back(number);
    for (char16_t const* const label : {u"b", u"a", u"b"})
        element->getLabels().push_back(label);
    for (char16_t const* const word : {u"b", u"a", u"b"})
        element->getWords().insert(word);
    for (Colour const colour : {Colour::Red, Colour::Green, Colour::Red})
    {
        element->getColours().push_back(colour);
        element->getPalette().insert(colour);
    }
    element->getPayments().push_back(twoDollars());
    element->getPrices().insert(twoDollars());
    element->getPrices().insert(twoDollars());

    EXPECT_EQ(element->getNumbers().getEntries(), (std::vector<int>{3, 1, 3}));
    EXPECT_EQ(element->getLabels().getEntries(), (std::vector<ustring>{u"b", u"a"}));
    EXPECT_EQ(element->getWords().size(), 2u);
    EXPECT_EQ(element->getColours().size(), 3u);
    EXPECT_EQ(element->getPalette().size(), 2u);
    EXPECT_TRUE(element->getPalette().contains(Colour::Green));
    EXPECT_EQ(element->getPayments()[0], twoDollars());
    EXPECT_EQ(element->getPrices().size(), 1u);
}

TEST_F(PlainProperty, OfManyLiteralsIsChangedByReflection)
{
    Values const element = Values::create(m_model);
    meta::Enum const colour = ShapesMetaPackage::getInstance().getEnum(rows::enumerations::Colour);
    auto& colours = read(element, u"colours").getValue<AbstractPrimitiveCollection&>();

    colours.genericAdd(Value(colour, 4L));

    EXPECT_EQ(element->getColours()[0], Colour::Green);
    EXPECT_TRUE(colours.getAllValues().at(0).getEnumNumber() == 4L);
    EXPECT_EQ(colours.getCollectionType(), colour);
}

TEST_F(PlainProperty, OfManyValuesIsBroughtBackByARollback)
{
    Values const element = Values::create(m_model);
    element->getColours().push_back(Colour::Red);
    element->getPayments().push_back(twoDollars());

    takeBack([&] {
        element->getColours().push_back(Colour::Green);
        element->getPayments().clear();
    });

    EXPECT_EQ(element->getColours().getEntries(), std::vector<Colour>{Colour::Red});
    EXPECT_EQ(element->getPayments().getEntries(), std::vector<Money>{twoDollars()});
}

TEST(DataTypeValue, IsComparedFieldByFieldInTheirOrder)
{
    Money const plain;
    Money more;
    more.setAmount(1);
    Money rated;
    rated.setRate(0.0);
    Money later;
    later.setCurrency(u"USD");
    later.setAmount(-1);

    EXPECT_EQ(plain.getCurrency(), u"EUR");
    EXPECT_EQ(plain.getColour(), Colour::Green);
    EXPECT_EQ(plain.compareWith(Money()), 0);
    EXPECT_LT(plain.compareWith(rated), 0);  // what is absent comes first
    EXPECT_LT(rated.compareWith(more), 0);
    EXPECT_LT(more.compareWith(later), 0);
    EXPECT_GT(later.compareWith(more), 0);
}

TEST(DataTypeValue, HoldsValuesOfOtherDataTypes)
{
    Price left;
    Price right;
    EXPECT_EQ(left, right);

    Money money;
    money.setAmount(1);
    right.setTax(money);
    EXPECT_LT(left, right);
    left.setNet(money);
    EXPECT_LT(right, left);
}

TEST(DataTypeValue, GivesNaNAPlaceOfItsOwn)
{
    Money left;
    left.setRate(std::numeric_limits<double>::quiet_NaN());
    Money const same = left;
    Money number;
    number.setRate(std::numeric_limits<double>::infinity());

    EXPECT_EQ(left, same);
    EXPECT_LT(number, left);
}
}  // namespace
}  // namespace testkit::shapes
