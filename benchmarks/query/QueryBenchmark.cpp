// What queries cost, beside the plain engine and beside loops that a person would write.
#include "benchmarks/query/Workloads.h"
#include "tests/support/PlainEngine.h"

#include <benchmark/benchmark.h>

namespace benchkit {
namespace {

using Engine = NativeTarnkilnQuery::Engine;

/// Of the books of the model, whether they match or not.
void perBook(benchmark::State& state, std::size_t rows)
{
    state.counters["rows"] = static_cast<double>(rows);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

template <class Workload> void runQuery(benchmark::State& state, Engine engine)
{
    Shelves const& shelves = Shelves::get(state.range(0));
    NativeTarnkilnQuery query(shelves.model);
    query.useEngine(engine);
    Workload::ask(query, state.range(1));
    std::size_t rows = 0;
    for (auto _ : state)
    {
        rows = Workload::run(query);
        benchmark::DoNotOptimize(rows);
    }
    if (rows != Workload::loop(shelves, state.range(1)))
        state.SkipWithError("the query and the loop find different rows");
    perBook(state, rows);
}

template <class Workload> void BM_Query(benchmark::State& state)
{
    runQuery<Workload>(state, nullptr);
}

template <class Workload> void BM_PlainQuery(benchmark::State& state)
{
    runQuery<Workload>(state, &testkit::runPlainly);
}

template <class Workload> void BM_QueryLoop(benchmark::State& state)
{
    Shelves const& shelves = Shelves::get(state.range(0));
    std::size_t rows = 0;
    for (auto _ : state)
    {
        rows = Workload::loop(shelves, state.range(1));
        benchmark::DoNotOptimize(rows);
    }
    perBook(state, rows);
}

/// The loop of somebody who has the model only, as a query has.
void BM_ModelLoop(benchmark::State& state)
{
    Shelves const& shelves = Shelves::get(state.range(0));
    int const bound = Shelves::boundFor(state.range(1));
    std::size_t rows = 0;
    for (auto _ : state)
    {
        std::vector<Book> found;
        for (ModelElement const& element : shelves.model->getAllElements())
        {
            if (Book const book = Book::cast(element); book && book->getPages() > bound)
                found.push_back(book);
        }
        rows = found.size();
        benchmark::DoNotOptimize(found.data());
    }
    perBook(state, rows);
}

template <std::int64_t MOST> void sizes(benchmark::internal::Benchmark* benchmark)
{
    for (std::int64_t size = 10'000; size <= MOST; size *= 10)
        benchmark->Args({size, 1})->Args({size, 50});
    benchmark->Unit(benchmark::kMillisecond);
}

/// The plain engine tries all combinations, which ends in time for the smallest size only.
void once(benchmark::internal::Benchmark* benchmark)
{
    sizes<10'000>(benchmark);
    benchmark->Iterations(1);
}

#define BESIDE_A_LOOP(Workload)                                                                    \
    BENCHMARK_TEMPLATE(BM_Query, Workload)->Apply(sizes<1'000'000>);                               \
    BENCHMARK_TEMPLATE(BM_QueryLoop, Workload)->Apply(sizes<1'000'000>)
#define ON_ONE_CLASS(Workload)                                                                     \
    BESIDE_A_LOOP(Workload);                                                                       \
    BENCHMARK_TEMPLATE(BM_PlainQuery, Workload)->Apply(sizes<100'000>)
#define ON_SEVERAL_CLASSES(Workload)                                                               \
    BESIDE_A_LOOP(Workload);                                                                       \
    BENCHMARK_TEMPLATE(BM_PlainQuery, Workload)->Apply(once)

ON_ONE_CLASS(ManyPages);
BENCHMARK(BM_ModelLoop)->Apply(sizes<1'000'000>);
ON_ONE_CLASS(Like);
ON_ONE_CLASS(Regexp);
ON_SEVERAL_CLASSES(JoinByReference);
ON_SEVERAL_CLASSES(JoinByText);
ON_SEVERAL_CLASSES(JoinOfThree);
ON_ONE_CLASS(FirstResult);
ON_ONE_CLASS(CountWithLimit);
}  // namespace
}  // namespace benchkit
