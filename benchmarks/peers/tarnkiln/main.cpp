/// \file
/// Runs each workload on a library of the given size and prints a line for each: its name and the
/// nanoseconds, or bytes, a book. Usage: books_of_tarnkiln BOOKS [ROUNDS]
#include "benchmarks/peers/tarnkiln/Library.h"
#include "benchmarks/support/LiveBytes.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <memory>
#include <numeric>
#include <random>

namespace peers {
namespace {

using meta::StandardTypes;
using Round = std::function<double()>;

auto const& ACCESS = ModelElement::Impl::PUBLIC_ACCESS;
constexpr int WARM_UP = 2;

/// The nanoseconds that `body` takes.
template <class Body> double timeOf(Body const& body)
{
    auto const begin = std::chrono::steady_clock::now();
    body();
    std::chrono::duration<double, std::nano> const taken = std::chrono::steady_clock::now() - begin;
    return taken.count();
}

class Workloads
{
public:
    Workloads(std::size_t size, std::size_t rounds) : m_size(size), m_rounds(rounds), m_order(size)
    {
        std::iota(m_order.begin(), m_order.end(), std::size_t{0});
        std::shuffle(m_order.begin(), m_order.end(), std::mt19937(1));
    }

    void run()
    {
        measureCreation();
        auto const library = std::make_unique<Library>(m_size);
        library->fill();
        measureReading(*library);
        measureRecorded(*library);
        measureMoves(*library);
        measureDeletion();
        if (m_sink == 42)
            std::puts("");  // the sums are needed, says this line
    }

private:
    /// Prints the median of the rounds that follow the warm-up, for each of `operations`.
    void measure(char const* workload, std::size_t operations, Round const& round)
    {
        for (int i = 0; i < WARM_UP; ++i)
            round();
        std::vector<double> times;
        for (std::size_t i = 0; i < m_rounds; ++i)
            times.push_back(round());
        std::sort(times.begin(), times.end());
        std::printf("%s\t%.2f\n", workload, times[m_rounds / 2] / static_cast<double>(operations));
    }

    void measureCreation()
    {
        {
            Library library(m_size);
            std::size_t const before = benchkit::liveBytes();
            library.fill();
            std::printf("bytes a book\t%.1f\n",
                        static_cast<double>(benchkit::liveBytes() - before) /
                            static_cast<double>(m_size));
        }
        measure("create", m_size, [&] {
            Library library(m_size);
            return timeOf([&] { library.fill(); });
        });
    }

    void measureReading(Library& library)
    {
        meta::Property const& pages = library.classes.pages;
        measure("read in order", m_size, [&] {
            return timeOf([&] {
                for (ModelElement const& book : library.books)
                    m_sink += book->getPropertyValue(pages, ACCESS).getValue<int>();
            });
        });
        measure("read at random", m_size, [&] {
            return timeOf([&] {
                for (std::size_t const i : m_order)
                    m_sink += library.books[i]->getPropertyValue(pages, ACCESS).getValue<int>();
            });
        });
        measure("set unrecorded", m_size, [&] {
            Transaction const shallow = library.model->beginTransaction(/*revertible=*/false);
            double const taken = timeOf([&] { setPages(library); });
            shallow.commit();
            return taken;
        });
        measure("find by UUID", m_size, [&] {
            return timeOf([&] {
                for (std::size_t const i : m_order)
                    m_sink +=
                        library.model->findElement(library.books[i].getImpl()->getUuid()) ? 0 : 1;
            });
        });
    }

    static void setPage(Library const& library, ModelElement const& book)
    {
        meta::Property const& pages = library.classes.pages;
        int const present = book->getPropertyValue(pages, ACCESS).getValue<int>();
        book->setPropertyValue(pages, Value(StandardTypes::integerMeta, present % 1000 + 1),
                               ACCESS);
    }

    static void setPages(Library const& library)
    {
        for (ModelElement const& book : library.books)
            setPage(library, book);
    }

    void measureRecorded(Library& library)
    {
        measure("set recorded", m_size, [&] {
            return timeOf([&] {
                Transaction const deep = library.model->beginTransaction(/*revertible=*/true);
                setPages(library);
                deep.commit();
            });
        });
        measure("undo", m_size, [&] {
            Transaction const deep = library.model->beginTransaction(/*revertible=*/true);
            setPages(library);
            return timeOf([&] { deep.rollBack(); });
        });
        std::size_t next = 0;
        measure("one recorded set", 1, [&] {
            return timeOf([&] {
                Transaction const deep = library.model->beginTransaction(/*revertible=*/true);
                setPage(library, library.books[next++ % m_size]);
                deep.commit();
            });
        });
    }

    /// Up to a thousand recorded moves to the other library, from the front or the back.
    void measureMoves(Library& library)
    {
        measureMoves("move from the front", library,
                     [&](GenericSequenceInterface& books) { return books.genericAt(0); });
        measureMoves("move from the back", library, [&](GenericSequenceInterface& books) {
            return books.genericAt(books.genericSize() - 1);
        });
    }

    template <class Pick>
    void measureMoves(char const* workload, Library& library, Pick const& pick)
    {
        std::size_t const moves = std::min<std::size_t>(m_size, 1000);
        meta::Property const& home = library.classes.libraryOf;
        Value const target = Value::createElementValue(home, library.secondLibrary);
        auto& books = dynamic_cast<GenericSequenceInterface&>(
            *Library::collection(library.library, library.classes.books).getGenericInterface());
        measure(workload, moves, [&] {
            Transaction const deep = library.model->beginTransaction(/*revertible=*/true);
            double const taken = timeOf([&] {
                for (std::size_t i = 0; i < moves; ++i)
                    pick(books)->setPropertyValue(home, target, ACCESS);
            });
            deep.rollBack();
            return taken;
        });
    }

    void measureDeletion()
    {
        measure("delete half", m_size / 2, [&] {
            Library library(m_size);
            library.fill();
            return timeOf([&] {
                Transaction const deep = library.model->beginTransaction(/*revertible=*/true);
                for (std::size_t i = m_size; i > 1; i -= 2)
                    library.books[i - 1]->destroy();
                deep.commit();
            });
        });
    }

    std::size_t m_size;
    std::size_t m_rounds;
    std::vector<std::size_t> m_order;
    long m_sink = 0;
};
}  // namespace
}  // namespace peers

int main(int count, char** arguments)
{
    if (count < 2)
    {
        std::fputs("usage: books_of_tarnkiln BOOKS [ROUNDS]\n", stderr);
        return 2;
    }
    auto const number = [&](int i) { return std::strtoul(arguments[i], nullptr, 10); };
    peers::Workloads(number(1), count > 2 ? number(2) : 5).run();
}
