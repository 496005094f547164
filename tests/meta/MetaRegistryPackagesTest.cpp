/// \file
/// Root packages, families and versions.
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tests/meta/RegistrySession.h"

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

/// A root package of the registry for the length of a test.
class RootPackage
{
public:
    explicit RootPackage(ustring const& uri) : m_package(u"")
    {
        RegistrySession session;
        m_package->setUri(uri);
        registry().registerRootPackage(m_package);
        session.commit();
    }
    RootPackage(RootPackage const&) = delete;
    RootPackage& operator=(RootPackage const&) = delete;
    ~RootPackage()
    {
        MetaRegistry::LockedModel const locked(registry());
        registry().unregisterRootPackage(m_package.get() ? m_package->getUri() : m_uri);
    }

    void destroy()
    {
        m_uri = m_package->getUri();
        m_package.destroy();
    }
    Package const& get() const { return m_package.get(); }

private:
    RegistryElement<Package> m_package;
    ustring m_uri;
};

TEST(RootPackages, AreFoundByTheirExactUri)
{
    ustring const uri = SchemaBase + u"shop/20200101";
    RootPackage const package(uri);

    EXPECT_EQ(registry().getRootPackage(uri), package.get());
    EXPECT_EQ(registry().getRootPackage(uri, /*load=*/false), package.get());
    EXPECT_EQ(registry().getRootPackage(uri, /*load=*/true), package.get());
    EXPECT_EQ(registry().getRootPackage(uri + u"/"), Package());
}

TEST(RootPackages, AreNotFoundByAnUnknownUri)
{
    EXPECT_EQ(registry().getRootPackage(u"http://other.invalid/x"), Package());
    EXPECT_EQ(registry().getRootPackage(u"http://other.invalid/x", /*load=*/true), Package());
    EXPECT_EQ(registry().getRootPackage(SchemaBase + u"nobody/1", /*load=*/true), Package());
    EXPECT_EQ(registry().getPackageForFamily(u"nobody"), Package());
}

TEST(RootPackages, MayHaveAUriOutsideAllFamilies)
{
    RootPackage const package(u"urn:private");

    EXPECT_EQ(registry().getRootPackage(u"urn:private"), package.get());
    EXPECT_FALSE(registry().isVersionCurrentForFamily(u"urn:private"));
}

TEST(RootPackages, AreReplacedUnderTheSameUri)
{
    ustring const uri = SchemaBase + u"shop/20200101";
    RootPackage const first(uri);
    RootPackage const second(uri);

    EXPECT_EQ(registry().getRootPackage(uri), second.get());
    EXPECT_EQ(registry().getPackageForFamily(u"shop"), second.get());
}

TEST(RootPackages, AreReturnedDeadWhereNothingReplacesThem)
{
    ustring const uri = SchemaBase + u"ruin/20200101";
    RootPackage package(uri);
    package.destroy();

    EXPECT_FALSE(registry().getRootPackage(uri, /*load=*/true));
    EXPECT_EQ(registry().getRootPackage(uri), package.get());
    EXPECT_FALSE(registry().isVersionCurrentForFamily(uri));
}

TEST(PackageFamily, HasTheRootPackageRegisteredLastEvenIfItsVersionIsOlder)
{
    RootPackage const newer(SchemaBase + u"bank/20210101");
    RootPackage const older(SchemaBase + u"bank/19990101");

    EXPECT_EQ(registry().getPackageForFamily(u"bank"), older.get());
    EXPECT_TRUE(registry().isVersionCurrentForFamily(SchemaBase + u"bank/19990101"));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"bank/20210101"));
    EXPECT_EQ(registry().getRootPackage(SchemaBase + u"bank/20210101"), newer.get());
}

TEST(PackageFamily, HasNoCurrentPackageOnceAnyVersionIsUnregistered)
{
    RootPackage const first(SchemaBase + u"farm/1");
    RootPackage const second(SchemaBase + u"farm/2");
    {
        MetaRegistry::LockedModel const locked(registry());
        registry().unregisterRootPackage(SchemaBase + u"farm/1");
    }

    EXPECT_EQ(registry().getPackageForFamily(u"farm"), Package());
    EXPECT_EQ(registry().getRootPackage(SchemaBase + u"farm/1"), Package());
    EXPECT_EQ(registry().getRootPackage(SchemaBase + u"farm/2"), second.get());
}

TEST(PackageVersion, IsComparedAsText)
{
    RootPackage const package(SchemaBase + u"mill/007");

    EXPECT_TRUE(registry().isVersionCurrentForFamily(SchemaBase + u"mill/007"));
    EXPECT_TRUE(registry().isVersionCurrentForFamily(SchemaBase + u"mill/007/path.to.package"));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"mill/7"));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"mill/"));
}

TEST(PackageVersion, IsNotCurrentWithoutAFamily)
{
    EXPECT_FALSE(registry().isVersionCurrentForFamily(u""));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"mill"));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"nobody/1"));
}

TEST(PackageVersion, IsCurrentWhereBothAreEmpty)
{
    RootPackage const package(SchemaBase + u"hut/");

    EXPECT_TRUE(registry().isVersionCurrentForFamily(SchemaBase + u"hut/"));
    EXPECT_FALSE(registry().isVersionCurrentForFamily(SchemaBase + u"hut/1"));
}
}  // namespace
}  // namespace tarn::kiln::meta
