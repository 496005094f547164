#include "benchmarks/peers/tarnkiln/Workloads.h"

namespace peers {
namespace {

void measureReading(Measure const& measure, FullLibraries& libraries)
{
    measure.ours("read in order, Value", [&] {
        Library const& library = libraries.ours();
        long sum = 0;
        return measure.timeEach([&] {
            for (ModelElement const& book : library.books)
                sum += book->getPropertyValue(library.classes.pages, ACCESS).getValue<int>();
            Measure::keep(sum);
        });
    });
    measure.ours("read at random, Value", [&] {
        Library const& library = libraries.ours();
        long sum = 0;
        return measure.timeEach([&] {
            for (std::size_t const i : measure.order())
                sum += library.books[i]
                           ->getPropertyValue(library.classes.pages, ACCESS)
                           .getValue<int>();
            Measure::keep(sum);
        });
    });
}

void measurePlainReading(Measure const& measure, FullLibraries& libraries)
{
    auto const inOrder = [&] {
        std::vector<WithPages*> const books = libraries.plain().booksWithPages();
        long sum = 0;
        return measure.timeEach([&] {
            for (WithPages const* book : books)
                sum += book->getPages();
            Measure::keep(sum);
        });
    };
    auto const atRandom = [&] {
        std::vector<WithPages*> const books = libraries.plain().booksWithPages();
        long sum = 0;
        return measure.timeEach([&] {
            for (std::size_t const i : measure.order())
                sum += books[i]->getPages();
            Measure::keep(sum);
        });
    };
    measure.floor("read in order, Value", inOrder);
    measure.floor("read at random, Value", atRandom);
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
    measureReading(measure, libraries);
    measurePlainReading(measure, libraries);
    measureSetting(measure, libraries);
    measureFinding(measure, libraries);
}
}  // namespace peers
