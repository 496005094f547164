#include "tests/query/QueryFixture.h"
#include "tests/support/FakeDataSource.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"

#include <gtest/gtest.h>

namespace testkit {
namespace {

using enum ValueMatchRelation;

class QueryOfValues : public QueryFixture
{};

TEST_F(QueryOfValues, ComparesRequiredValues)
{
    ModelElement const small = makeBook(u"small", 10);
    ModelElement const middle = makeBook(u"middle", 20);
    ModelElement const large = makeBook(u"large", 30);

    EXPECT_THAT(booksWith(pages, equal, integer(20)), ElementsAre(middle));
    EXPECT_EQ(booksWith(pages, notEqual, integer(20)), inOrder({small, large}));
    EXPECT_EQ(booksWith(pages, less, integer(30)), inOrder({small, middle}));
    EXPECT_THAT(booksWith(pages, greater, integer(30)), IsEmpty());
    EXPECT_EQ(booksWith(pages, greaterOrEqual, integer(20)), inOrder({middle, large}));
    EXPECT_THAT(booksWith(pages, lessOrEqual, integer(10)), ElementsAre(small));
}

TEST_F(QueryOfValues, FindsNoOrderWhereAValueIsAbsent)
{
    makeBook(u"without");
    ModelElement const rated = makeBook(u"with");
    set(rated, rating, 3);

    EXPECT_THAT(booksWith(rating, greater, integer(2)), ElementsAre(rated));
    EXPECT_THAT(booksWith(rating, less, integer(5)), ElementsAre(rated));
    Value const none = Value::createEmptyValue(rating);
    EXPECT_THAT(booksWith(rating, greater, none), IsEmpty());
    EXPECT_THAT(booksWith(rating, lessOrEqual, none), IsEmpty());
}

TEST_F(QueryOfValues, FindsOptionalValuesEqualInTheirOwnShapeOnly)
{
    ModelElement const without = makeBook(u"without");
    ModelElement const rated = makeBook(u"with");
    setValue(rated, rating, optionalValue(rating, 3));

    EXPECT_THAT(booksWith(rating, equal, optionalValue(rating, 3)), ElementsAre(rated));
    EXPECT_THAT(booksWith(rating, equal, integer(3)), IsEmpty());
    EXPECT_EQ(booksWith(rating, notEqual, integer(3)), inOrder({without, rated}));
    EXPECT_THAT(booksWith(rating, equal, Value::createEmptyValue(rating)), ElementsAre(without));
    // A run-time element keeps the shape that it was given.
    set(rated, rating, 3);
    EXPECT_THAT(booksWith(rating, equal, integer(3)), ElementsAre(rated));
    EXPECT_THAT(booksWith(rating, equal, optionalValue(rating, 3)), IsEmpty());
}

TEST_F(QueryOfValues, ComparesLiterals)
{
    ModelElement const novelOf = makeBook(u"prose");
    ModelElement const poem = makeBook(u"verse");
    set(poem, kind, 1L);
    set(poem, mood, 1L);
    Value const prose(genre, 0L);
    Value const verse(genre, 1L);
    Value const none = Value::createOptionalEnumValue(mood, boost::none);

    EXPECT_THAT(booksWith(kind, equal, verse), ElementsAre(poem));
    EXPECT_THAT(booksWith(kind, notEqual, verse), ElementsAre(novelOf));
    EXPECT_THAT(booksWith(mood, equal, verse), ElementsAre(poem));
    EXPECT_THAT(booksWith(mood, notEqual, prose), ElementsAre(poem));
    EXPECT_THAT(booksWith(mood, equal, none), ElementsAre(novelOf));
    EXPECT_THAT(booksWith(mood, notEqual, none), ElementsAre(novelOf));
}

TEST_F(QueryOfValues, ComparesReferencesWithValuesMadeForTheProperty)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const without = makeBook(u"without");
    ModelElement const emma = makeBook(u"Emma");
    set(emma, writer, jane);

    Value const wanted = Value::createElementValue(writer, jane);
    EXPECT_THAT(booksWith(writer, equal, wanted), ElementsAre(emma));
    EXPECT_THAT(booksWith(writer, notEqual, wanted), ElementsAre(without));
    EXPECT_THAT(booksWith(writer, equal, Value::createElementValue(writer, ModelElement())),
                ElementsAre(without));
    EXPECT_THAT(booksWith(writer, equal, Value(ModelElement::metaClass(), jane)), IsEmpty());
}

TEST_F(QueryOfValues, ResolvesAReferenceThatIsCompared)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const emma = makeBook(u"Emma");
    set(emma, writer, proxyOf(jane));

    EXPECT_THAT(booksWith(writer, equal, Value::createElementValue(writer, jane)),
                ElementsAre(emma));
    EXPECT_EQ(valueOf(emma, writer, ModelElement::Impl::NO_PROXY_RESOLVE).getValue<ModelElement>(),
              jane);
}

TEST_F(QueryOfValues, IsContentWithOneOfManyValues)
{
    makeBook(u"none");
    ModelElement const emma = makeBook(u"Emma");
    valuesOf(emma, scores).genericAdd(integer(3));
    valuesOf(emma, scores).genericAdd(integer(7));

    EXPECT_THAT(booksWith(scores, equal, integer(7)), ElementsAre(emma));
    EXPECT_THAT(booksWith(scores, notEqual, integer(7)), ElementsAre(emma));
    EXPECT_THAT(booksWith(scores, greater, integer(6)), ElementsAre(emma));
    EXPECT_THAT(booksWith(scores, greater, integer(7)), IsEmpty());
    // The entries are single values, though the property need not have any.
    EXPECT_THAT(booksWith(scores, equal, optionalValue(scores, 7)), IsEmpty());
}

TEST_F(QueryOfValues, HasNoPatternsForManyTextsUnlessOneIsRequired)
{
    meta::Property const words =
        metamodel.property(book, u"words", StandardTypes::stringMeta).many();
    meta::Property const labels =
        metamodel.property(book, u"labels", StandardTypes::stringMeta).many().required();
    ModelElement const emma = makeBook(u"Emma");
    valuesOf(emma, labels).genericAdd(text(u"first"));
    valuesOf(emma, labels).genericAdd(text(u"second"));

    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported, booksWith(words, like, text(u"%")),
                       "like", u"String");
    EXPECT_THAT(booksWith(labels, like, text(u"sec_nd")), ElementsAre(emma));
}

TEST_F(QueryOfValues, IsContentWithOneOfManyReferences)
{
    ModelElement const jane = makeAuthor(u"Jane");
    ModelElement const mary = makeAuthor(u"Mary");
    makeBook(u"none");
    ModelElement const emma = makeBook(u"Emma");
    addTo(emma, editors, mary);
    addTo(emma, editors, proxyOf(jane));

    EXPECT_THAT(booksWith(editors, equal, Value::createElementValue(editors, jane)),
                ElementsAre(emma));
    EXPECT_THAT(booksWith(editors, notEqual, Value::createElementValue(editors, jane)),
                ElementsAre(emma));
    EXPECT_THAT(booksWith(editors, equal, Value::createElementValue(editors, ModelElement())),
                IsEmpty());
}

TEST_F(QueryOfValues, FailsAtTheFirstValueOfAWrongType)
{
    Value const wide(StandardTypes::integer64Meta, 3L);
    EXPECT_THAT(booksWith(pages, less, wide), IsEmpty());
    makeAuthor(u"Jane");
    EXPECT_THAT(booksWith(pages, less, wide), IsEmpty());
    makeBook(u"Emma");

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, booksWith(pages, less, wide),
                       u"Integer64");
    EXPECT_THAT(booksWith(pages, equal, wide), IsEmpty());
}

TEST_F(QueryOfValues, FailsForAPropertyThatTheClassHasNotGot)
{
    makeBook(u"Emma");

    EXPECT_RAISES_WITH(messages::NoSuchProperty, booksWith(name, equal, text(u"Emma")), u"name",
                       u"rt.Book");
}

TEST_F(QueryOfValues, ReadsWhatIsNotPublic)
{
    meta::Property const secret =
        metamodel.property(book, u"secret", StandardTypes::integerMeta).required().notReadable();
    ModelElement const emma = makeBook(u"Emma");

    EXPECT_THAT(booksWith(secret, equal, integer(0)), ElementsAre(emma));
}

TEST_F(QueryOfValues, TestsConstraintsInTheirOrder)
{
    makeBook(u"Emma", 400);
    Value const wide(StandardTypes::integer64Meta, 3L);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addValueConstraint(pages, greater, integer(500), 0);
    query->addValueConstraint(pages, less, wide, 0);
    EXPECT_EQ(query->getResultCount(), 0u);
    query->addSearchClass(book, EXACTLY);
    query->addValueConstraint(pages, less, wide, 1);
    query->addValueConstraint(pages, greater, integer(500), 1);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, query->getResultCount(),
                       u"Integer64");
}

TEST_F(QueryOfValues, ComparesTwoPropertiesOfOneElement)
{
    ModelElement const emma = makeBook(u"Emma", 400);
    set(emma, printed, 400);
    ModelElement const poem = makeBook(u"poem", 3);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(pages, equal, printed, 0, 0);
    EXPECT_THAT(elementsOf(*query), ElementsAre(emma));

    query->reset();
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(pages, greater, printed, 0, 0);
    EXPECT_THAT(elementsOf(*query), ElementsAre(poem));
}

TEST_F(QueryOfValues, ComparesNoCollectionsOfOneElement)
{
    makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(scores, equal, rating, 0, 0);
    EXPECT_RAISES_WITH(failures::PropertyRelationValueNotPrimitive, query->getResultCount());

    query->reset();
    query->addSearchClass(book, EXACTLY);
    query->addPropertyRelation(rating, equal, scores, 0, 0);
    EXPECT_RAISES_WITH(failures::PropertyRelationValueNotPrimitive, query->getResultCount());
    // The query stays usable.
    query->reset();
    query->addSearchClass(book, EXACTLY);
    EXPECT_EQ(query->getResultCount(), 1u);
}

TEST_F(QueryOfValues, ComparesValuesOfGeneratedClasses)
{
    auto const& properties = NodeMetamodel::get().properties;
    meta::Property const& count = properties[Node::Impl::COUNT.index];
    meta::Property const& rank = properties[Node::Impl::RANK.index];
    meta::Property const& nodeName = properties[Node::Impl::NAME.index];
    Node const first = Node::create(model);
    first->setCount(5);
    first->setName(u"first");
    Node const second = Node::create(model);
    second->setCount(7);
    second->setRank(3);
    second->setName(u"second");
    auto const nodesWith = [&](meta::Property const& property, ValueMatchRelation relation,
                               Value const& value) {
        auto const query = makeQuery();
        query->addSearchClass(Node::metaClass(), WITH_SUBCLASSES);
        query->addValueConstraint(property, relation, value, 0);
        return elementsOf(*query);
    };

    EXPECT_THAT(nodesWith(count, greater, integer(5)), ElementsAre(second));
    EXPECT_THAT(nodesWith(count, equal, integer(5)), ElementsAre(first));
    EXPECT_THAT(nodesWith(rank, less, integer(5)), ElementsAre(second));
    EXPECT_THAT(nodesWith(rank, equal, optionalValue(rank, 3)), ElementsAre(second));
    EXPECT_THAT(nodesWith(rank, equal, integer(3)), IsEmpty());
    EXPECT_EQ(nodesWith(rank, notEqual, integer(3)), inOrder({first, second}));
    EXPECT_THAT(nodesWith(rank, equal, Value::createEmptyValue(rank)), ElementsAre(first));
    EXPECT_THAT(nodesWith(nodeName, like, text(u"sec_nd")), ElementsAre(second));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       nodesWith(count, greater, optionalValue(count, 5)), u"Integer");
}
}  // namespace
}  // namespace testkit
