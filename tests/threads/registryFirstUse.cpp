/// \file
/// Uses the registry for the first time in a process, from eight threads at once.
///
///     registryFirstUse <entry point>
///
/// Exits with 0 if all threads saw the same complete registry, else with 1 and a line for each
/// failure.
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <array>
#include <atomic>
#include <functional>
#include <iostream>
#include <latch>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <unistd.h>
#include <vector>

namespace {

using namespace tarn::kiln;
using meta::MetaRegistry;
using meta::StandardTypes;

constexpr int THREADS = 8;

/// What an entry point leads to; the same address on every thread.
using EntryPoint = void const* (*)();

void const* useRegistry()
{
    return &MetaRegistry::getInstance();
}

void const* useModelClass()
{
    return Model::metaClass().getImpl();
}

void const* useModelElementClass()
{
    return ModelElement::metaClass().getImpl();
}

void const* useConstellationClass()
{
    return ModelConstellation::metaClass().getImpl();
}

void const* useIntegralType()
{
    return StandardTypes::getIntegralType(/*isSigned=*/false, 32).getImpl();
}

/// Each thread has a model of its own, whose transaction carries a text and so its type.
void const* useCommitMessage()
{
    Model const model = Model::create(ModelConstellation());
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    transaction.commit(u"a message");
    return StandardTypes::stringMeta.getImpl();
}

void const* useModelsMetaClass()
{
    return Model::createTransientModel()->getMetaClass().getImpl();
}

std::map<std::string, EntryPoint> const entryPoints = {
    {"registry", useRegistry},
    {"modelClass", useModelClass},
    {"modelElementClass", useModelElementClass},
    {"constellationClass", useConstellationClass},
    {"integralType", useIntegralType},
    {"commitMessage", useCommitMessage},
    {"modelsMetaClass", useModelsMetaClass},
};

std::mutex failureMutex;
std::atomic<int> failures{0};

void check(bool condition, char const* what)
{
    if (condition)
        return;
    ++failures;
    std::lock_guard const lock(failureMutex);
    std::cerr << what << '\n';
}

/// What must be true on a thread as soon as its entry point has returned.
void checkCompleteness()
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    check(registry.getModel()->getElementCount() == 20, "17 primitive types and 3 classes");
    for (char16_t const* const name :
         {u"String", u"Integer", u"Integer8", u"Integer16", u"Integer64", u"Real", u"Boolean",
          u"UnlimitedNatural", u"UInteger8", u"UInteger16", u"UInteger64", u"UUID", u"DateTime",
          u"StdString", u"HostArray", u"JsonValue", u"StringToStringMap"})
    {
        meta::PrimitiveType const type = registry.getPrimitiveType(name);
        check(static_cast<bool>(type), "a primitive type is registered");
        check(type && type->getName() == name, "a primitive type has its name");
    }
    check(registry.getClass(u"Model") == Model::metaClass(), "the class of models");
    check(registry.getClass(u"ModelElement") == ModelElement::metaClass(), "the class of elements");
    check(registry.getClass(u"ModelConstellation") == ModelConstellation::metaClass(),
          "the class of constellations");
}

/// Runs `entryPointOf(thread)` on all threads at once and compares what they see.
void useAtOnce(std::function<EntryPoint(int)> const& entryPointOf)
{
    std::array<void const*, THREADS> seen{};
    std::latch start(THREADS);
    std::vector<std::thread> threads;
    for (int thread = 0; thread < THREADS; ++thread)
    {
        threads.emplace_back([&, thread] {
            start.arrive_and_wait();
            seen[static_cast<std::size_t>(thread)] = entryPointOf(thread)();
            checkCompleteness();
        });
    }
    for (std::thread& thread : threads)
        thread.join();
    for (int thread = 0; thread < THREADS; ++thread)
    {
        void const* const result = seen[static_cast<std::size_t>(thread)];
        check(result != nullptr, "an entry point leads to something");
        check(result == entryPointOf(thread)(), "an entry point leads to the same each time");
    }
}
}  // namespace

int main(int count, char** arguments)
{
    alarm(60);  // ends threads that wait for each other
    std::string const name = count == 2 ? arguments[1] : "";
    if (name == "all")
    {
        useAtOnce([](int thread) {
            auto const steps = thread % static_cast<int>(entryPoints.size());
            return std::next(entryPoints.begin(), steps)->second;
        });
    }
    else if (auto const found = entryPoints.find(name); found != entryPoints.end())
    {
        useAtOnce([&](int) { return found->second; });
    }
    else
    {
        std::cerr << "usage: registryFirstUse all";
        for (auto const& [known, entryPoint] : entryPoints)
            std::cerr << '|' << known;
        std::cerr << '\n';
        return 2;
    }
    return failures == 0 ? 0 : 1;
}
