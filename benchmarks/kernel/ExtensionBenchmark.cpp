// Values of extensions beside those of an ordinary property, and contents that move between models.
#include "benchmarks/support/LiveBytes.h"
#include "benchmarks/support/Nodes.h"
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <unordered_map>

namespace benchkit {
namespace {

using meta::StandardTypes;

constexpr char16_t const* SHELF = u"shelf";

Value number(int payload)
{
    StandardTypes::ensureInitialized();
    return Value(StandardTypes::integerMeta, payload);
}

/// A model that adds a number to the class of nodes, by default 0.
Model extendedModel()
{
    Model const model = newModel();
    meta::ExtensionPrototype prototype;
    prototype.setName(SHELF);
    prototype.setTypeName(u"Integer");
    prototype.setUpper(1);
    model->extendMetaclass(Node::metaClass(), prototype, number(0));
    return model;
}

void perElement(benchmark::State& state)
{
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

/// One element after the other is given another number in each round; `write(node, number)`.
template <class Write> void setAll(benchmark::State& state, Write const& write)
{
    Model const model = extendedModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    int round = 0;
    for (auto _ : state)
    {
        ++round;
        for (Node const& node : nodes)
            write(node, round);
    }
    perElement(state);
}

void BM_Set_Property(benchmark::State& state)
{
    setAll(state, [](Node const& node, int round) { node->setCount(round); });
}
BENCHMARK(BM_Set_Property)->Apply(sizes);

void BM_Set_Extension(benchmark::State& state)
{
    ustring const name = SHELF;
    setAll(state, [&](Node const& node, int round) { node->setExtension(name, number(round)); });
}
BENCHMARK(BM_Set_Extension)->Apply(sizes);

/// All in one transaction, which is taken back; `write(node)`.
template <class Write> void setAndRollBack(benchmark::State& state, Write const& write)
{
    Model const model = extendedModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    for (auto _ : state)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        for (Node const& node : nodes)
            write(node);
        if (transaction.rollBack() != TransactionResult::RolledBack)
            state.SkipWithError("the transaction was not rolled back");
    }
    if (nodes.back()->getCount() != 0 || nodes.back()->hasNonDefaultExtension(SHELF))
        state.SkipWithError("the value is not what it was");
    perElement(state);
}

void BM_SetAndRollBack_Property(benchmark::State& state)
{
    setAndRollBack(state, [](Node const& node) { node->setCount(1); });
}
BENCHMARK(BM_SetAndRollBack_Property)->Apply(sizes);

void BM_SetAndRollBack_Extension(benchmark::State& state)
{
    ustring const name = SHELF;
    Value const one = number(1);
    setAndRollBack(state, [&](Node const& node) { node->setExtension(name, one); });
}
BENCHMARK(BM_SetAndRollBack_Extension)->Apply(sizes);

/// Sums up what `read(node)` gives for all elements, each of which has the count and the shelf 2.
template <class Read> void readAll(benchmark::State& state, Read const& read)
{
    Model const model = extendedModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    for (Node const& node : nodes)
    {
        node->setCount(2);
        node->setExtension(SHELF, number(2));
    }
    long sum = 0;
    for (auto _ : state)
    {
        sum = 0;
        for (Node const& node : nodes)
            sum += read(node);
        benchmark::DoNotOptimize(sum);
    }
    if (sum != 2 * state.range(0))
        state.SkipWithError("the values are not those that were set");
    perElement(state);
}

void BM_Read_Property(benchmark::State& state)
{
    readAll(state, [](Node const& node) { return node->getCount(); });
}
BENCHMARK(BM_Read_Property)->Apply(sizes);

void BM_Read_PropertyByReflection(benchmark::State& state)
{
    meta::Property const& count = Node::Impl::COUNT.property();
    readAll(state, [&](Node const& node) {
        return node->getPropertyValue(count, ModelElement::Impl::PUBLIC_ACCESS).getValue<int>();
    });
}
BENCHMARK(BM_Read_PropertyByReflection)->Apply(sizes);

void BM_Read_Extension(benchmark::State& state)
{
    ustring const name = SHELF;
    readAll(state, [&](Node const& node) { return node->getExtension(name).getValue<int>(); });
}
BENCHMARK(BM_Read_Extension)->Apply(sizes);

/// What a client would do that may not touch the class: a table beside the elements.
void BM_Read_TableBesideElements(benchmark::State& state)
{
    std::unordered_map<ModelElement, int> table;
    bool isFilled = false;
    readAll(state, [&](Node const& node) {
        if (!isFilled)
        {
            for (ModelElement const& element : node->getModel()->getTopLevelElements())
                table[element] = 2;
            isFilled = true;
        }
        return table.find(node)->second;
    });
}
BENCHMARK(BM_Read_TableBesideElements)->Apply(sizes);

void BM_Read_ExtensionDefault(benchmark::State& state)
{
    Model const model = extendedModel();
    std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
    ustring const name = SHELF;
    for (auto _ : state)
    {
        for (Node const& node : nodes)
            benchmark::DoNotOptimize(node->getExtension(name));
    }
    perElement(state);
}
BENCHMARK(BM_Read_ExtensionDefault)->Apply(sizes);

/// The first value of each element, and what it takes.
void BM_SetFirst_Extension(benchmark::State& state)
{
    ustring const name = SHELF;
    Value const one = number(1);
    double bytes = 0;
    for (auto _ : state)
    {
        state.PauseTiming();
        Model const model = extendedModel();
        std::vector<Node> const nodes = makeNodes(model, static_cast<std::size_t>(state.range(0)));
        std::size_t const before = liveBytes();
        state.ResumeTiming();
        for (Node const& node : nodes)
            node->setExtension(name, one);
        state.PauseTiming();
        bytes = static_cast<double>(liveBytes() - before);
        model->destroy();
        state.ResumeTiming();
    }
    state.counters["bytes_per_value"] = bytes / static_cast<double>(state.range(0));
    perElement(state);
}
BENCHMARK(BM_SetFirst_Extension)->Apply(sizes);

/// From one model to the other and back; `prepare(node)` for each element before that.
template <class Prepare> void moveContents(benchmark::State& state, Prepare const& prepare)
{
    Model const source = extendedModel();
    Model const target = newModel();
    std::vector<Node> const nodes = makeNodes(source, static_cast<std::size_t>(state.range(0)));
    for (Node const& node : nodes)
        prepare(node);
    bool isThere = false;
    for (auto _ : state)
    {
        (isThere ? target : source)->moveAllContentsTo(isThere ? source : target);
        isThere = !isThere;
    }
    if (static_cast<std::int64_t>((isThere ? target : source)->getElementCount()) != state.range(0))
        state.SkipWithError("elements are missing");
    perElement(state);
}

void BM_MoveContents_Plain(benchmark::State& state)
{
    moveContents(state, [](Node const&) {});
}
BENCHMARK(BM_MoveContents_Plain)->Apply(sizes);

void BM_MoveContents_WithExtensions(benchmark::State& state)
{
    moveContents(state, [](Node const& node) { node->setExtension(SHELF, number(1)); });
}
BENCHMARK(BM_MoveContents_WithExtensions)->Apply(sizes);
}  // namespace
}  // namespace benchkit
