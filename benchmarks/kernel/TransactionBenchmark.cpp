// What the ends of transactions cost, and what it costs to resolve a proxy.
#include "benchmarks/support/LiveBytes.h"
#include "benchmarks/support/Nodes.h"

#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ProxyId.h"

namespace benchkit {
namespace {

class CountingListener : public Listener
{
public:
    using ElementType = Node;

    void transactionCommitted(ShallowChangeReport<Node>& report)
    {
        seen += report.getChanged().size();
    }
    void transactionCommitted(ReportData& report) { seen += report.getChanged().size(); }

    std::size_t seen = 0;
};

void changeAll(std::vector<Node> const& nodes, int value)
{
    for (Node const& node : nodes)
        node->setCount(value);
}

/// Commits of transactions that changed every element; only the commit is timed.
void commitAll(benchmark::State& state, bool deep, CountingListener* listener)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    if (listener && deep)
        model->addListener(listener);
    else if (listener)
        model->addShallowListener(listener);
    int value = 0;
    for (auto _ : state)
    {
        state.PauseTiming();
        Transaction transaction = model->beginTransaction(deep);
        changeAll(nodes, ++value);
        state.ResumeTiming();
        transaction.commit();
        transaction = Transaction();
    }
    if (listener && listener->seen != nodes.size() * static_cast<std::size_t>(value))
        state.SkipWithError("the listener was not told of every change");
    if (listener)
        model->removeListener(listener);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_Commit_DeepWithoutListener(benchmark::State& state)
{
    commitAll(state, /*deep=*/true, nullptr);
}
BENCHMARK(BM_Commit_DeepWithoutListener)->Apply(sizes);

void BM_Commit_ShallowListener(benchmark::State& state)
{
    CountingListener listener;
    commitAll(state, /*deep=*/false, &listener);
}
BENCHMARK(BM_Commit_ShallowListener)->Apply(sizes);

void BM_Commit_DeepListener(benchmark::State& state)
{
    CountingListener listener;
    commitAll(state, /*deep=*/true, &listener);
}
BENCHMARK(BM_Commit_DeepListener)->Apply(sizes);

void BM_RollBack_Changes(benchmark::State& state)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    double bytes = 0;
    for (auto _ : state)
    {
        state.PauseTiming();
        std::size_t const before = liveBytes();
        Transaction transaction = model->beginTransaction(/*revertible=*/true);
        changeAll(nodes, 7);
        bytes = static_cast<double>(liveBytes() - before);
        state.ResumeTiming();
        transaction.rollBack();
        transaction = Transaction();
    }
    if (nodes.front()->getCount() != 0)
        state.SkipWithError("the old value is not back");
    state.counters["bytes_per_change"] = bytes / static_cast<double>(state.range(0));
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_RollBack_Changes)->Apply(sizes);

void BM_RollBack_Destruction(benchmark::State& state)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    for (auto _ : state)
    {
        state.PauseTiming();
        Transaction transaction = model->beginTransaction(/*revertible=*/true);
        model->destroyAllContents();
        state.ResumeTiming();
        transaction.rollBack();
        transaction = Transaction();
    }
    if (model->getElementCount() != nodes.size())
        state.SkipWithError("elements are not back");
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_RollBack_Destruction)->Apply(sizes);

/// One change in a transaction of its own, in a model of that size.
void BM_OneChange_Deep(benchmark::State& state)
{
    Model const model = newModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    int value = 0;
    for (auto _ : state)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        nodes.front()->setCount(++value);
        transaction.commit();
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_OneChange_Deep)
    ->Arg(10'000)
    ->Arg(100'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kNanosecond);

void BM_ResolveProxy_OtherModel(benchmark::State& state)
{
    ModelConstellation const constellation = ModelConstellation::create();
    Model const here = Model::create(constellation);
    Model const there = Model::create(constellation);
    auto const count = static_cast<std::size_t>(state.range(0));
    std::vector<Node> targets;
    std::vector<Node> sources;
    {
        Transaction const transaction = here->beginTransaction(/*revertible=*/false);
        targets = makeNodes(there, count);
        sources = makeNodes(here, count);
        transaction.commit();
    }
    std::vector<std::size_t> const order = shuffled(count);
    for (auto _ : state)
    {
        state.PauseTiming();
        Transaction const transaction = here->beginTransaction(/*revertible=*/false);
        for (std::size_t i = 0; i < count; ++i)
            sources[i]->setBuddy(Node::createProxy(
                here, targets[order[i]]->getPersistentProxyId(/*omitModel=*/false)));
        transaction.commit();
        state.ResumeTiming();
        for (Node const& source : sources)
            benchmark::DoNotOptimize(source->getBuddy());
    }
    if (sources.front()->getBuddyImpl()->isProxy())
        state.SkipWithError("the proxy was not resolved");
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_ResolveProxy_OtherModel)->Apply(sizes);
}  // namespace
}  // namespace benchkit
