#include "tarnkiln/meta/ExtensionPrototype.h"

#include <gtest/gtest.h>

namespace {
using namespace tarn::kiln;
using meta::ExtensionPrototype;

void expectLess(ExtensionPrototype const& left, ExtensionPrototype const& right)
{
    EXPECT_EQ(left.compareWith(right), -1);
    EXPECT_EQ(right.compareWith(left), 1);
    EXPECT_TRUE(left < right);
    EXPECT_FALSE(right < left);
    EXPECT_FALSE(left == right);
}

TEST(PrototypeOfAnExtension, BeginsAsAnUnnamedOptionalSingleValue)
{
    ExtensionPrototype const prototype;

    EXPECT_EQ(prototype.getLower(), 0u);
    EXPECT_EQ(prototype.getUpper(), 1u);
    EXPECT_FALSE(prototype.isOrdered());
    EXPECT_TRUE(prototype.isUnique());
    EXPECT_EQ(prototype.getName(), u"");
    EXPECT_EQ(prototype.getTypeName(), u"");
}

TEST(PrototypeOfAnExtension, EqualsOneWithTheSameFields)
{
    ExtensionPrototype prototype;
    prototype.setLower(2);
    prototype.setUpper(0xFFFFFFFF);
    prototype.setIsOrdered(true);
    prototype.setIsUnique(false);
    prototype.setName(u"tags");
    prototype.setTypeName(u"String");
    ExtensionPrototype const copy = prototype;

    EXPECT_EQ(copy.getUpper(), 0xFFFFFFFFu);
    EXPECT_TRUE(copy == prototype);
    EXPECT_EQ(copy.compareWith(prototype), 0);
}

TEST(PrototypeOfAnExtension, IsOrderedByItsFieldsInTurn)
{
    ExtensionPrototype lower;
    lower.setLower(1);
    ExtensionPrototype upper;
    upper.setUpper(2);
    ExtensionPrototype ordered;
    ordered.setIsOrdered(true);
    ExtensionPrototype notUnique;
    notUnique.setIsUnique(false);
    ExtensionPrototype name;
    name.setName(u"a");
    ExtensionPrototype typeName;
    typeName.setTypeName(u"a");

    expectLess(notUnique, ExtensionPrototype());
    expectLess(ExtensionPrototype(), typeName);
    expectLess(typeName, name);
    expectLess(name, ordered);
    expectLess(ordered, upper);
    expectLess(upper, lower);
}
}  // namespace
