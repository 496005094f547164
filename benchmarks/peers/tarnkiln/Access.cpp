#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "tarnkiln/meta/PropertyReader.h"

namespace peers {
namespace {

/// Reads pages in the way of all properties.
class ByValue
{
public:
    static constexpr char const* IN_ORDER = "read in order, Value";
    static constexpr char const* AT_RANDOM = "read at random, Value";

    explicit ByValue(LibraryClasses const& classes) : m_pages(classes.pages) {}

    int read(ModelElement const& book) const
    {
        return book->getPropertyValue(m_pages, ACCESS).getValue<int>();
    }

private:
    meta::Property const& m_pages;
};

/// Reads pages without a `Value`.
class ByReader
{
public:
    static constexpr char const* IN_ORDER = "read in order, typed accessor";
    static constexpr char const* AT_RANDOM = "read at random, typed accessor";

    explicit ByReader(LibraryClasses const& classes) : m_pages(classes.pages) {}

    int read(ModelElement const& book) { return m_pages.read(book); }

private:
    meta::PropertyReader<int> m_pages;
};

template <class Way> void measureReading(Measure const& measure, FullLibraries& libraries)
{
    measure.ours(Way::IN_ORDER, [&] {
        Library const& library = libraries.ours();
        long sum = 0;
        return measure.timeEach([&] {
            Way way(library.classes);
            for (ModelElement const& book : library.books)
                sum += way.read(book);
            Measure::keep(sum);
        });
    });
    measure.ours(Way::AT_RANDOM, [&] {
        Library const& library = libraries.ours();
        long sum = 0;
        return measure.timeEach([&] {
            Way way(library.classes);
            for (std::size_t const i : measure.order())
                sum += way.read(library.books[i]);
            Measure::keep(sum);
        });
    });
    measure.floor(Way::IN_ORDER, [&] {
        std::vector<WithPages*> const books = libraries.plain().booksWithPages();
        long sum = 0;
        return measure.timeEach([&] {
            for (WithPages const* book : books)
                sum += book->getPages();
            Measure::keep(sum);
        });
    });
    measure.floor(Way::AT_RANDOM, [&] {
        std::vector<WithPages*> const books = libraries.plain().booksWithPages();
        long sum = 0;
        return measure.timeEach([&] {
            for (std::size_t const i : measure.order())
                sum += books[i]->getPages();
            Measure::keep(sum);
        });
    });
}

void measureSetting(Measure const& measure, FullLibraries& libraries)
{
    int turn = 0;
    measure.ours("set, Value", [&] {
        Library const& library = libraries.ours();
        ++turn;
        double const taken = measure.timeEach([&] {
            library.change(/*revertible=*/false, [&] {
                for (std::size_t i = 0; i < measure.size(); ++i)
                    library.setPages(i, turn);
            });
        });
        Measure::require(library.getPages(library.books.front()) == Library::pages(0, turn),
                         "the new pages");
        return taken;
    });
    measure.floor("set, Value", [&] {
        PlainLibrary const& library = libraries.plain();
        ++turn;
        return measure.timeEach([&] {
            for (std::size_t i = 0; i < measure.size(); ++i)
                library.books[i]->pages = Library::pages(i, turn);
        });
    });
}

void measureFinding(Measure const& measure, FullLibraries& libraries)
{
    measure.ours("find by UUID", [&] {
        Library const& library = libraries.ours();
        std::vector<UUID> ids;
        for (ModelElement const& book : library.books)
            ids.push_back(book.getImpl()->getUuid());
        std::size_t found = 0;
        double const taken = measure.timeEach([&] {
            for (std::size_t const i : measure.order())
                found += library.model->findElement(ids[i]) ? 1 : 0;
        });
        Measure::require(found == measure.size(), "all books");
        return taken;
    });
    measure.floor("find by UUID", [&] {
        PlainLibrary const& library = libraries.plain();
        std::size_t found = 0;
        double const taken = measure.timeEach([&] {
            for (std::size_t const i : measure.order())
                found += library.find(library.ids[i]) ? 1 : 0;
        });
        Measure::require(found == measure.size(), "all books");
        return taken;
    });
}
}  // namespace

void measureAccess(Measure const& measure, FullLibraries& libraries)
{
    measureReading<ByValue>(measure, libraries);
    measureReading<ByReader>(measure, libraries);
    measureSetting(measure, libraries);
    measureFinding(measure, libraries);
}
}  // namespace peers
