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

/// Two parents, the first one with children.
struct Family
{
    explicit Family(std::size_t count) : children(makeNodes(model, count))
    {
        for (Node const& child : children)
            child->setParent(first);
    }
    ~Family() { model->destroy(); }

    Model const model = newModel();
    Node const first = Node::create(model);
    Node const second = Node::create(model);
    std::vector<Node> const children;
};

/// All children move to the other parent in one recorded transaction, in `order`.
void moveAll(benchmark::State& state, std::vector<std::size_t> const& order)
{
    for (auto _ : state)
    {
        state.PauseTiming();
        {
            Family const family(order.size());
            state.ResumeTiming();
            {
                Transaction const deep = family.model->beginTransaction(/*revertible=*/true);
                for (std::size_t const i : order)
                    family.children[i]->setParent(family.second);
                deep.commit();
            }
            state.PauseTiming();
            if (family.second->getChildren().size() != order.size())
                state.SkipWithError("children have stayed");
        }
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

std::vector<std::size_t> inOrder(benchmark::State const& state)
{
    std::vector<std::size_t> order = shuffled(static_cast<std::size_t>(state.range(0)));
    std::sort(order.begin(), order.end());
    return order;
}

void BM_MoveRecorded_FromFront(benchmark::State& state)
{
    moveAll(state, inOrder(state));
}
BENCHMARK(BM_MoveRecorded_FromFront)->Apply(sizes);

void BM_MoveRecorded_FromBack(benchmark::State& state)
{
    std::vector<std::size_t> order = inOrder(state);
    std::reverse(order.begin(), order.end());
    moveAll(state, order);
}
BENCHMARK(BM_MoveRecorded_FromBack)->Apply(sizes);

void BM_MoveRecorded_AtRandom(benchmark::State& state)
{
    moveAll(state, shuffled(static_cast<std::size_t>(state.range(0))));
}
BENCHMARK(BM_MoveRecorded_AtRandom)->Apply(sizes);

void BM_MoveUndone(benchmark::State& state)
{
    Family const family(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state)
    {
        state.PauseTiming();
        Transaction const deep = family.model->beginTransaction(/*revertible=*/true);
        for (Node const& child : family.children)
            child->setParent(family.second);
        state.ResumeTiming();
        deep.rollBack();
    }
    if (family.first->getChildren().size() != family.children.size())
        state.SkipWithError("children are missing");
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_MoveUndone)->Apply(sizes);

/// One child in the middle moves to the other parent, recorded, and back with the transaction.
void BM_MoveRecorded_OneChild(benchmark::State& state)
{
    Family const family(static_cast<std::size_t>(state.range(0)));
    std::size_t next = 0;
    for (auto _ : state)
    {
        Transaction const deep = family.model->beginTransaction(/*revertible=*/true);
        family.children[next]->setParent(family.second);
        deep.rollBack();
        next = (next + 7919) % family.children.size();
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_MoveRecorded_OneChild)
    ->Arg(10'000)
    ->Arg(100'000)
    ->Arg(1'000'000)
    ->Unit(benchmark::kNanosecond);

/// Every second child is destroyed in one recorded transaction.
void BM_Destroy_EverySecondChild(benchmark::State& state)
{
    auto const count = static_cast<std::size_t>(state.range(0));
    for (auto _ : state)
    {
        state.PauseTiming();
        {
            Family const family(count);
            state.ResumeTiming();
            {
                Transaction const deep = family.model->beginTransaction(/*revertible=*/true);
                for (std::size_t i = 0; i < count; i += 2)
                    family.children[i]->destroy();
                deep.commit();
            }
            state.PauseTiming();
            if (family.first->getChildren().size() != count / 2)
                state.SkipWithError("children are left");
        }
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0) / 2);
}
BENCHMARK(BM_Destroy_EverySecondChild)->Apply(sizes);

void BM_Walk_Children(benchmark::State& state)
{
    Family const family(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state)
    {
        for (Node const& child : family.first->getChildren())
            benchmark::DoNotOptimize(child.getImpl());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_Walk_Children)->Apply(sizes);
}  // namespace
}  // namespace benchkit
