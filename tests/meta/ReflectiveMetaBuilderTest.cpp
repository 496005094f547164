// How builders of metamodel elements are driven by the properties that the metamodel describes.
#include "tarnkiln/kernel/Value.h"
#include "tests/meta/MetaBuilders.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <boost/date_time/gregorian/greg_date.hpp>
#include <boost/date_time/posix_time/ptime.hpp>

namespace tarn::kiln::meta {

using testkit::uuidOf;

class ReflectiveMetaBuilder : public MetamodelSketch
{
protected:
    /// The stored properties of a class, with those of its superclasses.
    static std::vector<Property> storedProperties(Class const& metaClass)
    {
        std::vector<Property> result;
        for (Class at = metaClass; at; at = at->getSuperclass())
            for (ModelElement const& element : at->getOwnedAttributes().getAllValues())
                if (!Property::cast(element)->isDerived())
                    result.push_back(Property::cast(element));
        return result;
    }
    static Property property(Class const& metaClass, ustring const& name)
    {
        return metaClass->getPropertyByName(name);
    }

    /// A value that no property has at first.
    Value sample(Property const& property) const
    {
        ustring const type = property->getType()->getQualifiedName();
        if (type == u"String")
            return Value::createPrimitiveValue(property, ustring(u"sample"));
        if (type == u"StdString")
            return Value::createPrimitiveValue(property, string("sample"));
        if (type == u"Integer")
            return Value::createPrimitiveValue(property, 7);
        if (type == u"UnlimitedNatural")
            return Value::createPrimitiveValue(property, 7u);
        if (type == u"UInteger64")
            return Value::createPrimitiveValue(property, 7ul);
        if (type == u"Real")
            return Value::createPrimitiveValue(property, 7.5);
        if (type == u"UUID")
            return Value::createPrimitiveValue(property, uuidOf(7));
        if (type == u"DateTime")
            return Value::createPrimitiveValue(
                property, boost::posix_time::ptime(boost::gregorian::date(2007, 7, 7)));
        if (type == u"Boolean")
            return Value::createPrimitiveValue(property, property->getDefaultValue() !=
                                                             boost::optional<ustring>(u"true"));
        return Value::createElementValue(property, targetOf(property)->create());
    }
    /// Builds something that the property may refer to or hold.
    std::unique_ptr<ModelElement::Builder> targetOf(Property const& property) const
    {
        Class const type = Class::cast(property->getType());
        if (type->isAbstract())
            return StringAttribute::metaClass()->instantiateBuilder(m_model);
        return type->instantiateBuilder(m_model);
    }
    /// Gives a builder some value of the property.
    Value give(ModelElement::Builder& builder, Property const& property) const
    {
        Value const value = sample(property);
        builder.setOrAdd(property, value);
        return value;
    }
    static Value read(ModelElement const& element, Property const& property)
    {
        return element->getPropertyValue(property, ModelElement::Impl::PRIVILEGED_ACCESS);
    }
    static bool isClassTyped(Property const& property)
    {
        return static_cast<bool>(Class::cast(property->getType()));
    }
};

template <class C> class ReflectiveBuilderOf : public ReflectiveMetaBuilder
{};

TYPED_TEST_SUITE(ReflectiveBuilderOf, ConcreteMetaClasses);

TYPED_TEST(ReflectiveBuilderOf, IsInTheRegistry)
{
    std::unique_ptr<ModelElement::Builder> const builder =
        TypeParam::metaClass()->instantiateBuilder(this->m_model);

    ASSERT_TRUE(builder);
    EXPECT_EQ(builder->getMetaClass(), TypeParam::metaClass());
    EXPECT_TRUE(TypeParam::cast(TypeParam::metaClass()->instantiate(this->m_model, uuidOf(1))));
    EXPECT_TRUE(TypeParam::cast(this->m_model->findElement(uuidOf(1))));
}

TYPED_TEST(ReflectiveBuilderOf, TakesEverySingleValue)
{
    for (Property const& property : this->storedProperties(TypeParam::metaClass()))
    {
        if (property->getUpper() != 1)
            continue;
        SCOPED_TRACE(::testing::PrintToString(property->identifier()));
        typename TypeParam::Builder builder(this->m_model);

        Value const given = this->give(builder, property);
        EXPECT_TRUE(builder.isSet(static_cast<unsigned long>(property->getPropertyIndex())));
        ModelElement const made = builder.create();

        bool const isOptional = property->getLower() == 0 && !this->isClassTyped(property);
        Value const kept = this->read(made, property);
        if (isOptional)
            EXPECT_FALSE(kept.isAbsent());
        else
            EXPECT_EQ(kept, given);
    }
    this->expectConsistent();
}

TYPED_TEST(ReflectiveBuilderOf, AddsToEveryManyValuedProperty)
{
    for (Property const& property : this->storedProperties(TypeParam::metaClass()))
    {
        if (property->getUpper() == 1)
            continue;
        SCOPED_TRACE(::testing::PrintToString(property->identifier()));
        typename TypeParam::Builder builder(this->m_model);

        if (!this->isClassTyped(property))
        {
            this->give(builder, property);
            this->give(builder, property);
            ModelElement const made = builder.create();
            EXPECT_EQ(
                this->read(made, property).template getValue<AbstractPrimitiveCollection&>().size(),
                2u);
            continue;
        }
        builder.setOrAdd(property, this->targetOf(property));
        ModelElement const made = builder.create();

        std::vector<ModelElement> const held =
            this->read(made, property).template getValue<ReferenceCollection&>().getAllValues();
        ASSERT_EQ(held.size(), 1u);
        EXPECT_EQ(held[0]->container(), made);
        EXPECT_EQ(held[0]->containmentFeature(), property);
        EXPECT_TRUE(builder.isSet(static_cast<unsigned long>(property->getPropertyIndex())));
    }
    this->expectConsistent();
}

TYPED_TEST(ReflectiveBuilderOf, RefusesDerivedPropertiesAndThoseOfOtherClasses)
{
    typename TypeParam::Builder builder(this->m_model);
    ustring const name = TypeParam::metaClass()->getQualifiedName();
    Property const derived = this->property(Package::metaClass(), u"qualifiedName");
    Property const foreign = this->property(AttributeMap::metaClass(), u"owner");

    EXPECT_RAISES_WITH(messages::NoSuchProperty, builder.setOrAdd(derived, this->sample(derived)),
                       u"qualifiedName", name);
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder.setOrAdd(foreign, Value::createEmptyValue(foreign)), u"owner", name);
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder.setOrAdd(Property(), this->sample(derived)), u"", name);
}

TEST_F(ReflectiveMetaBuilder, OfAnAbstractClassMakesNothing)
{
    Attribute::Builder builder(m_model);

    EXPECT_RAISES_WITH(messages::NoSuchOperation, builder.create(), u"create",
                       u"tarn.kiln.meta.Attribute");

    EXPECT_FALSE(Attribute::metaClass()->instantiateBuilder(m_model));
    EXPECT_FALSE(Attribute::metaClass()->instantiate(m_model, UUID{}));
    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
}

TEST_F(ReflectiveMetaBuilder, RefusesAsANestedBuilderThatOfAnAbstractClass)
{
    AttributeMap::Builder builder(m_model);
    builder.addAttributes(std::make_unique<Attribute::Builder>());

    EXPECT_RAISES_WITH(messages::NoSuchOperation, builder.create(), u"create",
                       u"tarn.kiln.meta.Attribute");

    EXPECT_EQ(m_model->getElementCount(), 0u);
}

TEST_F(ReflectiveMetaBuilder, TakesBuildersOfSubclassesOnly)
{
    Property const ownedTypes = property(Package::metaClass(), u"ownedTypes");
    Package::Builder builder(m_model);

    builder.setOrAdd(ownedTypes, std::make_unique<Class::Builder>());
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder.setOrAdd(ownedTypes, std::unique_ptr<ModelElement::Builder>(
                                                        std::make_unique<EnumLiteral::Builder>())),
                       u"ownedTypes", u"tarn.kiln.meta.Package");

    EXPECT_EQ(Package::cast(builder.create())->getOwnedTypes().size(), 1u);
}

TEST_F(ReflectiveMetaBuilder, SkipsTheDisplaySettingsRightsOfAccess)
{
    Property const hidden = property(Package::metaClass(), u"defaultVobjCategory");
    Package::Builder builder(m_model);

    builder.setOrAdd(hidden, sample(hidden));

    EXPECT_EQ(Package::cast(builder.create())->getDefaultVobjCategory().value(), "sample");
}

TEST_F(ReflectiveMetaBuilder, StandsInForElementsOfMetamodels)
{
    ModelElement const proxy = ModelElement::createProxy(
        m_model, EnumLiteral::metaClass(), ProxyId(ElementId::UUID_TYPE, u"x", ustring(u"y")));

    EXPECT_TRUE(EnumLiteral::cast(proxy));
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_RAISES(messages::CannotModifyProxy, EnumLiteral::cast(proxy)->setValue(1));
    EXPECT_RAISES_WITH(messages::NoSuchType,
                       ModelElement::createProxy(m_model, Attribute::metaClass(), ProxyId()),
                       u"tarn.kiln.meta.Attribute");
}
}  // namespace tarn::kiln::meta
