/// \file
/// Questions to books and their writers, each as a query and as a loop that a person would write.
///
/// `ask` states the query for that share of the books, `run` runs it to its last row, and `loop`
/// finds the same rows by generated getters; both give the number of rows. What the loops find they
/// keep in a vector of handles, as queries do.
#pragma once
#include "benchmarks/query/Shelves.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/query/NativeTarnkilnQuery.h"
#include "textkit/regex/Pattern.h"

#include <cstddef>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace benchkit {

using query::NativeTarnkilnQuery;
using query::ValueMatchRelation;

inline std::size_t walkRows(NativeTarnkilnQuery& query)
{
    std::size_t rows = 0;
    std::vector<ModelElement> row;
    for (auto const found = query.getResultIterator({}); found->next(row);)
        ++rows;
    return rows;
}

inline std::size_t searchFor(NativeTarnkilnQuery& query, meta::Class const& metaClass)
{
    return query.addSearchClass(metaClass, query::SearchClassMatchMode::MatchSubclasses);
}

/// Books with many pages: instance 0 of most queries.
struct ManyPages
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        searchFor(query, Book::metaClass());
        query.addValueConstraint(
            Book::metaClass()->getPropertyByName(u"pages"), ValueMatchRelation::greater,
            Value(meta::StandardTypes::integerMeta, Shelves::boundFor(percent)), 0);
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        int const bound = Shelves::boundFor(percent);
        std::vector<Book> found;
        for (Book const& book : shelves.books)
        {
            if (book->getPages() > bound)
                found.push_back(book);
        }
        return found.size();
    }
};

inline void askForTitle(NativeTarnkilnQuery& query, ValueMatchRelation relation,
                        char16_t const* pattern)
{
    searchFor(query, Book::metaClass());
    query.addValueConstraint(Book::metaClass()->getPropertyByName(u"title"), relation,
                             Value(meta::StandardTypes::stringMeta, ustring(pattern)), 0);
}

struct Like
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        askForTitle(query, ValueMatchRelation::like, percent == 1 ? u"%is rare%" : u"%sought%");
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        std::u16string_view const part = percent == 1 ? u"is rare" : u"sought";
        std::vector<Book> found;
        for (Book const& book : shelves.books)
        {
            if (book->getTitle().find(part) != ustring::npos)
                found.push_back(book);
        }
        return found.size();
    }
};

struct Regexp
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        askForTitle(query, ValueMatchRelation::regexp, patternFor(percent));
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    /// With the same compiled pattern: the standard library has none for UTF-16.
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        textkit::regex::Pattern const pattern(patternFor(percent));
        std::vector<Book> found;
        for (Book const& book : shelves.books)
        {
            if (pattern.isFoundIn(book->getTitle()))
                found.push_back(book);
        }
        return found.size();
    }

private:
    static char16_t const* patternFor(std::int64_t percent)
    {
        return percent == 1 ? u"number [0-9]+ is rare" : u"number [0-9]+ is (rare and )?sought$";
    }
};

struct JoinByReference
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        ManyPages::ask(query, percent);
        searchFor(query, Writer::metaClass());
        query.addAssociatedObjectConstraint(Book::metaClass()->getPropertyByName(u"writer"), 0, 1);
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        int const bound = Shelves::boundFor(percent);
        std::unordered_set<Writer> const writers(shelves.writers.begin(), shelves.writers.end());
        std::vector<std::pair<Book, Writer>> found;
        for (Book const& book : shelves.books)
        {
            if (book->getPages() <= bound)
                continue;
            if (Writer const writer = book->getWriter(); writers.count(writer))
                found.emplace_back(book, writer);
        }
        return found.size();
    }
};

struct JoinByText
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        ManyPages::ask(query, percent);
        searchFor(query, Writer::metaClass());
        query.addPropertyRelation(Book::metaClass()->getPropertyByName(u"writerName"),
                                  ValueMatchRelation::equal,
                                  Writer::metaClass()->getPropertyByName(u"name"), 0, 1);
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        int const bound = Shelves::boundFor(percent);
        std::unordered_multimap<ustring, Writer> writers;
        for (Writer const& writer : shelves.writers)
            writers.emplace(writer->getName(), writer);
        std::vector<std::pair<Book, Writer>> found;
        for (Book const& book : shelves.books)
        {
            if (book->getPages() <= bound)
                continue;
            auto const [begin, end] = writers.equal_range(book->getWriterName());
            for (auto writer = begin; writer != end; ++writer)
                found.emplace_back(book, writer->second);
        }
        return found.size();
    }
};

struct JoinOfThree
{
    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        JoinByReference::ask(query, percent);
        searchFor(query, Publisher::metaClass());
        query.addAssociatedObjectConstraint(Writer::metaClass()->getPropertyByName(u"publisher"), 1,
                                            2);
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return walkRows(query); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        struct Row
        {
            Book book;
            Writer writer;
            Publisher publisher;
        };
        int const bound = Shelves::boundFor(percent);
        std::unordered_set<Publisher> const publishers(shelves.publishers.begin(),
                                                       shelves.publishers.end());
        std::unordered_map<Writer, Publisher> writers;
        for (Writer const& writer : shelves.writers)
        {
            if (Publisher const publisher = writer->getPublisher(); publishers.count(publisher))
                writers.emplace(writer, publisher);
        }
        std::vector<Row> found;
        for (Book const& book : shelves.books)
        {
            if (book->getPages() <= bound)
                continue;
            if (auto const writer = writers.find(book->getWriter()); writer != writers.end())
                found.push_back({book, writer->first, writer->second});
        }
        return found.size();
    }
};

struct FirstResult : ManyPages
{
    static std::size_t run(NativeTarnkilnQuery& query)
    {
        return query.getFirstResult({}).front() ? 1 : 0;
    }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        int const bound = Shelves::boundFor(percent);
        for (Book const& book : shelves.books)
        {
            if (book->getPages() > bound)
                return 1;
        }
        return 0;
    }
};

struct CountWithLimit
{
    static constexpr std::size_t LIMIT = 100;

    static void ask(NativeTarnkilnQuery& query, std::int64_t percent)
    {
        ManyPages::ask(query, percent);
        query.setResultLimit(LIMIT);
    }
    static std::size_t run(NativeTarnkilnQuery& query) { return query.getResultCount(); }
    static std::size_t loop(Shelves const& shelves, std::int64_t percent)
    {
        int const bound = Shelves::boundFor(percent);
        std::size_t count = 0;
        for (Book const& book : shelves.books)
        {
            if (book->getPages() > bound && ++count == LIMIT)
                break;
        }
        return count;
    }
};
}  // namespace benchkit
