#include "benchmarks/peers/tarnkiln/Workloads.h"
#include "benchmarks/support/LiveBytes.h"

#include <cstdio>
#include <memory>

namespace peers {
namespace {

/// The bytes that `fill` leaves behind, without the table of handles or pointers to books.
template <class Made> double bytesABook(Made& library)
{
    std::size_t const before = benchkit::liveBytes();
    library.fill();
    return static_cast<double>(benchkit::liveBytes() - before) /
           static_cast<double>(library.books.size());
}

void measureBytes(Measure const& measure)
{
    measure.oursOnce("bytes a book", [&] {
        Library library(measure.size());
        return bytesABook(library);
    });
    measure.floorOnce("bytes a book", [&] {
        PlainLibrary library(Library::titles(measure.size()));
        return bytesABook(library);
    });
}

/// The times of making a library, with `create`, and of destroying it.
template <class Made, class Create, class Destroy>
std::vector<double> timeLife(Measure const& measure, Create const& create, Destroy const& destroy)
{
    std::unique_ptr<Made> library = create();
    double const made = measure.timeEach([&] { library->fill(); });
    Measure::require(library->books.size() == measure.size(), "all books");
    library->books.clear();  // else the handles would keep what is destroyed
    return {made, measure.timeEach([&] { destroy(*library); })};
}
}  // namespace

void measureCreation(Measure const& measure)
{
    measureBytes(measure);
    std::vector<char const*> const workloads = {"create", "destroy the model"};
    measure.ours(workloads, [&] {
        return timeLife<Library>(
            measure, [&] { return std::make_unique<Library>(measure.size()); },
            [](Library& library) { library.model->destroy(); });
    });
    measure.floor(workloads, [&] {
        return timeLife<PlainLibrary>(
            measure,
            [&] { return std::make_unique<PlainLibrary>(Library::titles(measure.size())); },
            [](PlainLibrary& library) { library.clear(); });
    });
}
}  // namespace peers
