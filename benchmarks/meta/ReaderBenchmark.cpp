// Metamodels read by one thread and by two at once, which ask for the same class or each for one of
// its own. Two threads that do not disturb each other do twice the work of one in the same time, as
// far as the machine can: what it can is shown by threads that share nothing. Where others take the
// machine's time, the least of many repetitions says more than their median.
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <benchmark/benchmark.h>

#include <array>
#include <string>
#include <unordered_map>

namespace benchkit {
namespace {

using namespace tarn::kiln;
using meta::ClassDefinition;
using meta::MetaRegistry;
using meta::StandardTypes;

constexpr std::size_t THREADS = 2;

/// A class below four others, the topmost of which has the property that is asked for.
struct Described
{
    ustring uri;
    ustring name;
    meta::Class top;
    meta::Class bottom;
    meta::Property title;
};

Described describe(char16_t number)
{
    Described result;
    result.uri = ustring(u"http://example.org/readers/") + number;
    ustring const package = ustring(u"readers") + number;
    meta::PackageDefinition definition(package, result.uri);
    ClassDefinition last = definition.defineClass(u"Class0");
    last.attribute(u"title", StandardTypes::stringMeta).defaultValue(u"untitled");
    result.top = last;
    for (char16_t level = u'1'; level <= u'4'; ++level)
    {
        ClassDefinition next = definition.defineClass(ustring(u"Class") + level);
        next.extends(last);
        last = next;
    }
    result.bottom = last;
    definition.finish();
    result.title = result.top->getPropertyByName(u"title");
    result.name = package + u".Class4";
    return result;
}

/// The one that a thread asks for.
Described const& mine(benchmark::State const& state, bool own)
{
    static std::array<Described, THREADS> const all = {describe(u'1'), describe(u'2')};
    return all[own ? static_cast<std::size_t>(state.thread_index()) : 0];
}

template <class Ask> void run(benchmark::State& state, bool own, Ask const& ask)
{
    Described const& described = mine(state, own);
    for (auto _ : state)
        benchmark::DoNotOptimize(ask(described));
    state.SetItemsProcessed(state.iterations());
}

void BM_Read_IsA(benchmark::State& state, bool own)
{
    run(state, own, [](Described const& asked) { return asked.bottom->isA(asked.top); });
}

void BM_Read_PropertyByName(benchmark::State& state, bool own)
{
    ustring const title = u"title";
    run(state, own, [&](Described const& asked) { return asked.bottom->getPropertyByName(title); });
}

void BM_Read_Default(benchmark::State& state, bool own)
{
    run(state, own, [](Described const& asked) { return asked.title->defaultValue(); });
}

void BM_Read_ClassByName(benchmark::State& state, bool own)
{
    MetaRegistry const& registry = MetaRegistry::getInstance();
    run(state, own, [&](Described const& asked) { return registry.getClass(asked.name); });
}

void BM_Read_PackageByUri(benchmark::State& state, bool own)
{
    MetaRegistry const& registry = MetaRegistry::getInstance();
    run(state, own, [&](Described const& asked) { return registry.getRootPackage(asked.uri); });
}

/// Looks names up in a table that no other thread knows.
void BM_Read_NothingShared(benchmark::State& state)
{
    std::unordered_map<std::string, int> table;
    for (int i = 0; i < 100; ++i)
        table.emplace("example.Class" + std::to_string(i), i);
    std::string const name = "example.Class42";
    for (auto _ : state)
        benchmark::DoNotOptimize(table.find(name));
    state.SetItemsProcessed(state.iterations());
}

void threads(benchmark::internal::Benchmark* benchmark)
{
    benchmark->Threads(1)->Threads(THREADS)->UseRealTime();
}

BENCHMARK(BM_Read_NothingShared)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_IsA, SameClass, false)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_IsA, OwnClass, true)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_PropertyByName, SameClass, false)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_PropertyByName, OwnClass, true)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_Default, SameClass, false)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_Default, OwnClass, true)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_ClassByName, SameClass, false)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_ClassByName, OwnClass, true)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_PackageByUri, SameClass, false)->Apply(threads);
BENCHMARK_CAPTURE(BM_Read_PackageByUri, OwnClass, true)->Apply(threads);
}  // namespace
}  // namespace benchkit
