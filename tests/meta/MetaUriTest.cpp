/// \file
/// The grammar of package URIs.
#include "tarnkiln/meta/internal/MetaUri.h"

#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/SchemaBase.h"

namespace tarn::kiln::meta {
namespace {

using UriParts = std::pair<ustring, ustring>;

TEST(SchemaBase, IsAnHttpUriThatEndsInASlash)
{
    EXPECT_EQ(SchemaBase, u"http://tarnkiln.invalid/tarnkiln/");
}

TEST(PackageUri, IsComposedOfVersionAndFamily)
{
    EXPECT_EQ(MetaRegistry::composeUri(u"19700101", u"meta"), SchemaBase + u"meta/19700101");
}

TEST(PackageUri, IsParsedIntoVersionAndFamily)
{
    EXPECT_EQ(MetaRegistry::parseUri(SchemaBase + u"meta/19700101"),
              UriParts(u"19700101", u"meta"));
}

TEST(PackageUri, ComesBackFromItsParts)
{
    auto const [version, family] = MetaRegistry::parseUri(SchemaBase + u"library/draft 7");

    EXPECT_EQ(MetaRegistry::composeUri(version, family), SchemaBase + u"library/draft 7");
}

TEST(PackageUri, MayGoOnWithAPackagePath)
{
    ustring const uri = SchemaBase + u"meta/19700101/tarn.kiln.meta";

    EXPECT_EQ(MetaRegistry::parseUri(uri), UriParts(u"19700101", u"meta"));
    EXPECT_TRUE(MetaRegistry::isValidUri(SchemaBase + u"meta/19700101/tarn"));
}

TEST(PackageUri, IsInvalidWithoutASlashAfterTheFamily)
{
    EXPECT_FALSE(MetaRegistry::isValidUri(SchemaBase + u"meta"));
    EXPECT_EQ(MetaRegistry::parseUri(SchemaBase + u"meta"), UriParts());
}

TEST(PackageUri, IsInvalidWithAnEmptyVersion)
{
    EXPECT_FALSE(MetaRegistry::isValidUri(SchemaBase + u"meta/"));
    EXPECT_FALSE(MetaRegistry::isValidUri(SchemaBase + u"meta//tarn"));
}

TEST(PackageUri, IsInvalidWithAnEmptyFamily)
{
    EXPECT_FALSE(MetaRegistry::isValidUri(SchemaBase + u"/19700101"));
}

TEST(PackageUri, OfAnotherHostHasNoParts)
{
    UriParts parts(u"untouched", u"untouched");

    EXPECT_NO_THROW(parts = MetaRegistry::parseUri(u"http://other.invalid/tarnkiln/meta/19700101"));
    EXPECT_EQ(parts, UriParts());
}

TEST(PackageUri, ShorterThanTheBaseHasNoParts)
{
    EXPECT_EQ(MetaRegistry::parseUri(u""), UriParts());
    EXPECT_EQ(MetaRegistry::parseUri(u"http://tarnkiln.invalid/"), UriParts());
    EXPECT_EQ(MetaRegistry::parseUri(SchemaBase), UriParts());
}

TEST(PackageUri, TellsAnAbsentPartFromAnEmptyOne)
{
    EXPECT_EQ(internal::familyOfUri(SchemaBase + u"meta"), std::nullopt);
    EXPECT_EQ(internal::versionOfUri(SchemaBase + u"meta"), std::nullopt);
    EXPECT_EQ(internal::familyOfUri(SchemaBase + u"/7"), std::optional<ustring>(u""));
    EXPECT_EQ(internal::versionOfUri(SchemaBase + u"meta/"), std::optional<ustring>(u""));
    EXPECT_EQ(internal::versionOfUri(u"memory://3"), std::nullopt);
}
}  // namespace
}  // namespace tarn::kiln::meta
