// Reading one property of many elements without a value for each.
#include "tarnkiln/meta/PropertyReader.h"
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

auto const& PRIVILEGED = ModelElement::Impl::PRIVILEGED_ACCESS;

class PropertyReaders : public ReflectiveFixture
{
protected:
    ModelElement bookOf(int number, ustring const& title)
    {
        ModelElement const made = make(book);
        set(made, pages, number);
        set(made, name, title);
        return made;
    }

    meta::Class const book = metamodel.makeClass(u"Book");
    meta::Property const pages =
        metamodel.property(book, u"pages", StandardTypes::integerMeta).required();
    meta::Property const name =
        metamodel.property(book, u"name", StandardTypes::stringMeta).required();
    meta::Property const rating = metamodel.property(book, u"rating", StandardTypes::realMeta);
    ModelElement const emma = bookOf(474, u"Emma");
};

TEST_F(PropertyReaders, ReadNumbersAndTextsOfElementAfterElement)
{
    meta::PropertyReader<int> numbers(pages);
    meta::PropertyReader<ustring> texts(name);
    ModelElement const nameless = bookOf(-3, u"");

    EXPECT_EQ(numbers.read(emma), 474);
    EXPECT_EQ(numbers.read(nameless), -3);
    EXPECT_EQ(texts.read(emma), u"Emma");
    EXPECT_EQ(texts.read(nameless), u"");
}

TEST_F(PropertyReaders, SeeEachChange)
{
    meta::PropertyReader<int> numbers(pages);
    EXPECT_EQ(numbers.read(emma), 474);

    set(emma, pages, 475);

    EXPECT_EQ(numbers.read(emma), 475);
}

TEST_F(PropertyReaders, ReadElementsOfSubclassesAndOfEarlierLayouts)
{
    meta::PropertyReader<int> numbers(pages);
    meta::Class const novel = metamodel.makeClass(u"Novel", book);
    ModelElement const first = make(novel);
    set(first, pages, 1);
    metamodel.property(novel, u"added", StandardTypes::integerMeta);
    ModelElement const second = make(novel);
    set(second, pages, 2);

    EXPECT_EQ(numbers.read(emma), 474);
    EXPECT_EQ(numbers.read(first), 1);
    EXPECT_EQ(numbers.read(second), 2);
    EXPECT_EQ(numbers.read(emma), 474);
}

TEST_F(PropertyReaders, FailAsReadingAValueDoes)
{
    meta::PropertyReader<int> numbers(pages);
    meta::PropertyReader<double> reals(pages);
    meta::PropertyReader<double> ratings(rating);
    ModelElement const other = make(metamodel.makeClass(u"Other"));

    EXPECT_RAISES_WITH(messages::NoSuchProperty, numbers.read(other), u"pages", u"rt.Other");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, reals.read(emma), u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, ratings.read(emma), u"Real");
    EXPECT_EQ(numbers.read(emma), 474);
}

TEST_F(PropertyReaders, AskForTheRightToReadEachTime)
{
    meta::PropertyReader<int> numbers(pages);
    meta::PropertyReader<int> privileged(pages, PRIVILEGED);
    EXPECT_EQ(numbers.read(emma), 474);

    pages->setIsPublicAccessor(false);

    EXPECT_RAISES(messages::NoSuchProperty, numbers.read(emma));
    EXPECT_EQ(privileged.read(emma), 474);
    pages->setIsPublicAccessor(true);
    EXPECT_EQ(numbers.read(emma), 474);
}

TEST_F(PropertyReaders, ReadALiteralAsItsNumber)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"green"});
    meta::Property const tint = metamodel.property(book, u"tint", colour).required();
    ModelElement const tinted = make(book);
    meta::PropertyReader<long> tints(tint);
    EXPECT_EQ(tints.read(tinted), 1);  // the first one by name
    Transaction const transaction = begin();
    tinted->setPropertyValue(tint, Value(colour, 0L), ModelElement::Impl::PUBLIC_ACCESS);
    EXPECT_EQ(tints.read(tinted), 0);

    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(tints.read(tinted), 1);
    EXPECT_RAISES(messages::NoSuchProperty, tints.read(emma));
}

TEST_F(PropertyReaders, ReadElementsWithGeneratedCodeToo)
{
    meta::Property const property = meta::PrimitiveType::metaClass()->getPropertyByName(u"name");
    meta::PropertyReader<ustring> names(property);

    EXPECT_EQ(names.read(StandardTypes::integerMeta), u"Integer");
    EXPECT_EQ(names.read(StandardTypes::realMeta), u"Real");
    EXPECT_EQ(names.read(pages->getType()), u"Integer");
    EXPECT_EQ(names.read(book), u"Book");
    EXPECT_EQ(names.read(pages), u"pages");
}
}  // namespace
}  // namespace testkit
