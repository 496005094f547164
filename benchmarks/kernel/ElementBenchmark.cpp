// Elements come and go, are found, and take values.
#include "benchmarks/support/LiveBytes.h"
#include "benchmarks/support/Nodes.h"

#include "tarnkiln/kernel/UUIDHasher.h"

#include <memory>
#include <unordered_map>

namespace benchkit {
namespace {

void perElement(benchmark::State& state)
{
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_Create_Element(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    double bytes = 0;
    for (auto _ : state)
    {
        std::size_t const before = liveBytes();
        Model const model = newModel();
        std::vector<Node> const nodes = makeNodes(model, count);
        state.PauseTiming();
        bytes = static_cast<double>(liveBytes() - before - nodes.capacity() * sizeof(Node));
        if (model->getElementCount() != count)
            state.SkipWithError("elements are missing");
        model->destroy();
        state.ResumeTiming();
    }
    state.counters["bytes_per_element"] = bytes / static_cast<double>(count);
    perElement(state);
}
BENCHMARK(BM_Create_Element)->Apply(sizes);

void BM_Create_PlainStruct(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    double bytes = 0;
    for (auto _ : state)
    {
        std::size_t const before = liveBytes();
        std::unordered_map<UUID, std::unique_ptr<PlainNode>, internal::UUIDHasher> nodes;
        for (std::size_t i = 0; i < count; ++i)
        {
            auto node = std::make_unique<PlainNode>();
            node->id = ElementImpl::generateNewUuid();
            nodes.emplace(node->id, std::move(node));
        }
        state.PauseTiming();
        bytes = static_cast<double>(liveBytes() - before);
        nodes.clear();
        state.ResumeTiming();
    }
    state.counters["bytes_per_element"] = bytes / static_cast<double>(count);
    perElement(state);
}
BENCHMARK(BM_Create_PlainStruct)->Apply(sizes);

void BM_Destroy_Model(benchmark::State& state)
{
    for (auto _ : state)
    {
        state.PauseTiming();
        Model model = newModel();
        makeNodes(model, static_cast<std::size_t>(state.range(0)));
        state.ResumeTiming();
        model->destroy();
        model = Model();
    }
    perElement(state);
}
BENCHMARK(BM_Destroy_Model)->Apply(sizes);

void BM_FindByUuid_Element(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, count);
    std::vector<UUID> wanted;
    for (std::size_t const i : shuffled(count))
        wanted.push_back(nodes[i]->getUuid());
    for (auto _ : state)
    {
        for (UUID const& id : wanted)
            benchmark::DoNotOptimize(model->findElementImpl(id));
    }
    perElement(state);
}
BENCHMARK(BM_FindByUuid_Element)->Apply(sizes);

void BM_FindByUuid_UnorderedMap(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    std::unordered_map<UUID, std::unique_ptr<PlainNode>, internal::UUIDHasher> nodes;
    std::vector<UUID> ids;
    for (std::size_t i = 0; i < count; ++i)
    {
        ids.push_back(ElementImpl::generateNewUuid());
        nodes.emplace(ids.back(), std::make_unique<PlainNode>());
    }
    std::vector<UUID> wanted;
    for (std::size_t const i : shuffled(count))
        wanted.push_back(ids[i]);
    for (auto _ : state)
    {
        for (UUID const& id : wanted)
            benchmark::DoNotOptimize(nodes.find(id)->second.get());
    }
    perElement(state);
}
BENCHMARK(BM_FindByUuid_UnorderedMap)->Apply(sizes);

void BM_Set_WithoutTransaction(benchmark::State& state)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    model->beginTransaction(/*revertible=*/false).commit();
    int value = 0;
    for (auto _ : state)
    {
        ++value;
        for (Node const& node : nodes)
            node->setCount(value);
    }
    perElement(state);
}
BENCHMARK(BM_Set_WithoutTransaction)->Apply(sizes);

void BM_Set_PlainStruct(benchmark::State& state)
{
    std::vector<std::unique_ptr<PlainNode>> nodes;
    for (std::int64_t i = 0; i < state.range(0); ++i)
        nodes.push_back(std::make_unique<PlainNode>());
    int value = 0;
    for (auto _ : state)
    {
        ++value;
        for (auto const& node : nodes)
            node->count = value;
        benchmark::ClobberMemory();
    }
    perElement(state);
}
BENCHMARK(BM_Set_PlainStruct)->Apply(sizes);

/// Each element is set in one transaction; begin and end are included.
void setInTransaction(benchmark::State& state, bool deep, int changes)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    int value = 0;
    for (auto _ : state)
    {
        Transaction const transaction = model->beginTransaction(deep);
        for (int change = 0; change < changes; ++change)
        {
            ++value;
            for (Node const& node : nodes)
                node->setCount(value);
        }
        if (transaction.commit() == TransactionResult::RolledBack)
            state.SkipWithError("the transaction was rolled back");
    }
    perElement(state);
}

void BM_Set_Shallow(benchmark::State& state)
{
    setInTransaction(state, /*deep=*/false, 1);
}
BENCHMARK(BM_Set_Shallow)->Apply(sizes);

void BM_Set_DeepFirstChange(benchmark::State& state)
{
    setInTransaction(state, /*deep=*/true, 1);
}
BENCHMARK(BM_Set_DeepFirstChange)->Apply(sizes);

void BM_Set_DeepFirstAndNineMore(benchmark::State& state)
{
    setInTransaction(state, /*deep=*/true, 10);
}
BENCHMARK(BM_Set_DeepFirstAndNineMore)->Apply(sizes);
}  // namespace
}  // namespace benchkit
