#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "benchmarks/support/LiveBytes.h"
#include "tarnkiln/kernel/Transaction.h"

namespace peers {
namespace {

struct OldPages
{
    PlainBook* book;
    int pages;
};

void setAll(Library const& library, int turn)
{
    for (std::size_t i = 0; i < library.books.size(); ++i)
        library.setPages(i, turn);
}

std::vector<OldPages> setAll(PlainLibrary const& library, int turn)
{
    std::vector<OldPages> record;
    for (std::size_t i = 0; i < library.books.size(); ++i)
    {
        PlainBook& book = *library.books[i];
        record.push_back({&book, book.pages});
        book.pages = Library::pages(i, turn);
    }
    return record;
}

void measureBytes(Measure const& measure, FullLibraries& libraries)
{
    char const* const workload = "bytes a recorded change";
    auto const since = [&](std::size_t before) {
        return static_cast<double>(benchkit::liveBytes() - before) /
               static_cast<double>(measure.size());
    };
    measure.oursOnce(workload, [&] {
        Library const& library = libraries.ours();
        std::size_t const before = benchkit::liveBytes();
        Transaction const transaction = library.model->beginTransaction(/*revertible=*/true);
        setAll(library, /*turn=*/1);
        return since(before);  // taken back
    });
    measure.floorOnce(workload, [&] {
        PlainLibrary const& library = libraries.plain();
        std::size_t const before = benchkit::liveBytes();
        std::vector<OldPages> const record = setAll(library, /*turn=*/1);
        return since(before);
    });
}

void measureSets(Measure const& measure, FullLibraries& libraries)
{
    int turn = 0;
    measure.ours("set recorded", [&] {
        Library const& library = libraries.ours();
        ++turn;
        return measure.timeEach(
            [&] { library.change(/*revertible=*/true, [&] { setAll(library, turn); }); });
    });
    measure.ours("undo sets", [&] {
        Library const& library = libraries.ours();
        ++turn;
        int const before = library.getPages(library.books.back());
        Transaction const transaction = library.model->beginTransaction(/*revertible=*/true);
        setAll(library, turn);
        double const taken = measure.timeEach([&] { transaction.rollBack(); });
        Measure::require(library.getPages(library.books.back()) == before, "the old pages");
        return taken;
    });
    measure.floor({"set recorded", "undo sets"}, [&] {
        PlainLibrary const& library = libraries.plain();
        ++turn;
        std::vector<OldPages> record;
        double const set = measure.timeEach([&] { record = setAll(library, turn); });
        double const undone = measure.timeEach([&] {
            for (auto old = record.rbegin(); old != record.rend(); ++old)
                old->book->pages = old->pages;
        });
        return std::vector<double>{set, undone};
    });
}

void measureSingleSets(Measure const& measure, FullLibraries& libraries)
{
    constexpr int SETS = 1000;
    int turn = 0;
    measure.ours("one recorded set", [&] {
        Library const& library = libraries.ours();
        return Measure::time([&] {
                   for (int i = 0; i < SETS; ++i)
                   {
                       std::size_t const book = measure.order()[static_cast<std::size_t>(i)];
                       library.change(/*revertible=*/true, [&] { library.setPages(book, ++turn); });
                   }
               }) /
               SETS;
    });
}
}  // namespace

void measureRecording(Measure const& measure, FullLibraries& libraries)
{
    measureBytes(measure, libraries);
    measureSets(measure, libraries);
    measureSingleSets(measure, libraries);
}
}  // namespace peers
