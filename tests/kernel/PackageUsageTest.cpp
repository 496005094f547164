#include "tarnkiln/collections/PrimitiveSequence.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tests/support/PlainElement.h"

#include <gmock/gmock.h>

namespace {

using namespace tarn::kiln;
using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

/// An element of whatever class a test wants.
class Classed : public Plain::Impl
{
public:
    Classed(Model const& model, meta::Class const& metaClass)
        : Impl(model, UUID{}),
          m_class(metaClass)
    {}

    meta::Class const& getMetaClass() const override { return m_class; }

private:
    meta::Class m_class;
};

/// Two root packages, one with a package inside, in a model of their own.
class Packages : public ::testing::Test
{
protected:
    meta::Package makePackage(ustring const& uri, meta::Package const& parent = {}) const
    {
        meta::Package const result = meta::Package::create(metamodel);
        result->setName(uri);
        result->setUri(uri);
        if (parent)
            result->setParentPackage(parent);
        return result;
    }
    meta::Class makeClass(ustring const& name, meta::Package const& package,
                          meta::Class const& superclass = {}) const
    {
        meta::Class const result = meta::Class::create(metamodel);
        result->setName(name);
        if (package)
            result->setOwningPackage(package);
        if (superclass)
            result->setSuperclass(superclass);
        return result;
    }
    Plain make(meta::Class const& metaClass) const
    {
        Plain const result(new Classed(model, metaClass));
        result->notifyCreated();
        return result;
    }

    Model const metamodel = Model::createTransientModel();
    Model const model = Model::create(ModelConstellation());
    meta::Package const base = makePackage(u"base");
    meta::Package const top = makePackage(u"top");
    meta::Package const nested = makePackage(u"nested", top);
    meta::Class const baseClass = makeClass(u"Base", base, ModelElement::metaClass());
    meta::Class const topClass = makeClass(u"Top", top, baseClass);
    meta::Class const nestedClass = makeClass(u"Nested", nested);
};

using AUsedPackage = Packages;
using ThePackageClosure = Packages;

TEST_F(AUsedPackage, IsThatOfTheClassOfAnElement)
{
    EXPECT_THAT(model->getUsedPackages(), IsEmpty());

    Plain const element = make(baseClass);

    EXPECT_THAT(model->getUsedPackages(), ElementsAre(base));
    EXPECT_THAT(model->getUsedPackageUris(), ElementsAre(u"base"));
}

TEST_F(AUsedPackage, IsThatOfEachSuperclassToo)
{
    Plain const element = make(topClass);

    EXPECT_THAT(model->getUsedPackages(), UnorderedElementsAre(base, top));
}

TEST_F(AUsedPackage, IsTheRootOfThePackageOfTheClass)
{
    Plain const element = make(nestedClass);

    EXPECT_THAT(model->getUsedPackages(), ElementsAre(top));
}

TEST_F(AUsedPackage, IsNoneForAClassWithoutAPackage)
{
    Plain const element = make(makeClass(u"Homeless", meta::Package()));

    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
}

TEST_F(AUsedPackage, StaysInUseUntilItsLastElementIsDestroyed)
{
    Plain const first = make(topClass);
    Plain const second = make(baseClass);

    first->destroy();
    EXPECT_THAT(model->getUsedPackages(), ElementsAre(base));
    second->destroy();

    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
}

TEST_F(AUsedPackage, IsThatOfOneModel)
{
    Model const other = Model::create(ModelConstellation());

    Plain const element = make(baseClass);

    EXPECT_THAT(other->getUsedPackages(), IsEmpty());
}

TEST_F(AUsedPackage, IsForgottenWithADestructionThatIsTakenBack)
{
    Plain const element = make(baseClass);
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    element->destroy();
    transaction.rollBack();

    EXPECT_TRUE(element);
    EXPECT_THAT(model->getUsedPackages(), IsEmpty());
    element->destroy();
    EXPECT_THAT(model->getUsedPackages(), ElementsAre(base)) << "a count below 0 is not 0";
}

TEST_F(AUsedPackage, StaysInUseByACreationThatIsTakenBack)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    Plain const element = make(baseClass);
    transaction.rollBack();

    EXPECT_FALSE(element);
    EXPECT_THAT(model->getUsedPackages(), ElementsAre(base));
}

// ---------------------------------------------------------------------------- closure

/// Enters packages in the registry for as long as it lives.
class Registered
{
public:
    explicit Registered(std::vector<meta::Package> packages) : m_packages(std::move(packages))
    {
        meta::MetaRegistry::LockedModel const locked(meta::MetaRegistry::getInstance());
        for (meta::Package const& package : m_packages)
            meta::MetaRegistry::getInstance().registerRootPackage(package);
    }
    Registered(Registered const&) = delete;
    Registered& operator=(Registered const&) = delete;
    ~Registered()
    {
        meta::MetaRegistry::LockedModel const locked(meta::MetaRegistry::getInstance());
        for (meta::Package const& package : m_packages)
            meta::MetaRegistry::getInstance().unregisterRootPackage(package->getUri());
    }

private:
    std::vector<meta::Package> m_packages;
};

void import(meta::Package const& package, ustring const& uri)
{
    package->getImportedPackageURIs().push_back(uri);
}

TEST_F(ThePackageClosure, OfNothingIsEmpty)
{
    EXPECT_THAT(Model::Impl::getImportedPackageClosure({}), IsEmpty());
}

TEST_F(ThePackageClosure, HoldsThePackagesThemselvesEachOnce)
{
    EXPECT_THAT(Model::Impl::getImportedPackageClosure({base, top, base}),
                UnorderedElementsAre(u"base", u"top"));
}

TEST_F(ThePackageClosure, FollowsImportsThatAreRegistered)
{
    meta::Package const far = makePackage(u"far");
    import(top, u"base");
    import(base, u"far");
    Registered const registered({base, far});

    EXPECT_THAT(Model::Impl::getImportedPackageClosure({top}),
                UnorderedElementsAre(u"top", u"base", u"far"));
}

TEST_F(ThePackageClosure, LeavesOutImportsThatAreNot)
{
    import(top, u"unknown");

    EXPECT_THAT(Model::Impl::getImportedPackageClosure({top}), ElementsAre(u"top"));
}

TEST_F(ThePackageClosure, EndsInACircle)
{
    import(top, u"base");
    import(base, u"top");
    import(base, u"base");
    Registered const registered({base, top});

    EXPECT_THAT(Model::Impl::getImportedPackageClosure({top}),
                UnorderedElementsAre(u"top", u"base"));
}

TEST_F(ThePackageClosure, DescribesAModelByThePackagesItUses)
{
    import(top, u"base");
    Registered const registered({base});
    Plain const element = make(nestedClass);

    EXPECT_THAT(model->getUsedPackageUris(), ElementsAre(u"top"));
    EXPECT_THAT(model->getDescriptivePackageURIClosure(), UnorderedElementsAre(u"top", u"base"));
}
}  // namespace
