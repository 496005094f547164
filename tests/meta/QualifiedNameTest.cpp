#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/meta/MetamodelSketch.h"

namespace tarn::kiln::meta {

using QualifiedName = MetamodelSketch;

TEST_F(QualifiedName, LeavesOutTheEmptyNameOfTheRootPackage)
{
    Package const root = package(u"");
    Package const outer = package(u"outer", root);
    Package const inner = package(u"inner", outer);

    EXPECT_EQ(root->getQualifiedName(), u"");
    EXPECT_EQ(outer->getQualifiedName(), u"outer");
    EXPECT_EQ(inner->getQualifiedName(), u"outer.inner");
    EXPECT_EQ(cls(u"Book", {}, inner)->getQualifiedName(), u"outer.inner.Book");
    EXPECT_EQ(cls(u"Book", {}, root)->getQualifiedName(), u"Book");
    EXPECT_EQ(cls(u"Book")->getQualifiedName(), u"Book");
    StandardTypes::ensureInitialized();
    EXPECT_EQ(StandardTypes::booleanMeta->getQualifiedName(), u"Boolean");
}

TEST_F(QualifiedName, FollowsARename)
{
    Package const outer = package(u"outer");
    Class const book = cls(u"Book", {}, outer);

    outer->setName(u"library");

    EXPECT_EQ(book->getQualifiedName(), u"library.Book");
}

TEST_F(QualifiedName, IdentifiesTypesPackagesPropertiesAndLiterals)
{
    Package const outer = package(u"outer");
    Class const book = cls(u"Book", {}, outer);
    Property const title = property(u"title", book);
    Enum const colour = named<Enum>(u"Colour");
    colour->setOwningPackage(outer);
    EnumLiteral const red = literal(u"red", 1, colour);

    EXPECT_EQ(outer->identifier(), u"outer");
    EXPECT_EQ(book->identifier(), u"outer.Book");
    EXPECT_EQ(title->identifier(), u"outer.Book.title");
    EXPECT_EQ(red->identifier(), u"outer.Colour.red");
    EXPECT_EQ(operation(u"lend", book)->identifier(), u"");
}

TEST_F(QualifiedName, IsTheBareNameOfAPropertyWhoseOwnerIsDead)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);

    book->destroy();

    EXPECT_EQ(title->identifier(), u"title");
}
}  // namespace tarn::kiln::meta
