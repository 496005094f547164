// What classes answer about themselves: inheritance, properties and operations by name.
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tests/meta/MetamodelSketch.h"

namespace tarn::kiln::meta {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Inheritance = MetamodelSketch;
using NameTable = MetamodelSketch;

TEST_F(Inheritance, ReachesUpTheChainOfSuperclassesAndNotDown)
{
    Class const top = cls(u"Top");
    Class const middle = cls(u"Middle", top);
    Class const bottom = cls(u"Bottom", middle);

    EXPECT_TRUE(bottom->isA(bottom));
    EXPECT_TRUE(bottom->isA(top));
    EXPECT_FALSE(top->isA(bottom));
    EXPECT_FALSE(bottom->isA(Type()));
}

TEST_F(Inheritance, EndsInARingOfSuperclasses)
{
    Class const a = cls(u"A");
    Class const b = cls(u"B", a);
    a->setSuperclass(b);

    EXPECT_TRUE(a->isA(b));
    EXPECT_FALSE(a->isA(cls(u"C")));
    EXPECT_FALSE(a->getPropertyByName(u"nothing"));
    EXPECT_THAT(a->getOperationsByName(u"nothing"), IsEmpty());
}

TEST_F(Inheritance, ReachesToTheTopOfALongChain)
{
    Class const top = cls(u"Top");
    Property const atTop = property(u"atTop", top);
    Class bottom = top;
    for (int depth = 0; depth < 300; ++depth)
        bottom = cls(u"Below", bottom);

    EXPECT_TRUE(bottom->isA(top));
    EXPECT_TRUE(bottom->isATypeOf(atTop));
    EXPECT_EQ(bottom->getPropertyByName(u"atTop"), atTop);
}

TEST_F(Inheritance, IsIdentityForTypesThatAreNoClasses)
{
    DataType const date = named<DataType>(u"Date");
    DataType const sameName = named<DataType>(u"Date");

    EXPECT_TRUE(date->isA(date));
    EXPECT_FALSE(date->isA(sameName));
}

TEST_F(Inheritance, MakesASubclassATypeOfInheritedProperties)
{
    Class const top = cls(u"Top");
    Class const bottom = cls(u"Bottom", top);
    Property const inherited = property(u"inherited", top);
    Property const own = property(u"own", bottom);

    EXPECT_TRUE(bottom->isATypeOf(inherited));
    EXPECT_TRUE(bottom->isATypeOf(own));
    EXPECT_FALSE(top->isATypeOf(own));
    EXPECT_FALSE(top->isATypeOf(Property()));

    inherited->destroy();
    EXPECT_FALSE(top->isATypeOf(inherited));
}

TEST_F(NameTable, FindsInheritedPropertiesWithoutHoldingThem)
{
    Class const top = cls(u"Top");
    Class const bottom = cls(u"Bottom", top);
    Property const inherited = property(u"name", top);

    EXPECT_EQ(bottom->getPropertyByName(u"name"), inherited);
    EXPECT_FALSE(bottom->getOwnedAttributes().find(u"name"));
    EXPECT_FALSE(bottom->getPropertyByName(u"other"));
}

TEST_F(NameTable, LetsAPropertyHideTheOneAbove)
{
    Class const top = cls(u"Top");
    Class const bottom = cls(u"Bottom", top);
    Property const above = property(u"name", top);
    Property const below = property(u"name", bottom);

    EXPECT_EQ(bottom->getPropertyByName(u"name"), below);
    EXPECT_EQ(top->getPropertyByName(u"name"), above);
}

TEST_F(NameTable, LetsAnOperationHideAllOverloadsAbove)
{
    Class const top = cls(u"Top");
    Class const bottom = cls(u"Bottom", top);
    Operation const first = operation(u"lend", top);
    Operation const second = operation(u"lend", top);
    EXPECT_THAT(bottom->getOperationsByName(u"lend"), ElementsAre(first, second));

    Operation const own = operation(u"lend", bottom);

    EXPECT_THAT(bottom->getOperationsByName(u"lend"), ElementsAre(own));
    EXPECT_THAT(top->getOperationsByName(u"lend"), ElementsAre(first, second));
}

TEST_F(NameTable, FindsLiteralsInTheOrderOfTheirNames)
{
    Enum const colour = named<Enum>(u"Colour");
    EnumLiteral const red = literal(u"red", 1, colour);
    EnumLiteral const crimson = literal(u"crimson", 1, colour);
    EnumLiteral const blue = literal(u"blue", 2, colour);
    red->setPublicIdentifier(ustring(u"R"));

    EXPECT_EQ(colour->findLiteralByValue(1), crimson);
    EXPECT_EQ(colour->findLiteralByValue(2), blue);
    EXPECT_FALSE(colour->findLiteralByValue(3));
    EXPECT_EQ(colour->findLiteralByPublicIdentifier(u"R"), red);
    EXPECT_FALSE(colour->findLiteralByPublicIdentifier(u"blue"));
}
}  // namespace tarn::kiln::meta
