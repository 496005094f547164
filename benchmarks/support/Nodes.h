/// \file
/// Models with many elements, and the plain structs that are measured beside them.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/NodeImpl.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstddef>
#include <random>
#include <vector>

namespace benchkit {

using namespace tarn::kiln;
using testkit::Node;

/// What plain C++ keeps for the few properties that the measurements use.
struct PlainNode
{
    UUID id;
    int count = 0;
    PlainNode* parent = nullptr;
};

inline Model newModel()
{
    return Model::create(ModelConstellation());
}

/// `count` top-level nodes, made outside any transaction.
inline std::vector<Node> makeNodes(Model const& model, std::size_t count)
{
    std::vector<Node> nodes;
    nodes.reserve(count);
    for (std::size_t i = 0; i < count; ++i)
        nodes.push_back(Node::create(model));
    return nodes;
}

/// The numbers from 0 in a shuffled order that is the same in each run.
inline std::vector<std::size_t> shuffled(std::size_t count)
{
    std::vector<std::size_t> order(count);
    for (std::size_t i = 0; i < count; ++i)
        order[i] = i;
    std::shuffle(order.begin(), order.end(), std::mt19937(42));
    return order;
}

/// The sizes that all benchmarks run at.
template <class Benchmark> void sizes(Benchmark* benchmark)
{
    benchmark->Arg(10'000)->Arg(100'000)->Arg(1'000'000)->Unit(benchmark::kMillisecond);
}
}  // namespace benchkit
