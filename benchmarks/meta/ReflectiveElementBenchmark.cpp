// Elements of a class without code, with three numbers, a text and two references.
#include "benchmarks/support/LiveBytes.h"
#include "tests/support/RuntimeMetamodel.h"

#include <benchmark/benchmark.h>

#include <array>
#include <memory>
#include <unordered_map>

namespace benchkit {
namespace {

using namespace testkit;

/// The class and its properties.
struct Described
{
    RuntimeMetamodel metamodel;
    meta::Class const part = metamodel.makeClass(u"Part");
    meta::Property const name =
        metamodel.property(part, u"name", StandardTypes::stringMeta).required();
    meta::Property const width =
        metamodel.property(part, u"width", StandardTypes::integerMeta).required();
    meta::Property const height =
        metamodel.property(part, u"height", StandardTypes::integerMeta).required();
    meta::Property const price = metamodel.property(part, u"price", StandardTypes::realMeta);
    meta::Property const left = metamodel.property(part, u"left", part);
    meta::Property const right = metamodel.property(part, u"right", part);
};

using Parts = std::vector<ModelElement>;

Parts makeParts(Model const& model, Described const& described, std::int64_t count)
{
    Parts parts;
    parts.reserve(static_cast<std::size_t>(count));
    for (std::int64_t i = 0; i < count; ++i)
        parts.push_back(ModelElement::createReflective(model, described.part));
    return parts;
}

/// A model full of parts.
struct Populated
{
    explicit Populated(benchmark::State const& state)
        : parts(makeParts(model, described, state.range(0)))
    {}

    void readEach(meta::Property const& property) const
    {
        for (ModelElement const& part : parts)
            benchmark::DoNotOptimize(
                part->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS));
    }
    void setEach(meta::Property const& property, Value const& value) const
    {
        for (ModelElement const& part : parts)
            part->setPropertyValue(property, value, ModelElement::Impl::PUBLIC_ACCESS);
    }

    Described const described;
    Model const model = Model::create(ModelConstellation());
    Parts const parts;
};

void perElement(benchmark::State& state)
{
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void sizes(benchmark::internal::Benchmark* benchmark)
{
    benchmark->Arg(10'000)->Arg(100'000)->Unit(benchmark::kMillisecond);
}

void BM_Create_Reflective(benchmark::State& state)
{
    Described const described;
    double bytes = 0;
    for (auto _ : state)
    {
        std::size_t const before = liveBytes();
        Model const model = Model::create(ModelConstellation());
        Parts const parts = makeParts(model, described, state.range(0));
        state.PauseTiming();
        bytes = static_cast<double>(liveBytes() - before - parts.capacity() * sizeof(ModelElement));
        if (static_cast<std::int64_t>(model->getElementCount()) != state.range(0))
            state.SkipWithError("elements are missing");
        model->destroy();
        state.ResumeTiming();
    }
    state.counters["bytes_per_element"] = bytes / static_cast<double>(state.range(0));
    perElement(state);
}
BENCHMARK(BM_Create_Reflective)->Apply(sizes);

/// The literal form: a table from property to value in each element.
void BM_Create_TablePerElement(benchmark::State& state)
{
    Described const described;
    std::array const properties = {described.name, described.width, described.height,
                                   described.price};
    using Table = std::unordered_map<meta::Property, Value, std::hash<ModelElement>>;
    double bytes = 0;
    for (auto _ : state)
    {
        std::size_t const before = liveBytes();
        std::vector<std::unique_ptr<Table>> tables;
        for (std::int64_t i = 0; i < state.range(0); ++i)
        {
            tables.push_back(std::make_unique<Table>());
            for (meta::Property const& property : properties)
                tables.back()->emplace(property, Value::createEmptyValue(property));
        }
        state.PauseTiming();
        bytes = static_cast<double>(liveBytes() - before);
        tables.clear();
        state.ResumeTiming();
    }
    state.counters["bytes_per_element"] = bytes / static_cast<double>(state.range(0));
    perElement(state);
}
BENCHMARK(BM_Create_TablePerElement)->Apply(sizes);

void BM_Read_Number(benchmark::State& state)
{
    Populated const populated(state);
    for (auto _ : state)
        populated.readEach(populated.described.width);
    perElement(state);
}
BENCHMARK(BM_Read_Number)->Apply(sizes);

void BM_Read_Reference(benchmark::State& state)
{
    Populated const populated(state);
    meta::Property const& left = populated.described.left;
    populated.setEach(left, Value::createElementValue(left, populated.parts.front()));
    for (auto _ : state)
        populated.readEach(left);
    perElement(state);
}
BENCHMARK(BM_Read_Reference)->Apply(sizes);

void BM_Set_Number(benchmark::State& state)
{
    Populated const populated(state);
    int number = 0;
    for (auto _ : state)
        populated.setEach(populated.described.width, Value(StandardTypes::integerMeta, ++number));
    perElement(state);
}
BENCHMARK(BM_Set_Number)->Apply(sizes);

void BM_Set_NumberAndRollBack(benchmark::State& state)
{
    Populated const populated(state);
    Value const value(StandardTypes::integerMeta, 1);
    for (auto _ : state)
    {
        Transaction const transaction = populated.model->beginTransaction(/*revertible=*/true);
        populated.setEach(populated.described.width, value);
        if (transaction.rollBack() != TransactionResult::RolledBack)
            state.SkipWithError("the transaction was not rolled back");
    }
    if (get<int>(populated.parts.front(), populated.described.width) != 0)
        state.SkipWithError("the number is not what it was");
    perElement(state);
}
BENCHMARK(BM_Set_NumberAndRollBack)->Apply(sizes);
}  // namespace
}  // namespace benchkit
