/// \file
/// Metamodels are read on several threads while another one changes the registry.
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace {

using namespace tarn::kiln;
using meta::MetaRegistry;
using meta::StandardTypes;

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

ustring uriOf(ustring const& name)
{
    return u"http://example.org/" + name;
}

meta::Package define(ustring const& name)
{
    meta::PackageDefinition definition(name, uriOf(name));
    meta::ClassDefinition const base = definition.defineClass(u"Base");
    meta::ClassDefinition(base)
        .attribute(u"title", StandardTypes::stringMeta)
        .defaultValue(u"untitled");
    meta::ClassDefinition derived = definition.defineClass(u"Derived");
    derived.extends(base);
    return definition.finish();
}

void destroy(meta::Package const& package)
{
    MetaRegistry::LockedModel const locked(registry());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/false);
    registry().unregisterRootPackage(package->getUri());
    package->destroy();
    transaction.commit();
}

/// Asks all there is to be asked about the package, which is whole.
void readAll(ustring const& name)
{
    meta::Class const base = registry().getClass(name + u".Base");
    meta::Class const derived = registry().getClass(name + u".Derived");
    ASSERT_TRUE(base);
    ASSERT_TRUE(derived);
    EXPECT_TRUE(derived->isA(base));
    EXPECT_FALSE(base->isA(derived));
    meta::Property const title = derived->getPropertyByName(u"title");
    ASSERT_TRUE(title);
    boost::optional<Value> const byDefault = title->defaultValue();
    ASSERT_TRUE(byDefault);
    EXPECT_TRUE(byDefault->getValue<boost::optional<ustring>>() == ustring(u"untitled"));
    EXPECT_EQ(registry().getPackageForFamily(u"meta"),
              registry().getRootPackage(registry().getPackageForFamily(u"meta")->getUri()));
    Model const model = Model::create(ModelConstellation());
    EXPECT_TRUE(derived->instantiate(model, {}));
}

/// Calls `read` on two threads again and again, until `write` has returned on this one.
template <class Read, class Write> void readBeside(Read const& read, Write const& write)
{
    std::atomic<bool> isDone{false};
    std::vector<std::thread> readers;
    for (int i = 0; i < 2; ++i)
        readers.emplace_back([&] {
            do
                read();
            while (!isDone && !testing::Test::HasFailure());
        });
    write();
    isDone = true;
    for (std::thread& reader : readers)
        reader.join();
}

TEST(MetamodelReaders, AreNotDisturbedByThoseWhoDefineAndDestroy)
{
    meta::Package const stable = define(u"stable");

    readBeside([] { readAll(u"stable"); },
               [] {
                   for (int i = 0; i < 20; ++i)
                       destroy(define(u"passing"));
               });

    destroy(stable);
}

TEST(MetamodelReaders, FindAllOfAPackageOrNothing)
{
    constexpr char16_t FIRST = u'A';
    constexpr char16_t LAST = u'T';
    std::vector<meta::Package> defined;

    readBeside(
        [] {
            for (char16_t number = LAST; number >= FIRST; --number)
            {
                ustring const name = ustring(u"growing") + number;
                if (registry().getRootPackage(uriOf(name)))
                    readAll(name);
            }
        },
        [&] {
            for (char16_t number = FIRST; number <= LAST; ++number)
                defined.push_back(define(ustring(u"growing") + number));
        });

    for (meta::Package const& package : defined)
        destroy(package);
}

TEST(MetamodelReaders, DoNotWaitForTheOneWhoChanges)
{
    meta::Package const stable = define(u"stable");
    {
        MetaRegistry::LockedModel const locked(registry());

        std::thread([] { readAll(u"stable"); }).join();
    }
    destroy(stable);
}

TEST(MetamodelReaders, SeeTheirOwnChangesAtOnce)
{
    MetaRegistry::LockedModel const locked(registry());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    meta::Class const made = meta::Class::create(locked.getModel());
    made->setName(u"SeenAtOnce");

    registry().registerReflectiveClass(made);
    EXPECT_EQ(registry().getClass(u"SeenAtOnce"), made);

    registry().unregisterType(made, u"SeenAtOnce");
    EXPECT_FALSE(registry().getType(u"SeenAtOnce"));
}

TEST(MetamodelReaders, WaitForWhatIsNotThereYet)
{
    std::thread reader;
    std::atomic<bool> hasFound{false};
    meta::Package awaited;
    {
        meta::PackageDefinition definition(u"awaited", uriOf(u"awaited"));
        definition.defineClass(u"Base");
        reader = std::thread(
            [&] { hasFound = static_cast<bool>(registry().getClass(u"awaited.Base")); });
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        EXPECT_FALSE(hasFound);
        awaited = definition.finish();
    }
    reader.join();

    // It may also have come when all was done.
    EXPECT_TRUE(hasFound);
    destroy(awaited);
}
}  // namespace
