#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelId.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tests/support/ExpectRaises.h"

#include <gtest/gtest.h>

namespace {
using namespace tarn::kiln;

TEST(ElementIdentifier, NamesTheTypeOfUuids)
{
    EXPECT_EQ(ElementId::UUID_TYPE, u"uuid");
}

TEST(ElementIdentifier, KeepsItsParts)
{
    ElementId const id(u"isbn", u"42");

    EXPECT_EQ(id.getType(), u"isbn");
    EXPECT_EQ(id.getId(), u"42");
    EXPECT_EQ(ElementId().getType(), u"");
    EXPECT_EQ(ElementId().getId(), u"");
}

TEST(ElementIdentifier, IsOrderedByTypeFirst)
{
    ElementId const left(u"a", u"9");
    ElementId const right(u"b", u"1");

    EXPECT_LT(left.compare(right), 0);
    EXPECT_GT(right.compare(left), 0);
    EXPECT_TRUE(left < right);
    EXPECT_FALSE(right < left);
}

TEST(ElementIdentifier, IsOrderedByIdWithinAType)
{
    ElementId const left(u"a", u"1");
    ElementId const right(u"a", u"10");

    EXPECT_LT(left.compare(right), 0);
    EXPECT_GT(right.compare(left), 0);
    EXPECT_EQ(left.compare(ElementId(u"a", u"1")), 0);
    EXPECT_FALSE(left < left);
}

TEST(ElementIdentifier, IsOrderedByCodeUnit)
{
    // U+10000 comes after U+FF5E as a character, its first code unit before it.
    ElementId const surrogates(u"a", u"\U00010000");
    ElementId const wide(u"a", u"\uFF5E");

    EXPECT_TRUE(surrogates < wide);
    EXPECT_TRUE(ElementId(u"B", u"") < ElementId(u"a", u""));
}

TEST(ProxyIdentifier, IsOrderedByElementBeforeModel)
{
    ProxyId const left(u"uuid", u"1", ustring(u"z"));
    ProxyId const right(u"uuid", u"2", ustring(u"a"));

    EXPECT_TRUE(left < right);
    EXPECT_FALSE(right < left);
    EXPECT_TRUE(ProxyId(u"a", u"2", ustring(u"z")) < ProxyId(u"b", u"1"));
}

TEST(ProxyIdentifier, IsOrderedByModelForOneElement)
{
    ProxyId const left(u"uuid", u"1", ustring(u"a"));
    ProxyId const right(u"uuid", u"1", ustring(u"b"));

    EXPECT_TRUE(left < right);
    EXPECT_FALSE(right < left);
    EXPECT_FALSE(left == right);
}

TEST(ProxyIdentifier, TakesAnAbsentModelForAnEmptyOne)
{
    ProxyId const absent(u"uuid", u"1");
    ProxyId const empty(u"uuid", u"1", ustring());
    ProxyId const named(u"uuid", u"1", ustring(u"m"));

    EXPECT_FALSE(absent < empty);
    EXPECT_FALSE(empty < absent);
    EXPECT_TRUE(absent == empty);
    EXPECT_TRUE(absent < named);
    EXPECT_FALSE(named < absent);
    EXPECT_FALSE(absent == named);
}

TEST(ProxyIdentifier, KeepsWhetherThereIsAModel)
{
    EXPECT_FALSE(ProxyId(u"uuid", u"1").getModelId());
    EXPECT_FALSE(ProxyId().getModelId());
    EXPECT_EQ(*ProxyId(ElementId(u"isbn", u"1"), ustring(u"m")).getModelId(), u"m");
    EXPECT_EQ(ProxyId(ElementId(u"isbn", u"1"), ustring(u"m")).getType(), u"isbn");
}

void expectParts(ustring const& text, ustring const& prefix, ustring const& scheme,
                 ustring const& path)
{
    ModelId const id = ModelId::parse(text);

    EXPECT_EQ(id.prefix, prefix) << ::testing::PrintToString(text);
    EXPECT_EQ(id.scheme, scheme) << ::testing::PrintToString(text);
    EXPECT_EQ(id.path, path) << ::testing::PrintToString(text);
}

TEST(ModelIdentifier, IsTakenApartWithAndWithoutPrefix)
{
    expectParts(u"memory://3", u"", u"memory", u"//3");
    expectParts(u"registry@registry://metaRegistry/model", u"registry", u"registry",
                u"//metaRegistry/model");
}

TEST(ModelIdentifier, MayHaveEmptyParts)
{
    expectParts(u":", u"", u"", u"");
    expectParts(u"@:", u"", u"", u"");
    expectParts(u"p@:x", u"p", u"", u"x");
}

TEST(ModelIdentifier, IsSplitAtTheFirstMarks)
{
    expectParts(u"a@b@c:d:e", u"a", u"b@c", u"d:e");
}

TEST(ModelIdentifier, FindsThePrefixMarkEvenInWhatWouldBeThePath)
{
    expectParts(u"file:/home/a@b:c", u"file:/home/a", u"b", u"c");
}

TEST(ModelIdentifier, NeedsAColonBehindThePrefix)
{
    EXPECT_RAISES_WITH(messages::InvalidValue, ModelId::parse(u"memory"), );
    EXPECT_RAISES(messages::InvalidValue, ModelId::parse(u""));
    EXPECT_RAISES(messages::InvalidValue, ModelId::parse(u"prefix@memory"));
    EXPECT_RAISES(messages::InvalidValue, ModelId::parse(u"memory://3@x"));
}
}  // namespace
