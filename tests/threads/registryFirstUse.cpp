/// \file
/// Uses the registry or its catalogue for the first time in a process, from eight threads at once.
///
///     registryFirstUse <entry point>
///     registryFirstUse round <number>      one of the entry points, another one for each number
///
/// Exits with 0 if all threads saw the same complete registry, else with 1 and a line for each
/// failure.
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Catalogue.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/MetaPackageMeta.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <array>
#include <atomic>
#include <cstdlib>
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

template <class Handle> void const* useMetaClass()
{
    return Handle::metaClass().getImpl();
}

void const* useTypeByName()
{
    return MetaRegistry::getInstance().getType(u"tarn.kiln.meta.TransactionOrigin").getImpl();
}

void const* useRootPackage()
{
    return MetaRegistry::getInstance()
        .getRootPackage(meta::SchemaBase + u"meta/19700101")
        .getImpl();
}

void const* useFamily()
{
    return MetaRegistry::getInstance().getPackageForFamily(u"meta").getImpl();
}

void const* useMetaPackage()
{
    return &meta::MetaPackageMeta::getInstance();
}

/// An element of each thread's own model asks for its class as it is created.
void const* useAnElement()
{
    return meta::Enum::create(Model::create(ModelConstellation()))->getMetaClass().getImpl();
}

/// The property of a slot.
void const* useASlot()
{
    meta::Enum const element = meta::Enum::create(Model::create(ModelConstellation()));
    return element->getPropertyByIndex(1).getImpl();
}

void const* useValueOfAModel()
{
    return meta::standardTypeOf<Model>().getElementImpl();
}

/// Changes of the registry's model, one thread after the other.
void const* useTransaction()
{
    MetaRegistry::LockedModel const locked(MetaRegistry::getInstance());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    meta::Package const made = meta::Package::create(locked.getModel());
    made->destroy();
    transaction.commit();
    return locked.getModel().getImpl();
}

/// Whether the catalogue is complete; what only looks at the registry leaves it unbuilt.
bool isCatalogueUsed(std::string const& name)
{
    return name.find("registry.") != 0;
}

std::map<std::string, EntryPoint> const entryPoints = {
    {"Argument", useMetaClass<meta::Argument>},
    {"Attribute", useMetaClass<meta::Attribute>},
    {"AttributeMap", useMetaClass<meta::AttributeMap>},
    {"AttributeMapAttribute", useMetaClass<meta::AttributeMapAttribute>},
    {"BooleanAttribute", useMetaClass<meta::BooleanAttribute>},
    {"Class", useMetaClass<meta::Class>},
    {"DataType", useMetaClass<meta::DataType>},
    {"DateTimeAttribute", useMetaClass<meta::DateTimeAttribute>},
    {"DynamicExtensions", useMetaClass<meta::DynamicExtensions>},
    {"Enum", useMetaClass<meta::Enum>},
    {"EnumLiteral", useMetaClass<meta::EnumLiteral>},
    {"Extension", useMetaClass<meta::Extension>},
    {"IntegerAttribute", useMetaClass<meta::IntegerAttribute>},
    {"NamedElement", useMetaClass<meta::NamedElement>},
    {"Operation", useMetaClass<meta::Operation>},
    {"Package", useMetaClass<meta::Package>},
    {"PrimitiveType", useMetaClass<meta::PrimitiveType>},
    {"Property", useMetaClass<meta::Property>},
    {"RealAttribute", useMetaClass<meta::RealAttribute>},
    {"StringAttribute", useMetaClass<meta::StringAttribute>},
    {"StructuredType", useMetaClass<meta::StructuredType>},
    {"Type", useMetaClass<meta::Type>},
    {"TypedElement", useMetaClass<meta::TypedElement>},
    {"UUIDAttribute", useMetaClass<meta::UUIDAttribute>},
    {"metaPackage", useMetaPackage},
    {"typeByName", useTypeByName},
    {"rootPackage", useRootPackage},
    {"family", useFamily},
    {"element", useAnElement},
    {"slot", useASlot},
    {"valueOfAModel", useValueOfAModel},
    {"transaction", useTransaction},
    {"registry.instance", useRegistry},
    {"registry.modelClass", useModelClass},
    {"registry.modelElementClass", useModelElementClass},
    {"registry.constellationClass", useConstellationClass},
    {"registry.integralType", useIntegralType},
    {"registry.commitMessage", useCommitMessage},
    {"registry.modelsMetaClass", useModelsMetaClass},
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
void checkRegistry()
{
    MetaRegistry& registry = MetaRegistry::getInstance();
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

/// The same of an entry point that leads to the catalogue.
void checkCatalogue()
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    meta::MetaPackageMeta& catalogue = meta::MetaPackageMeta::getInstance();
    check(catalogue.isBuilt(), "the catalogue is built");
    check(static_cast<bool>(catalogue.getRootPackage()), "the catalogue has its root package");
    for (std::size_t row = 0; row <= meta::rows::classes::UUIDAttribute; ++row)
    {
        meta::Class const& type = catalogue.getClass(row);
        check(type && registry.getType(type->getQualifiedName()) == type, "a class is registered");
        check(type && type->hasOwnedAttributes(), "a class has its properties");
        check(type && type->isA(ModelElement::metaClass()), "a class has its superclasses");
    }
    check(meta::Property::metaClass()->getPropertyByName(u"name") ==
              catalogue.getProperty(meta::rows::properties::NamedElementName),
          "a property is inherited");
    check(registry.getRootPackage(meta::SchemaBase + u"meta/19700101") ==
              catalogue.getRootPackage(),
          "the root package is registered");
}

/// The first builder fails, whoever that is, and a later one succeeds.
void useAfterFailure()
{
    MetaRegistry& registry = MetaRegistry::getInstance();
    auto const hide = [&] {
        MetaRegistry::LockedModel const locked(registry);
        registry.unregisterType(StandardTypes::jsonValueMeta, u"JsonValue");
    };
    auto const fails = [] {
        try
        {
            meta::Class::metaClass();
            return false;
        }
        catch (tarnkiln::messages::NoSuchType const& exception)
        {
            return true;
        }
    };
    hide();
    check(fails(), "the catalogue can not be built without one of the types that it needs");
    check(fails(), "a second attempt fails in the same way");
    check(!meta::MetaRegistry::getInstance().getModel()->findElement(
              boost::lexical_cast<UUID>("83420365-c799-3b21-8efd-43817abf0909")),
          "nothing is left of the attempts");
    check(registry.getModel()->getElementCount() == 20, "no element is left of the attempts");
    registry.registerType(StandardTypes::jsonValueMeta, nullptr, nullptr);
}

/// Runs `entryPointOf(thread)` on all threads at once and compares what they see.
void useAtOnce(std::function<EntryPoint(int)> const& entryPointOf, bool usesCatalogue)
{
    std::array<void const*, THREADS> seen{};
    std::latch start(THREADS);
    std::vector<std::thread> threads;
    for (int thread = 0; thread < THREADS; ++thread)
    {
        threads.emplace_back([&, thread] {
            start.arrive_and_wait();
            seen[static_cast<std::size_t>(thread)] = entryPointOf(thread)();
            checkRegistry();
            if (usesCatalogue)
                checkCatalogue();
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
    alarm(120);  // ends threads that wait for each other
    std::string name = count >= 2 ? arguments[1] : "";
    if (name == "round" && count == 3)
    {
        // A step that shares no factor with the number of entry points reaches all of them.
        auto const round = static_cast<std::size_t>(std::atoi(arguments[2]));
        std::size_t const step = entryPoints.size() % 7 ? 7 : 11;
        name = std::next(entryPoints.begin(),
                         static_cast<std::ptrdiff_t>(round * step % entryPoints.size()))
                   ->first;
    }
    auto const found = entryPoints.find(name);
    if (name == "all" || name == "afterFailure")
    {
        if (name == "afterFailure")
            useAfterFailure();
        useAtOnce(
            [](int thread) {
                auto const steps = 5 * thread % static_cast<int>(entryPoints.size());
                return std::next(entryPoints.begin(), steps)->second;
            },
            /*usesCatalogue=*/true);
    }
    else if (found != entryPoints.end())
    {
        useAtOnce([&](int) { return found->second; }, isCatalogueUsed(name));
    }
    else
    {
        std::cerr << "usage: registryFirstUse round <number>|all|afterFailure";
        for (auto const& [known, entryPoint] : entryPoints)
            std::cerr << '|' << known;
        std::cerr << '\n';
        return 2;
    }
    Model const model = MetaRegistry::getInstance().getModel();
    check(isCatalogueUsed(name) || model->getElementCount() == 20,
          "the catalogue is not built before it is used");
    checkCatalogue();
    check(model->getElementCount() == 182, "no element is made twice");
    if (failures != 0)
        std::cerr << "entry point: " << name << '\n';
    return failures == 0 ? 0 : 1;
}
