// How a generated metamodel stands in the registry.
#include "shapes/BellImpl.h"
#include "shapes/DefaultsImpl.h"
#include "shapes/Money.h"
#include "shapes/NodeBuilder.h"
#include "shapes/VaultImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/SchemaBase.h"
#include "tests/generated/ShapesFixture.h"

#include <gmock/gmock.h>

namespace testkit::shapes {
namespace {

using meta::MetaRegistry;
using ::testing::ElementsAre;
using GeneratedPackage = ShapesTest;

TEST_F(GeneratedPackage, IsFoundByItsUriAndFamily)
{
    meta::Package const root = ShapesMetaPackage::getInstance().getRootPackage();

    EXPECT_EQ(root->getUri(), meta::SchemaBase + u"shapes/1");
    EXPECT_EQ(root->getUuid(), (UUID{{0x4a, 0x0f, 0x6c, 0x1e, 0x64, 0xc2, 0x4c, 0x0e, 0x9d, 0x15,
                                      0x7e, 0x31, 0xc5, 0x4f, 0x2b, 0x01}}));
    EXPECT_EQ(MetaRegistry::getInstance().getRootPackage(root->getUri()), root);
    EXPECT_EQ(MetaRegistry::getInstance().getPackageForFamily(u"shapes"), root);
}

TEST_F(GeneratedPackage, RegistersItsTypesByTheirQualifiedNames)
{
    ShapesMetaPackage const& package = ShapesMetaPackage::getInstance();
    MetaRegistry const& registry = MetaRegistry::getInstance();

    EXPECT_EQ(registry.getClass(u"shapes.Node"), Node::metaClass());
    EXPECT_EQ(registry.getType(u"shapes.Colour"), package.getEnum(rows::enumerations::Colour));
    EXPECT_EQ(registry.getType(u"shapes.Money"), package.getDataType(rows::dataTypes::Money));
    EXPECT_EQ(Node::create(m_model)->getMetaClass(), Node::metaClass());
}

TEST_F(GeneratedPackage, DescribesItsClassesAsTheyAre)
{
    meta::Property const named = property(Node::metaClass(), u"named");
    meta::Property const once = property(Vault::metaClass(), u"once");

    EXPECT_EQ(named->getPropertyIndex(), static_cast<int>(Node::Impl::NAMED.index));
    EXPECT_TRUE(named->isComposite());
    EXPECT_EQ(named->getOpposite(), property(Node::metaClass(), u"scope"));
    EXPECT_EQ(named->getQualifiedBy(), property(Node::metaClass(), u"name"));
    EXPECT_FALSE(property(Node::metaClass(), u"grouped")->isQualificationUnique());
    EXPECT_TRUE(once->isReadOnly());
    EXPECT_TRUE(once->isSetOnce());
    EXPECT_FALSE(property(Vault::metaClass(), u"hidden")->isPublicAccessor());
    EXPECT_TRUE(property(Defaults::metaClass(), u"natural")->getDefaultValue() == ustring(u"-1"));
    EXPECT_TRUE(Guarded::metaClass()->isAbstract());
    EXPECT_EQ(Vault::metaClass()->getSuperclass(), Guarded::metaClass());
    EXPECT_EQ(Vault::metaClass()->getVobjName(), "shapes.Vault");
}

TEST_F(GeneratedPackage, KeepsHowItsObjectsAreDisplayed)
{
    ShapesMetaPackage const& package = ShapesMetaPackage::getInstance();
    meta::Class const& bell = Bell::metaClass();
    meta::DataType const& money = package.getDataType(rows::dataTypes::Money);
    meta::Property const strokes = property(bell, u"strokes");

    EXPECT_EQ(package.getRootPackage()->getDefaultVobjCategory().value(), "Other");
    EXPECT_EQ(bell->getVobjName(), "BellObject");
    EXPECT_TRUE(bell->isVobjHidden());
    EXPECT_TRUE(bell->getVobjCompactDisplay());
    EXPECT_THAT(bell->getVobjDispCategories(), ElementsAre("Sound", "Place"));
    EXPECT_EQ(strokes->getVobjDispCategory().value(), "Sound");
    EXPECT_TRUE(strokes->getVobjDispSkipEmpty());
    EXPECT_TRUE(strokes->isVobjHidden());
    EXPECT_TRUE(money->getVobjCompactDisplay());
    EXPECT_FALSE(money->isVobjHidden());
    EXPECT_THAT(money->getVobjDispCategories(), ElementsAre("Sum"));
    EXPECT_TRUE(package.getEnum(rows::enumerations::Colour)->isVobjHidden());
}

TEST_F(GeneratedPackage, DisplaysEverythingUnlessTold)
{
    meta::Class const& node = Node::metaClass();
    meta::Property const name = property(node, u"name");

    EXPECT_FALSE(node->isVobjHidden());
    EXPECT_FALSE(node->getVobjCompactDisplay());
    EXPECT_EQ(node->getVobjDispCategories().size(), 0u);
    EXPECT_FALSE(name->isVobjHidden());
    EXPECT_FALSE(name->getVobjDispCategory());
    EXPECT_FALSE(name->getVobjDispSkipEmpty());
}

TEST_F(GeneratedPackage, AgreesWithItsElementsOnDefaults)
{
    Defaults const element = Defaults::create(m_model);

    for (auto const& [name, property] : Defaults::metaClass()->getOwnedAttributes())
    {
        if (property->isDynamicDefault())
            continue;
        boost::optional<Value> const expected = property->defaultValue();
        Value const actual = element->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS);
        ASSERT_TRUE(expected);
        EXPECT_TRUE(property->getLower() == 0 || *expected == actual)
            << string(name.begin(), name.end());
    }
}

TEST_F(GeneratedPackage, BuildsElementsByReflection)
{
    auto builder = MetaRegistry::getInstance().instantiateBuilder(Node::metaClass(), m_model);
    ASSERT_TRUE(builder);
    auto child = std::make_unique<Node::Builder>();
    child->setName(u"child");

    builder->setOrAdd(property(Node::metaClass(), u"name"),
                      Value(meta::StandardTypes::stringMeta, ustring(u"parent")));
    builder->setOrAdd(property(Node::metaClass(), u"named"), std::move(child));
    Node const parent = Node::cast(builder->create());

    EXPECT_EQ(parent->getName(), u"parent");
    EXPECT_EQ(parent->getNamed().find(u"child")->getScope(), parent);
}

TEST_F(GeneratedPackage, BuildsNoElementsOfAbstractClasses)
{
    EXPECT_FALSE(MetaRegistry::getInstance().instantiateBuilder(Guarded::metaClass(), m_model));
}

TEST_F(GeneratedPackage, MakesCollectionsForPropertiesOfOtherClasses)
{
    std::unique_ptr<AbstractOwnedCollection> const nodes(
        MetaRegistry::getInstance().instantiateDynamicCollection(
            ModelElement(), property(Node::metaClass(), u"links")));

    EXPECT_TRUE(dynamic_cast<ElementSequence<Node>*>(nodes.get()));
}

TEST_F(GeneratedPackage, TakesValuesOfDataTypesApart)
{
    meta::DataType const type =
        ShapesMetaPackage::getInstance().getDataType(rows::dataTypes::Money);
    meta::Property const amount = type->getPropertyByName(u"amount");
    auto const* const serializer =
        meta::PropertySerializerRegistry::getInstance().getDatatypeSerializer(type);
    ASSERT_TRUE(serializer);

    Value const changed = serializer->setPropertyValue(
        serializer->createDefaultValue(), amount, Value(meta::StandardTypes::integer64Meta, 5L));

    EXPECT_EQ(changed.getValue<Money>().getAmount(), 5);
    EXPECT_EQ(changed.getValue<Money>().getCurrency(), u"EUR");
    EXPECT_EQ(serializer->getPropertyValue(changed, amount).getValue<long>(), 5);
}

TEST_F(GeneratedPackage, WritesLiteralsInThreeForms)
{
    meta::Enum const colour = ShapesMetaPackage::getInstance().getEnum(rows::enumerations::Colour);
    auto const& registry = meta::PropertySerializerRegistry::getInstance();
    Value const red(colour, 3L);

    EXPECT_EQ(registry.getPropertySerializer(colour, "")->serializeValue(red), u"red");
    EXPECT_EQ(registry.getPropertySerializer(colour, "ID")->serializeValue(red), u"3");
    EXPECT_EQ(registry.getPropertySerializer(colour, "PublicID")->serializeValue(red), u"R");
    EXPECT_TRUE(
        registry.getPropertySerializer(colour, "")->parseValue(u"new", colour).getEnumNumber() ==
        -1L);
    EXPECT_EQ(colour->findLiteralByValue(4)->getName(), u"green");
}
}  // namespace
}  // namespace testkit::shapes
