// Metamodels that are defined while memory runs out: all of one is there or nothing, the registry
// is as before, and the same definition succeeds afterwards.
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/PackageBuilder.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/PropertyBuilder.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/support/EachFailure.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/RuntimeMetamodel.h"

#include <gmock/gmock.h>

#include <ostream>

namespace {

using namespace testkit;
using meta::ClassDefinition;
using meta::MetaRegistry;
using meta::PackageDefinition;
using testing::IsEmpty;

ustring const URI = u"http://example.org/a-library-that-runs-out-of-memory";

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

void define()
{
    PackageDefinition library(u"forgetful", URI);
    ClassDefinition book = library.defineClass(u"Book");
    book.attribute(u"title", StandardTypes::stringMeta);
    book.attribute(u"genre", library.defineEnum(u"Genre", {u"prose", u"verse"}));
    ClassDefinition shelf = library.defineClass(u"Shelf");
    shelf.contents(u"books", book).sequence().opposite(u"shelf");
    shelf.reference(u"best", book);
    library.finish();
}

/// Without the definitions: by builders, step by step.
void buildAndRegister()
{
    MetaRegistry::LockedModel const locked(registry());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
    meta::Package const package = meta::Package::cast(
        meta::Package::Builder(locked.getModel()).setName(u"forgetful").setUri(URI).create());
    meta::Class const book = meta::Class::cast(meta::Class::Builder(locked.getModel())
                                                   .setName(u"Book")
                                                   .setOwningPackage(package)
                                                   .setSuperclass(ModelElement::metaClass())
                                                   .create());
    ustring const name = u"forgetful.Book";
    meta::Property::Builder(locked.getModel())
        .setName(u"title")
        .setUpper(1)
        .setPropertyIndex(1)
        .setType(StandardTypes::stringMeta)
        .setOwningType(book)
        .create();
    try
    {
        registry().registerReflectiveClass(book);
        registry().registerRootPackage(package);
        if (transaction.commit() == TransactionResult::RolledBack)
            throw std::bad_alloc();
    }
    catch (std::bad_alloc const&)
    {
        registry().unregisterRootPackage(URI);
        registry().unregisterType(book, name);
        throw;
    }
}

/// Takes out what one of the two above has defined.
void undefine()
{
    meta::Package const package = registry().getRootPackage(URI);
    ASSERT_TRUE(package);
    MetaRegistry::LockedModel const locked(registry());
    Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/false);
    registry().unregisterRootPackage(URI);
    package->destroy();
    transaction.commit();
}

/// How much memory is in use after a change of the registry that is always the same: what listens
/// to the registry keeps the last report.
long blocksAfterSameReport()
{
    {
        MetaRegistry::LockedModel const locked(registry());
        Transaction const transaction = locked.getModel()->beginTransaction(/*revertible=*/true);
        meta::Package::create(locked.getModel())->destroy();
        transaction.commit();
    }
    registry().getType(u"String");
    return FailingAllocation::liveBlocks();
}

/// Makes an element of the class.
void expectUsable()
{
    meta::Class const book = registry().getClass(u"forgetful.Book");
    ASSERT_TRUE(book);
    Model const model = Model::create(ModelConstellation());
    ModelElement const emma = book->instantiate(model, {});
    ASSERT_TRUE(emma);
    meta::Property const title = book->getPropertyByName(u"title");
    setValue(emma, title, Value::createEmptyValue(title));
    EXPECT_THAT(model->checkInvariants(), IsEmpty());
}

struct Definition
{
    char const* name;
    void (*define)();

    friend void PrintTo(Definition const& definition, std::ostream* out)
    {
        *out << definition.name;
    }
};

class DefinitionsOutOfMemory : public testing::TestWithParam<Definition>
{
protected:
    /// The names of what the registry's model holds, sorted.
    static std::vector<ustring> contents()
    {
        std::vector<ustring> names;
        for (ModelElement const& element : registry().getModel()->getAllElements())
            names.push_back(element->identifier());
        std::sort(names.begin(), names.end());
        return names;
    }
    static void expectNothingDefined(std::vector<ustring> const& before)
    {
        EXPECT_EQ(contents(), before);
        EXPECT_FALSE(registry().getType(u"forgetful.Book"));
        EXPECT_FALSE(registry().getType(u"forgetful.Genre"));
        EXPECT_FALSE(registry().getRootPackage(URI));
        EXPECT_TRUE(registry().getModel()->isFrozen());
        EXPECT_EQ(registry().getModel()->getCurrentTransaction(), nullptr);
        EXPECT_THAT(registry().getModel()->checkInvariants(), IsEmpty());
    }
};

INSTANTIATE_TEST_SUITE_P(By, DefinitionsOutOfMemory,
                         testing::Values(Definition{"Definitions", &define},
                                         Definition{"Builders", &buildAndRegister}),
                         testing::PrintToStringParamName());

TEST_P(DefinitionsOutOfMemory, LeaveAllOrNothing)
{
    for (Failing const mode : {Failing::Once, Failing::FromThereOn})
    {
        GetParam().define();
        expectUsable();
        undefine();
        std::vector<ustring> const before = contents();
        bool failed = true;
        for (unsigned long number = 1; failed && !HasFailure(); ++number)
        {
            SCOPED_TRACE("allocation " + std::to_string(number));
            long const blocks = blocksAfterSameReport();
            Attempt const attempt(number, mode, GetParam().define);
            failed = attempt.failed;
            if (attempt.threw)
            {
                expectNothingDefined(before);
                EXPECT_EQ(blocksAfterSameReport(), blocks);
            }
            else
            {
                expectUsable();
                undefine();
                expectNothingDefined(before);
            }
        }
    }
    GetParam().define();
    expectUsable();
    undefine();
}

TEST_P(DefinitionsOutOfMemory, AreTakenBackWithoutMemory)
{
    std::vector<ustring> const before = contents();
    bool failed = true;
    for (unsigned long number = 1; failed && !HasFailure(); ++number)
    {
        SCOPED_TRACE("allocation " + std::to_string(number));
        {
            MetaRegistry::LockedModel const locked(registry());
            Transaction const transaction =
                locked.getModel()->beginTransaction(/*revertible=*/true);
            meta::Package const package = meta::Package::cast(
                meta::Package::Builder(locked.getModel()).setName(u"undone").create());
            meta::Class::Builder(locked.getModel())
                .setName(u"Book")
                .setOwningPackage(package)
                .create();
            Attempt const attempt(number, Failing::FromThereOn, [&] {
                EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
            });
            EXPECT_FALSE(attempt.threw);
            failed = attempt.failed;
        }
        expectNothingDefined(before);
    }
    GetParam().define();
    expectUsable();
    undefine();
}

TEST(ExtensionsDeclaredOutOfMemory, AreThereOrNot)
{
    forEachFailure([](unsigned long number, Failing mode) {
        Model const model = Model::create(ModelConstellation());
        auto const declare = [&] {
            meta::ExtensionPrototype prototype;
            prototype.setName(u"a shelf with a name that is long");
            prototype.setTypeName(u"Integer");
            prototype.setUpper(1);
            model->extendMetaclass(Node::metaClass(), prototype,
                                   Value(StandardTypes::integerMeta, 7));
        };
        Attempt const attempt(number, mode, declare);
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        EXPECT_THAT(registry().getModel()->checkInvariants(), IsEmpty());
        if (attempt.threw)
            declare();
        Node const node = Node::create(model);
        EXPECT_EQ(node->getExtension(u"a shelf with a name that is long").getValue<int>(), 7);
        return attempt.failed;
    });
}
}  // namespace
