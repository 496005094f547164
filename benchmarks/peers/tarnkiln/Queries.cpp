#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/query/NativeTarnkilnQuery.h"

#include <string>
#include <utility>

namespace peers {
namespace {

using meta::StandardTypes;
using query::NativeTarnkilnQuery;
using query::SearchClassMatchMode;
using query::ValueMatchRelation;

constexpr char16_t const* AUTHOR = u"Author 7";

std::size_t countOf(NativeTarnkilnQuery& query)
{
    return query.getResultCount();
}

std::size_t rowsOf(NativeTarnkilnQuery& query)
{
    std::size_t rows = 0;
    std::vector<ModelElement> row;
    for (auto const found = query.getResultIterator({}); found->next(row);)
        ++rows;
    return rows;
}

/// Times `ask`, which gives a number of rows.
Measure::Round round(Measure const& measure, std::size_t rows,
                     std::function<std::size_t()> const& ask)
{
    return [&measure, rows, ask] {
        std::size_t found = 0;
        double const taken = measure.timeEach([&] { found = ask(); });
        Measure::require(found == rows, "the right number of rows");
        return taken;
    };
}

/// Books with more pages than `least`, as many percent of them as the names of workloads say.
class ManyPages
{
public:
    ManyPages(Measure const& measure, FullLibraries& libraries, int percent)
        : m_measure(measure),
          m_libraries(libraries),
          m_least(1000 - 10 * percent),
          m_rows(measure.size() / 100 * static_cast<std::size_t>(percent)),
          m_count("count " + std::to_string(percent) + " %"),
          m_list("rows " + std::to_string(percent) + " %")
    {}

    void measureOurs() const
    {
        m_measure.ours(m_count.c_str(), ask(&countOf));
        m_measure.ours(m_list.c_str(), ask(&rowsOf));
    }

    void measureFloor() const
    {
        m_measure.floor(m_count.c_str(), round(m_measure, m_rows, [this] {
                            std::size_t count = 0;
                            for (PlainBook const* book : m_libraries.plain().books)
                                count += book->pages > m_least ? 1 : 0;
                            return count;
                        }));
        m_measure.floor(m_list.c_str(), round(m_measure, m_rows, [this] {
                            std::vector<PlainBook const*> rows;
                            for (PlainBook const* book : m_libraries.plain().books)
                            {
                                if (book->pages > m_least)
                                    rows.push_back(book);
                            }
                            return rows.size();
                        }));
    }

private:
    Measure::Round ask(std::size_t (*run)(NativeTarnkilnQuery&)) const
    {
        return round(m_measure, m_rows, [this, run] {
            Library const& library = m_libraries.ours();
            NativeTarnkilnQuery query(library.model);
            std::size_t const book =
                query.addSearchClass(library.classes.book, SearchClassMatchMode::MatchSubclasses);
            query.addValueConstraint(library.classes.pages, ValueMatchRelation::greater,
                                     Value(StandardTypes::integerMeta, m_least), book);
            return run(query);
        });
    }

    Measure const& m_measure;
    FullLibraries& m_libraries;
    int const m_least;
    std::size_t const m_rows;
    std::string const m_count;
    std::string const m_list;
};

std::size_t joinOf(Library const& library)
{
    LibraryClasses const& classes = library.classes;
    NativeTarnkilnQuery query(library.model);
    auto const mode = SearchClassMatchMode::MatchSubclasses;
    std::size_t const book = query.addSearchClass(classes.book, mode);
    std::size_t const author = query.addSearchClass(classes.author, mode);
    query.addAssociatedObjectConstraint(classes.authorOf, book, author);
    query.addValueConstraint(classes.authorName, ValueMatchRelation::equal,
                             Value(StandardTypes::stringMeta, ustring(AUTHOR)), author);
    return rowsOf(query);
}

std::size_t joinOf(PlainLibrary const& library)
{
    std::vector<std::pair<PlainBook const*, PlainAuthor const*>> rows;
    for (PlainBook const* book : library.books)
    {
        if (book->author->name == AUTHOR)
            rows.emplace_back(book, book->author);
    }
    return rows.size();
}

void measureJoin(Measure const& measure, FullLibraries& libraries)
{
    char const* const workload = "rows of a join";
    std::size_t const rows = Library::BOOKS_PER_AUTHOR;
    measure.ours(workload, round(measure, rows, [&] { return joinOf(libraries.ours()); }));
    measure.floor(workload, round(measure, rows, [&] { return joinOf(libraries.plain()); }));
}
}  // namespace

void measureQueries(Measure const& measure, FullLibraries& libraries)
{
    for (int const percent : {1, 50})
    {
        ManyPages const query(measure, libraries, percent);
        query.measureOurs();
        query.measureFloor();
    }
    measureJoin(measure, libraries);
}
}  // namespace peers
