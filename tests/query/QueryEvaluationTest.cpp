#include "tarnkiln/kernel/Freezer.h"
#include "tests/query/QueryFixture.h"
#include "tests/support/PlainElement.h"

#include <gtest/gtest.h>

namespace testkit {
namespace {

using enum ValueMatchRelation;

class QueryEvaluation : public QueryFixture
{};

TEST_F(QueryEvaluation, GivesElementsInTheOrderOfTheModel)
{
    Row expected;
    for (int number = 0; number < 40; ++number)
        makeBook(u"book", number);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);

    EXPECT_EQ(elementsOf(*query), model->getAllElements());
}

TEST_F(QueryEvaluation, TellsAClassFromItsSubclasses)
{
    ModelElement const plain = make(book);
    ModelElement const prose = make(novel);
    make(author);
    auto const query = makeQuery();
    auto const search = [&](meta::Class const& searched, SearchClassMatchMode mode) {
        query->reset();
        query->addSearchClass(searched, mode);
        return elementsOf(*query);
    };

    EXPECT_THAT(search(book, EXACTLY), ElementsAre(plain));
    EXPECT_EQ(search(book, WITH_SUBCLASSES), inOrder({plain, prose}));
    EXPECT_EQ(search(book, SearchClassMatchMode(17)), inOrder({plain, prose}));
    EXPECT_THAT(search(novel, WITH_SUBCLASSES), ElementsAre(prose));
    EXPECT_THAT(search(ModelElement::metaClass(), EXACTLY), IsEmpty());
    EXPECT_EQ(search(ModelElement::metaClass(), WITH_SUBCLASSES), model->getAllElements());
}

TEST_F(QueryEvaluation, LeavesOutElementsWithoutAClass)
{
    Plain::create(model);
    auto const query = makeQuery();
    query->addSearchClass(ModelElement::metaClass(), WITH_SUBCLASSES);

    EXPECT_EQ(query->getResultCount(), 0u);
}

TEST_F(QueryEvaluation, FindsTopLevelElements)
{
    ModelElement const whole = makeBook(u"whole");
    ModelElement const part = makeBook(u"part");
    addTo(whole, parts, part);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    EXPECT_EQ(query->getResultCount(), 2u);

    query->addTopLevelConstraint(0);

    EXPECT_THAT(elementsOf(*query), ElementsAre(whole));
}

TEST_F(QueryEvaluation, LetsAnElementStandForSeveralInstances)
{
    ModelElement const emma = makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(book, WITH_SUBCLASSES);

    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(emma, emma)));
}

TEST_F(QueryEvaluation, CombinesInstancesThatNothingTiesTogether)
{
    makeBook(u"Emma");
    makeBook(u"Persuasion");
    makeAuthor(u"Jane");
    makeAuthor(u"Mary");
    makeAuthor(u"Ann");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    Row const books = elementsOf(*query);
    query->reset();
    query->addSearchClass(author, EXACTLY);
    Row const authors = elementsOf(*query);
    query->reset();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    Rows expected;
    for (ModelElement const& second : authors)
    {
        for (ModelElement const& first : books)
            expected.push_back({first, second});
    }

    EXPECT_EQ(rowsOf(*query), expected);
    EXPECT_EQ(query->getResultCount(), 6u);
}

TEST_F(QueryEvaluation, HasNoRowsWhereAnInstanceHasNoElements)
{
    makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);

    EXPECT_THAT(rowsOf(*query), IsEmpty());
    EXPECT_EQ(query->getResultCount(), 0u);
    EXPECT_EQ(query->getFirstResult({0, 1}), Row(2));
    query->addAssociatedObjectConstraint(writer, 0, 1);
    EXPECT_THAT(rowsOf(*query), IsEmpty());
    EXPECT_EQ(query->getFirstResult({}), Row(2));
}

TEST_F(QueryEvaluation, EndsWithAnEmptyHandleForEachInstance)
{
    ModelElement const emma = makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(book, EXACTLY);
    auto const iterator = query->getResultIterator({1});
    Row row(5, emma);

    EXPECT_TRUE(iterator->next(row));
    EXPECT_THAT(row, ElementsAre(emma));
    EXPECT_FALSE(iterator->next(row));
    EXPECT_EQ(row, Row(2));
    EXPECT_FALSE(iterator->next(row));
    EXPECT_EQ(row, Row(2));
}

TEST_F(QueryEvaluation, GivesTheColumnsThatAreAskedFor)
{
    ModelElement const emma = makeBook(u"Emma");
    ModelElement const jane = makeAuthor(u"Jane");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);

    EXPECT_THAT(rowsOf(*query), ElementsAre(ElementsAre(emma, jane)));
    EXPECT_THAT(rowsOf(*query, {1, 0}), ElementsAre(ElementsAre(jane, emma)));
    EXPECT_THAT(rowsOf(*query, {1}), ElementsAre(ElementsAre(jane)));
    EXPECT_THAT(rowsOf(*query, {0, 0, 1}), ElementsAre(ElementsAre(emma, emma, jane)));
    EXPECT_THAT(query->getFirstResult({1, 1}), ElementsAre(jane, jane));
}

TEST_F(QueryEvaluation, CutsRowsAtOffsetAndLimit)
{
    for (int number = 0; number < 5; ++number)
        makeBook(u"book", number);
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    Row const all = elementsOf(*query);
    auto const cut = [&](std::size_t offset, std::size_t limit) {
        query->setResultOffset(offset);
        query->setResultLimit(limit);
        Row const rows = elementsOf(*query);
        EXPECT_EQ(query->getResultCount(), rows.size());
        EXPECT_EQ(query->getFirstResult({}), rows.empty() ? Row(1) : Row{rows.front()});
        return rows;
    };

    EXPECT_EQ(cut(0, 0), all);
    EXPECT_EQ(cut(0, 2), Row(all.begin(), all.begin() + 2));
    EXPECT_EQ(cut(2, 0), Row(all.begin() + 2, all.end()));
    EXPECT_EQ(cut(1, 2), Row(all.begin() + 1, all.begin() + 3));
    EXPECT_EQ(cut(4, 9), Row{all[4]});
    EXPECT_THAT(cut(5, 0), IsEmpty());
    EXPECT_THAT(cut(6, 1), IsEmpty());
    EXPECT_EQ(cut(0, 5), all);
    EXPECT_EQ(cut(0, 6), all);
    EXPECT_EQ(cut(0, 1), Row{all[0]});
}

TEST_F(QueryEvaluation, CutsCombinationsAfterAllHaveBeenMade)
{
    for (int number = 0; number < 3; ++number)
    {
        makeBook(u"book", number);
        makeAuthor(u"author", number);
    }
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    query->addSearchClass(author, EXACTLY);
    Rows const all = rowsOf(*query);
    query->setResultOffset(4);
    query->setResultLimit(3);

    EXPECT_EQ(rowsOf(*query), Rows(all.begin() + 4, all.begin() + 7));
    EXPECT_EQ(query->getResultCount(), 3u);
    EXPECT_EQ(query->getFirstResult({}), all[4]);
}

TEST_F(QueryEvaluation, SeesTheModelAsItIsAtEachRun)
{
    ModelElement const emma = makeBook(u"Emma");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    EXPECT_EQ(query->getResultCount(), 1u);
    ModelElement const persuasion = makeBook(u"Persuasion");
    EXPECT_EQ(query->getResultCount(), 2u);

    emma->destroy();

    EXPECT_THAT(elementsOf(*query), ElementsAre(persuasion));
    Model const other = Model::create(ModelConstellation());
    query->setModel(other);
    EXPECT_EQ(query->getResultCount(), 0u);
}

TEST_F(QueryEvaluation, KeepsRowsThatWereFound)
{
    ModelElement const emma = makeBook(u"Emma");
    auto query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    auto const iterator = query->getResultIterator({});
    emma->destroy();
    makeBook(u"Persuasion");
    query.reset();
    Row row;

    EXPECT_TRUE(iterator->next(row));
    EXPECT_THAT(row, ElementsAre(emma));
    EXPECT_FALSE(row.front());
    EXPECT_FALSE(iterator->next(row));
}

TEST_F(QueryEvaluation, KeepsElementsOfItsRowsInMemory)
{
    for (int number = 0; number < 100; ++number)
        makeBook(u"book");
    auto const query = makeQuery();
    query->addSearchClass(book, EXACTLY);
    auto const iterator = query->getResultIterator({});
    auto const narrower = query->getResultIterator({0, 0});
    for (ModelElement const& element : model->getAllElements())
        element->destroy();
    for (int number = 0; number < 100; ++number)
        makeBook(u"another");

    for (auto const* const rows : {&iterator, &narrower})
    {
        std::size_t found = 0;
        for (Row row; (*rows)->next(row); ++found)
        {
            EXPECT_FALSE(row.front());
            EXPECT_EQ(row.front()->getMetaClass(), book);
        }
        EXPECT_EQ(found, 100u);
    }
}

TEST_F(QueryEvaluation, GivesPartsOfManyRowsInTheirOrder)
{
    Rows expected;
    for (int number = 0; number < 300; ++number)
        set(make(number % 3 == 0 ? novel : book), pages, number);
    for (ModelElement const& element : model->getAllElements())
    {
        if (valueOf(element, pages).getValue<int>() > 150)
            expected.push_back({element});
    }
    auto const query = makeQuery();
    query->addSearchClass(book, WITH_SUBCLASSES);
    query->addValueConstraint(pages, greater, integer(150), 0);
    EXPECT_EQ(rowsOf(*query), expected);
    EXPECT_EQ(query->getResultCount(), 149u);
    EXPECT_EQ(query->getFirstResult({0, 0}), Row(2, expected[0][0]));

    query->setResultOffset(20);
    query->setResultLimit(100);
    EXPECT_EQ(rowsOf(*query), Rows(expected.begin() + 20, expected.begin() + 120));
    EXPECT_EQ(query->getResultCount(), 100u);
    query->setResultOffset(140);
    EXPECT_EQ(rowsOf(*query), Rows(expected.begin() + 140, expected.end()));
    EXPECT_EQ(query->getResultCount(), 9u);
    query->setResultOffset(149);
    EXPECT_EQ(rowsOf(*query), Rows());
    EXPECT_EQ(query->getResultCount(), 0u);
}

TEST_F(QueryEvaluation, OpensNoTransaction)
{
    makeBook(u"Emma");
    {
        auto const frozen = model->freeze();
        auto const query = makeQuery();
        query->addSearchClass(book, EXACTLY);
        query->addValueConstraint(pages, equal, integer(0), 0);
        EXPECT_EQ(query->getResultCount(), 1u);
    }
    EXPECT_EQ(model->getCurrentTransaction(), nullptr);
}
}  // namespace
}  // namespace testkit
