// The examples of docs/queries.md, compiled and run. blocksInSource.py sees that both say the same.
#include "library/BookConstrainables.h"
#include "library/BookImpl.h"
#include "library/LibraryImpl.h"
#include "library/ReaderConstrainables.h"
#include "library/ReaderImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/query/AbstractQuery.h"
#include "tarnkiln/query/Results.h"
#include "tarnkiln/query/RetargetableQuery.h"

#include <gtest/gtest.h>

namespace library {
namespace {

using testing::ElementsAre;
using testing::UnorderedElementsAre;

class QueryPage : public testing::Test
{
protected:
    QueryPage()
    {
        add(u"Emma", 1815);
        add(u"Persuasion", 1817)->setShelf(Shelf::Locked);
        add(u"Camilla", 1816)->setReader(m_reader);
        m_reader->setName(u"Anne");
        m_reader->setLibrary(m_library);
    }

    Book add(ustring const& title, int year)
    {
        Book const book = Book::create(model);
        book->setTitle(title);
        book->setYear(year);
        book->setLibrary(m_library);
        return book;
    }
    void print(ustring const& line) { m_printed.push_back(line); }

    Model const model = Model::create(ModelConstellation());
    Library const m_library = Library::create(model);
    Reader const m_reader = Reader::create(model);
    std::vector<ustring> m_printed;
};

TEST_F(QueryPage, AsksForElements)
{
    query::AbstractQuery query(model);
    Book::Constrainables books({query, query::SearchClassMatchMode::MatchSubclasses});
    books.title.like(u"%a");
    books.year >= 1816;
    books.shelf != Shelf::Locked;

    for (auto const& [book] : query.results(books))
        print(book->getTitle());

    EXPECT_THAT(m_printed, ElementsAre(u"Camilla"));
}

TEST_F(QueryPage, JoinsByAReference)
{
    query::AbstractQuery query(model);
    Book::Constrainables books({query, query::SearchClassMatchMode::MatchSubclasses});
    Reader::Constrainables readers({query, query::SearchClassMatchMode::MatchSubclasses});
    books.reader.refersTo(readers);
    readers.name == u"Anne";

    for (auto const& [book, reader] : query.results(books, readers))
        print(book->getTitle() + u" is with " + reader->getName());

    EXPECT_THAT(m_printed, ElementsAre(u"Camilla is with Anne"));
}

TEST_F(QueryPage, JoinsByMembersAndTakesAPart)
{
    query::AbstractQuery query(model);
    Book::Constrainables earlier({query, query::SearchClassMatchMode::MatchSubclasses});
    Book::Constrainables later({query, query::SearchClassMatchMode::MatchSubclasses});
    earlier.year < later.year;
    earlier.library == later.library;

    for (auto const& [first, second] : query.results(earlier, later))
        print(first->getTitle() + u", " + second->getTitle());
    EXPECT_THAT(m_printed, UnorderedElementsAre(u"Emma, Persuasion", u"Emma, Camilla",
                                                u"Camilla, Persuasion"));

    query.setResultOffset(1);
    query.setResultLimit(2);
    std::size_t const rows = query.getReflectiveQuery().getResultCount();

    EXPECT_EQ(rows, 2u);
}

TEST_F(QueryPage, AsksByReflection)
{
    meta::Class const bookClass = Book::metaClass();
    meta::Property const title = bookClass->getPropertyByName(u"title");

    query::AbstractQuery query(model);
    ModelElement::Constrainables sought(query, bookClass,
                                        query::SearchClassMatchMode::MatchSubclasses);
    sought.constrain(title, query::ValueMatchRelation::like,
                     Value::createPrimitiveValue(title, ustring(u"Em%")));

    for (auto const& [element] : query.results(sought))
        print(Book::cast(element)->getTitle());
    EXPECT_THAT(m_printed, ElementsAre(u"Emma"));
}
}  // namespace
}  // namespace library
