#include "tarnkiln/query/AbstractQuery.h"
#include "tests/query/QueryFixture.h"

#include <gtest/gtest.h>

namespace testkit {
namespace {

using enum ValueMatchRelation;

class QueryConstruction : public QueryFixture
{};

TEST(ValueMatchRelationNames, AreThoseOfTheEnumerators)
{
    char const* const names[] = {
        "equal", "equalStringNocase", "notEqual", "greater", "greaterOrEqual",
        "less",  "lessOrEqual",       "like",     "regexp"};
    for (int number = 0; number < 9; ++number)
        EXPECT_EQ(query::ValueMatchRelationName(ValueMatchRelation(number)), names[number]);
    EXPECT_EQ(query::ValueMatchRelationName(ValueMatchRelation(9)), "");
    EXPECT_EQ(query::ValueMatchRelationName(ValueMatchRelation(-1)), "");
    EXPECT_EQ(static_cast<int>(EXACTLY), 0);
    EXPECT_EQ(static_cast<int>(WITH_SUBCLASSES), 1);
}

TEST(QueryMessages, SayWhatIsWrong)
{
    failures::RelationAndTypeNotSupported const failure("like", u"Integer");

    EXPECT_EQ(failure.GetBaseMsgIDObj().toString(), "tarnkiln:query:RelationAndTypeNotSupported");
    EXPECT_STREQ(failure.what(),
                 "the relation 'like' does not exist for this property of type 'Integer'");
    EXPECT_EQ(failures::NoModel().GetBaseMsgIDObj().toString(), "tarnkiln:query:NoModel");
    EXPECT_STREQ(failures::NoModel().what(), "the query has no model to search");
}

TEST_F(QueryConstruction, ReadsWithAllRights)
{
    EXPECT_TRUE(query::ReflectiveQuery::privilegedTag == ModelElement::Impl::PRIVILEGED_ACCESS);
}

TEST_F(QueryConstruction, NumbersInstancesFromZero)
{
    auto const query = makeQuery();

    EXPECT_EQ(query->addSearchClass(book, EXACTLY), 0u);
    EXPECT_EQ(query->addSearchClass(author, EXACTLY), 1u);
    EXPECT_EQ(query->addSearchClass(book, EXACTLY), 2u);
    query->reset();
    EXPECT_EQ(query->addSearchClass(book, EXACTLY), 0u);
}

TEST_F(QueryConstruction, RefusesToSearchAClassThatIsNotThere)
{
    auto const query = makeQuery();
    EXPECT_RAISES_WITH(failures::InvalidSearchClass, query->addSearchClass(meta::Class(), EXACTLY));
    meta::Class const dead = metamodel.makeClass(u"Dead");
    dead->destroy();
    EXPECT_RAISES_WITH(failures::InvalidSearchClass, query->addSearchClass(dead, EXACTLY));
    EXPECT_RAISES_WITH(failures::NoSearchInstances, query->getResultCount());
}

TEST_F(QueryConstruction, RefusesAValueForAnInstanceThatIsNotThere)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_RAISES_WITH(failures::NoSuchInstanceId,
                       query->addValueConstraint(pages, equal, integer(1), 1));
    // The number is looked at first.
    EXPECT_RAISES_WITH(failures::NoSuchInstanceId,
                       query->addValueConstraint(pages, like, integer(1), 7));
}

TEST_F(QueryConstruction, RefusesToCompareWithACollection)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    Value const numbers(StandardTypes::integerMeta, std::vector<int>{1, 2});

    EXPECT_RAISES_WITH(failures::PropertyRelationValueNotPrimitive,
                       query->addValueConstraint(pages, equal, numbers, 0));
    // Before it is seen that there is no such relation.
    EXPECT_RAISES_WITH(failures::PropertyRelationValueNotPrimitive,
                       query->addValueConstraint(pages, like, numbers, 0));
}

TEST_F(QueryConstruction, RefusesALikePatternThatMayBeAbsent)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_RAISES_WITH(
        failures::LikePatternNotSingle,
        query->addValueConstraint(title, like, optionalValue(note, ustring(u"a")), 0));
    // Before the type is looked at.
    EXPECT_RAISES_WITH(failures::LikePatternNotSingle,
                       query->addValueConstraint(pages, like, optionalValue(rating, 3), 0));
}

TEST_F(QueryConstruction, HasLikePatternsForTextsOnly)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_RAISES_WITH(failures::LikePatternNotString,
                       query->addValueConstraint(pages, like, integer(1), 0));
    EXPECT_RAISES_WITH(failures::LikePatternNotString,
                       query->addValueConstraint(
                           kind, like, Value::createEnumValue(genre->findLiteralByValue(0)), 0));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       query->addValueConstraint(title, like, bytes("a"), 0), u"StdString");
}

TEST_F(QueryConstruction, HasNoLikeForOptionalTexts)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addValueConstraint(note, like, text(u"a%"), 0), "like", u"String");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addValueConstraint(note, regexp, text(u"a"), 0), "regexp", u"String");
}

TEST_F(QueryConstruction, NamesTheRelationThatDoesNotExist)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addValueConstraint(pages, regexp, integer(1), 0), "regexp",
                       u"Integer");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addValueConstraint(
                           kind, greater, Value::createEnumValue(genre->findLiteralByValue(0)), 0),
                       "greater", u"Genre");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addValueConstraint(writer, equalStringNocase,
                                                 Value::createElementValue(writer, ModelElement()),
                                                 0),
                       "equalStringNocase", u"Author");
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addPropertyRelation(title, like, title, 0, 0), "like", u"String");
    query->addSearchClass(book, EXACTLY);
    EXPECT_RAISES_WITH(failures::RelationAndTypeNotSupported,
                       query->addPropertyRelation(writer, less, writer, 0, 1), "less", u"Author");
}

TEST_F(QueryConstruction, ComparesPropertiesOfOneTypeOnly)
{
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);

    EXPECT_RAISES_WITH(failures::PropertyRelationPropertyTypeMismatch,
                       query->addPropertyRelation(title, equal, shelfMark, 0, 0));
    EXPECT_RAISES_WITH(failures::PropertyRelationPropertyTypeMismatch,
                       query->addPropertyRelation(title, like, born, 0, 1));
}

TEST_F(QueryConstruction, LeavesTheQueryAloneWhenAConstraintIsRefused)
{
    makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    EXPECT_RAISES(failures::LikePatternNotString,
                  query->addValueConstraint(pages, like, integer(1), 0));
    EXPECT_RAISES(failures::RelationAndTypeNotSupported,
                  query->addPropertyRelation(title, like, title, 0, 0));

    EXPECT_EQ(query->getResultCount(), 1u);
}

TEST_F(QueryConstruction, NeedsASearchInstanceBeforeAModel)
{
    auto const query = query::createNativeQuery();

    EXPECT_RAISES_WITH(failures::NoSearchInstances, query->getResultCount());
    EXPECT_RAISES_WITH(failures::NoSearchInstances, query->getResultIterator({}));
    EXPECT_RAISES_WITH(failures::NoSearchInstances, query->getFirstResult({}));
    query->addSearchClass(book, EXACTLY);
    EXPECT_RAISES_WITH(failures::NoModel, query->getResultCount());
    EXPECT_RAISES_WITH(failures::NoModel, query->getResultIterator({}));
    EXPECT_RAISES_WITH(failures::NoModel, query->getFirstResult({}));
}

TEST_F(QueryConstruction, DoesNotRunOnADestroyedModel)
{
    Model const other = Model::create(ModelConstellation());
    auto const query = query::createNativeQuery(other);
    query->addSearchClass(book, EXACTLY);
    EXPECT_EQ(query->getResultCount(), 0u);

    other->destroy();

    EXPECT_RAISES_WITH(failures::NoModel, query->getResultCount());
}

TEST_F(QueryConstruction, KeepsItsModelWhenItIsReset)
{
    makeBook(u"Emma");
    makeBook(u"Persuasion");
    auto const query = makeQuery();
    query->addSearchClass(author, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    query->addAssociatedObjectConstraint(writer, 1, 0);
    query->setResultLimit(1);
    query->setResultOffset(1);

    query->reset();

    EXPECT_EQ(query->getModel(), model);
    EXPECT_RAISES_WITH(failures::NoSearchInstances, query->getResultCount());
    query->addSearchClass(book, EXACTLY);
    EXPECT_EQ(query->getResultCount(), 2u);
}

TEST_F(QueryConstruction, OutlivesTheHandleOfTheSearchClass)
{
    ModelElement const emma = makeBook(u"Emma");
    auto const query = makeQuery();
    {
        meta::Class const temporary = book;
        query->addSearchClass(temporary, EXACTLY);
    }

    EXPECT_THAT(elementsOf(*query), ElementsAre(emma));
}

TEST_F(QueryConstruction, CopiesAQueryToAnotherModel)
{
    ModelElement const jane = makeAuthor(u"Jane", 1775);
    ModelElement const emma = makeBook(u"Emma", 400);
    ModelElement const part = makeBook(u"Emma, volume one", 400);
    set(emma, writer, jane);
    set(emma, printed, 400);
    set(part, writer, jane);
    addTo(emma, parts, part);
    auto const source = query::createNativeQuery();
    source->addSearchClass(book, EXACTLY);
    source->addSearchClass(author, WITH_SUBCLASSES);
    source->addValueConstraint(title, like, text(u"%Emma_%"), 0);
    source->addValueConstraint(pages, greater, integer(100), 0);
    source->addPropertyRelation(pages, greaterOrEqual, printed, 0, 0);
    source->addPropertyRelation(pages, notEqual, born, 0, 1);
    source->addAssociatedObjectConstraint(writer, 0, 1);
    auto const copy = makeQuery();
    copy->addSearchClass(novel, EXACTLY);
    copy->setResultLimit(7);

    source->retargetTo(*copy);

    EXPECT_THAT(rowsOf(*copy), ElementsAre(ElementsAre(part, jane)));
    EXPECT_EQ(copy->getModel(), model);
    EXPECT_RAISES_WITH(failures::NoModel, source->getResultCount());
    source->addTopLevelConstraint(0);
    source->retargetTo(*copy);
    EXPECT_THAT(rowsOf(*copy), IsEmpty());
}

TEST_F(QueryConstruction, CopiesLimitAndOffset)
{
    for (int number = 0; number < 5; ++number)
        makeBook(u"Emma", number);
    auto const source = makeQuery();
    source->addSearchClass(book, EXACTLY);
    source->setResultLimit(2);
    source->setResultOffset(1);
    auto const copy = makeQuery();

    source->retargetTo(*copy);

    EXPECT_EQ(rowsOf(*copy), rowsOf(*source));
    EXPECT_EQ(copy->getResultCount(), 2u);
    copy->setResultLimit(0);
    EXPECT_EQ(copy->getResultCount(), 4u);
}

TEST_F(QueryConstruction, CopiesTheModeOfAnInstance)
{
    make(book);
    ModelElement const emma = make(novel);
    auto const source = makeQuery();
    source->addSearchClass(novel, EXACTLY);
    source->addSearchClass(book, WITH_SUBCLASSES);
    auto const copy = makeQuery();

    source->retargetTo(*copy);

    EXPECT_EQ(copy->getResultCount(), 2u);
    EXPECT_EQ(copy->getFirstResult({0}).front(), emma);
}

TEST_F(QueryConstruction, TranslatesALikePatternOnceOnly)
{
    ModelElement const odd = makeBook(u"a.*b");
    makeBook(u"axxb");
    auto const source = makeQuery();
    source->addSearchClass(book, EXACTLY);
    source->addValueConstraint(title, like, text(u"a.*b"), 0);
    auto const copy = makeQuery();
    source->retargetTo(*copy);
    auto const copyOfCopy = makeQuery();
    copy->retargetTo(*copyOfCopy);

    EXPECT_THAT(elementsOf(*source), ElementsAre(odd));
    EXPECT_THAT(elementsOf(*copyOfCopy), ElementsAre(odd));
}

TEST_F(QueryConstruction, DoesNotCopyAClassThatWasDestroyed)
{
    meta::Class const doomed = metamodel.makeClass(u"Doomed");
    auto const source = makeQuery();
    source->addSearchClass(book, EXACTLY);
    source->addSearchClass(doomed, EXACTLY);
    auto const copy = makeQuery();
    doomed->destroy();

    EXPECT_RAISES_WITH(failures::InvalidSearchClass, source->retargetTo(*copy));
}

TEST_F(QueryConstruction, GivesAbstractQueriesAReflectiveOne)
{
    makeBook(u"Emma");
    makeBook(u"Persuasion");
    query::AbstractQuery const withoutModel;
    withoutModel.getReflectiveQuery().addSearchClass(book, EXACTLY);
    EXPECT_RAISES_WITH(failures::NoModel, withoutModel.getReflectiveQuery().getResultCount());

    withoutModel.getReflectiveQuery().setModel(model);

    EXPECT_EQ(withoutModel.getReflectiveQuery().getResultCount(), 2u);
    query::AbstractQuery abstract(model);
    EXPECT_EQ(abstract.getReflectiveQuery().getModel(), model);
    abstract.getReflectiveQuery().addSearchClass(book, EXACTLY);
    abstract.setResultOffset(1);
    EXPECT_EQ(abstract.getReflectiveQuery().getResultCount(), 1u);
    abstract.setResultOffset(0);
    abstract.setResultLimit(1);
    EXPECT_EQ(abstract.getReflectiveQuery().getResultCount(), 1u);
}
}  // namespace
}  // namespace testkit
