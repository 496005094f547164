// What elements cost with generated code, with generated code by reflection, and without code.
#include "benchmarks/meta/Parts.h"
#include "benchmarks/support/LiveBytes.h"
#include "tarnkiln/kernel/Transaction.h"

#include <benchmark/benchmark.h>

#include <memory>
#include <vector>

namespace benchkit {
namespace {

/// A struct that holds as much.
class PlainParts
{
public:
    struct Node
    {
        UUID id;
        ustring name;
        int width = 0, height = 0;
        double price = 0;
        bool hasPrice = false;
        Node* left = nullptr;
        Node* right = nullptr;
        Node* parent = nullptr;
        std::vector<Node*> children;
    };
    using Part = std::shared_ptr<Node>;

    Part make(Model const&) const { return std::make_shared<Node>(); }
    int width(Part const& part) const { return part->width; }
    void setWidth(Part const& part, int width) const { part->width = width; }
    Node* left(Part const& part) const { return part->left; }
    void setLeft(Part const& part, Part const& other) const { part->left = other.get(); }
    void addChild(Part const& part, Part const& child) const
    {
        part->children.push_back(child.get());
        child->parent = part.get();
    }
};

/// A model with elements of one kind.
template <class Parts> struct Stock
{
    explicit Stock(std::int64_t count)
    {
        all.reserve(static_cast<std::size_t>(count));
        for (std::int64_t i = 0; i < count; ++i)
            all.push_back(parts.make(model));
    }

    Parts const parts{};
    Model const model = Model::create(ModelConstellation());
    std::vector<typename Parts::Part> all;
};

void perElement(benchmark::State& state)
{
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

template <class Parts> void BM_Create(benchmark::State& state)
{
    double bytes = 0;
    for (auto _ : state)
    {
        std::size_t const before = liveBytes();
        auto stock = std::make_unique<Stock<Parts>>(state.range(0));
        state.PauseTiming();
        std::size_t const handles = stock->all.capacity() * sizeof(typename Parts::Part);
        bytes = static_cast<double>(liveBytes() - before - handles);
        stock->model->destroy();
        stock.reset();
        state.ResumeTiming();
    }
    state.counters["bytes_per_element"] = bytes / static_cast<double>(state.range(0));
    perElement(state);
}

template <class Parts> void BM_Destroy(benchmark::State& state)
{
    for (auto _ : state)
    {
        state.PauseTiming();
        auto stock = std::make_unique<Stock<Parts>>(state.range(0));
        state.ResumeTiming();
        stock->model->destroy();
        stock.reset();
    }
    perElement(state);
}

template <class Parts> void BM_ReadNumber(benchmark::State& state)
{
    Stock<Parts> const stock(state.range(0));
    for (auto _ : state)
    {
        for (auto const& part : stock.all)
            benchmark::DoNotOptimize(stock.parts.width(part));
    }
    perElement(state);
}

template <class Parts> void BM_ReadReference(benchmark::State& state)
{
    Stock<Parts> const stock(state.range(0));
    for (auto const& part : stock.all)
        stock.parts.setLeft(part, stock.all.front());
    for (auto _ : state)
    {
        for (auto const& part : stock.all)
            benchmark::DoNotOptimize(stock.parts.left(part));
    }
    perElement(state);
}

template <class Parts> void BM_SetNumber(benchmark::State& state)
{
    Stock<Parts> const stock(state.range(0));
    int number = 0;
    for (auto _ : state)
    {
        ++number;
        for (auto const& part : stock.all)
            stock.parts.setWidth(part, number);
        benchmark::ClobberMemory();
    }
    if (stock.parts.width(stock.all.back()) != number)
        state.SkipWithError("the number was not set");
    perElement(state);
}

/// Each number once in a transaction, begin and end included.
template <class Parts> void setInTransaction(benchmark::State& state, bool revertible, bool commits)
{
    Stock<Parts> const stock(state.range(0));
    int number = 0;
    for (auto _ : state)
    {
        ++number;
        Transaction const transaction = stock.model->beginTransaction(revertible);
        for (auto const& part : stock.all)
            stock.parts.setWidth(part, number);
        if (commits)
            transaction.commit();
        else
            transaction.rollBack();
    }
    if (stock.parts.width(stock.all.back()) != (commits ? number : 0))
        state.SkipWithError("the number is wrong");
    perElement(state);
}
template <class Parts> void BM_SetNumberShallow(benchmark::State& state)
{
    setInTransaction<Parts>(state, /*revertible=*/false, /*commits=*/true);
}
template <class Parts> void BM_SetNumberRecorded(benchmark::State& state)
{
    setInTransaction<Parts>(state, /*revertible=*/true, /*commits=*/true);
}
template <class Parts> void BM_SetNumberAndRollBack(benchmark::State& state)
{
    setInTransaction<Parts>(state, /*revertible=*/true, /*commits=*/false);
}

/// All others become children of the first one; only that is timed.
template <class Parts> void BM_AppendChild(benchmark::State& state)
{
    for (auto _ : state)
    {
        state.PauseTiming();
        auto stock = std::make_unique<Stock<Parts>>(state.range(0));
        state.ResumeTiming();
        for (std::size_t i = 1; i < stock->all.size(); ++i)
            stock->parts.addChild(stock->all.front(), stock->all[i]);
        state.PauseTiming();
        stock->model->destroy();
        stock.reset();
        state.ResumeTiming();
    }
    perElement(state);
}

void sizes(benchmark::internal::Benchmark* benchmark)
{
    benchmark->Arg(10'000)->Arg(100'000)->Arg(1'000'000)->Unit(benchmark::kMillisecond);
}

#define BESIDE_EACH_OTHER(operation)                                                               \
    BENCHMARK_TEMPLATE(operation, GeneratedParts)->Apply(sizes);                                   \
    BENCHMARK_TEMPLATE(operation, GeneratedByReflection)->Apply(sizes);                            \
    BENCHMARK_TEMPLATE(operation, RunTimeParts)->Apply(sizes)
#define BESIDE_A_STRUCT(operation)                                                                 \
    BESIDE_EACH_OTHER(operation);                                                                  \
    BENCHMARK_TEMPLATE(operation, PlainParts)->Apply(sizes)

BESIDE_A_STRUCT(BM_Create);
BESIDE_A_STRUCT(BM_Destroy);
BESIDE_A_STRUCT(BM_ReadNumber);
BESIDE_A_STRUCT(BM_ReadReference);
BESIDE_A_STRUCT(BM_SetNumber);
BESIDE_EACH_OTHER(BM_SetNumberShallow);
BESIDE_EACH_OTHER(BM_SetNumberRecorded);
BESIDE_EACH_OTHER(BM_SetNumberAndRollBack);
BESIDE_A_STRUCT(BM_AppendChild);
}  // namespace
}  // namespace benchkit
