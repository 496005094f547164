// Elements enter, leave and change collections.
#include "benchmarks/support/Nodes.h"

namespace benchkit {
namespace {

void BM_Append_Children(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    for (auto _ : state)
    {
        state.PauseTiming();
        Model const model = newModel();
        std::vector<Node> const nodes = makeNodes(model, count);
        Node const parent = Node::create(model);
        state.ResumeTiming();
        for (Node const& node : nodes)
            node->setParent(parent);
        state.PauseTiming();
        if (parent->getChildren().size() != count)
            state.SkipWithError("children are missing");
        model->destroy();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_Append_Children)->Apply(sizes);

void BM_Append_PlainVector(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    std::vector<PlainNode> nodes(count);
    for (auto _ : state)
    {
        PlainNode parent;
        std::vector<PlainNode*> children;
        for (PlainNode& node : nodes)
        {
            node.parent = &parent;
            children.push_back(&node);
        }
        benchmark::DoNotOptimize(children.data());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_Append_PlainVector)->Apply(sizes);

void BM_Remove_ChildrenFromBack(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    for (auto _ : state)
    {
        state.PauseTiming();
        Model const model = newModel();
        std::vector<Node> const nodes = makeNodes(model, count);
        Node const parent = Node::create(model);
        for (Node const& node : nodes)
            node->setParent(parent);
        state.ResumeTiming();
        GenericSequenceInterface& children =
            static_cast<GenericSequenceInterface&>(*parent->getChildren().getGenericInterface());
        for (std::size_t left = count; left != 0; --left)
            children.genericRemoveAt(left - 1);
        state.PauseTiming();
        if (parent->getChildren().size() != 0)
            state.SkipWithError("children are left");
        model->destroy();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_Remove_ChildrenFromBack)->Apply(sizes);

/// The last of the children moves to another container and back, in a transaction of its own.
void BM_Move_LastChild(benchmark::State& state)
{
    Model const model = newModel();
    Node const from = Node::create(model);
    Node const to = Node::create(model);
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    for (Node const& node : nodes)
        node->setParent(from);
    bool there = false;
    for (auto _ : state)
    {
        there = !there;
        nodes.back()->setParent(there ? to : from);
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Move_LastChild)
    ->Arg(10'000)
    ->Arg(100'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kNanosecond);
}  // namespace
}  // namespace benchkit
