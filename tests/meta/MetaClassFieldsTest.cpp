#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/BooleanAttributeImpl.h"
#include "tarnkiln/meta/DateTimeAttributeImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/IntegerAttributeImpl.h"
#include "tarnkiln/meta/RealAttributeImpl.h"
#include "tarnkiln/meta/StringAttributeImpl.h"
#include "tarnkiln/meta/UUIDAttributeImpl.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {

using MetaClassFields = MetamodelSketch;

TEST_F(MetaClassFields, OfAPropertyStartAsATypeThatNothingIsKnownOf)
{
    Property const property = Property::create(m_model);

    EXPECT_EQ(property->getName(), u"");
    EXPECT_FALSE(property->getType());
    EXPECT_EQ(property->getLower(), 0u);
    EXPECT_EQ(property->getUpper(), 0u);
    EXPECT_FALSE(property->isOrdered());
    EXPECT_FALSE(property->isDerived());
    EXPECT_FALSE(property->isComposite());
    EXPECT_FALSE(property->isReadOnly());
    EXPECT_FALSE(property->isUnique());
    EXPECT_FALSE(property->hasQualifiedBy());
    EXPECT_FALSE(property->getCustomQualification());
    EXPECT_TRUE(property->isQualificationUnique());
    EXPECT_FALSE(property->hasOpposite());
    EXPECT_EQ(property->getPropertyIndex(), 0);
    EXPECT_TRUE(property->isPublicAccessor());
    EXPECT_TRUE(property->isPublicMutator());
    EXPECT_FALSE(property->isTransient());
    EXPECT_FALSE(property->isSparse());
    EXPECT_FALSE(property->hasOwningType());
    EXPECT_FALSE(property->getVobjDispCategory().has_value());
    EXPECT_FALSE(property->getVobjDispSkipEmpty());
    EXPECT_FALSE(property->isSetOnce());
    EXPECT_FALSE(property->isVobjHidden());
    EXPECT_FALSE(property->getDefaultValue().has_value());
    EXPECT_FALSE(property->isQueryIndex());
}

TEST_F(MetaClassFields, OfOtherClassesStartWithTheirDefaults)
{
    Operation const operation = Operation::create(m_model);

    EXPECT_TRUE(operation->isPublic());
    EXPECT_FALSE(operation->isStatic());
    EXPECT_FALSE(operation->isEvent());
    EXPECT_FALSE(operation->isAbstract());
    EXPECT_TRUE(Argument::create(m_model)->isInput());
    EXPECT_EQ(EnumLiteral::create(m_model)->getValue(), 0);
    EXPECT_EQ(DynamicExtensions::create(m_model)->getModelID(), 0u);
    EXPECT_FALSE(BooleanAttribute::create(m_model)->getValue());
    EXPECT_EQ(IntegerAttribute::create(m_model)->getValue(), 0);
    EXPECT_EQ(RealAttribute::create(m_model)->getValue(), 0.0);
    EXPECT_EQ(StringAttribute::create(m_model)->getValue(), u"");
    EXPECT_TRUE(UUIDAttribute::create(m_model)->getValue().is_nil());
    EXPECT_TRUE(DateTimeAttribute::create(m_model)->getValue().is_not_a_date_time());
    EXPECT_FALSE(AttributeMapAttribute::create(m_model)->hasValue());
}

TEST_F(MetaClassFields, KeepWhatTheyAreGiven)
{
    Class const owner = cls(u"Book");
    Property const title = property(u"title", owner);
    Property const other = property(u"other", owner);

    title->setType(owner);
    title->setLower(1);
    title->setUpper(0xFFFFFFFF);
    title->setIsOrdered(true);
    title->setOpposite(other);
    title->setQualifiedBy(other);
    title->setPropertyIndex(7);
    title->setIsPublicAccessor(false);
    title->setDefaultValue(ustring(u"none"));

    EXPECT_EQ(title->getType(), owner);
    EXPECT_EQ(title->getLower(), 1u);
    EXPECT_EQ(title->getUpper(), 0xFFFFFFFFu);
    EXPECT_TRUE(title->isOrdered());
    EXPECT_EQ(title->getOpposite(), other);
    EXPECT_EQ(title->getOppositeImpl(), other.getImpl());
    EXPECT_TRUE(title->hasQualifiedBy());
    EXPECT_EQ(title->getPropertyIndex(), 7);
    EXPECT_FALSE(title->isPublicAccessor());
    EXPECT_EQ(title->getDefaultValue().value(), u"none");
    EXPECT_EQ(title->getOwningType(), owner);
}

TEST_F(MetaClassFields, NumberTheirSlotsDownTheChainOfSuperclasses)
{
    EXPECT_EQ(NamedElement::Impl::NAME.index, 1u);
    EXPECT_EQ(TypedElement::Impl::IS_ORDERED.index, 5u);
    EXPECT_EQ(Property::Impl::IS_DERIVED.index, 6u);
    EXPECT_EQ(Property::Impl::SLOTS, 26u);
    EXPECT_EQ(Extension::Impl::OWNER.index, 26u);
    EXPECT_EQ(Extension::Impl::SLOTS, 27u);
    EXPECT_EQ(Package::Impl::URI.index, 4u);
    EXPECT_EQ(Package::Impl::SLOTS, 8u);
}

TEST_F(MetaClassFields, CastOnlyToTheirOwnClasses)
{
    Class const book = cls(u"Book");

    EXPECT_EQ(Class::cast(book), book);
    EXPECT_EQ(Type::cast(book), book);
    EXPECT_FALSE(Enum::cast(book));
    EXPECT_FALSE(Class::cast(ModelElement()));
}

TEST_F(MetaClassFields, CanNotBeChangedOnAStandIn)
{
    Property const proxy(new Property::Impl(m_model, UUID()));
    proxy->_becomeProxy(ProxyId(u"uuid", u"p"), ElementImpl::ElementValidity::BuilderProxy);
    Class const other(new Class::Impl(m_model, UUID()));
    other->_becomeProxy(ProxyId(u"uuid", u"c"), ElementImpl::ElementValidity::BuilderProxy);

    EXPECT_RAISES(messages::CannotModifyProxy, proxy->setLower(1));
    EXPECT_RAISES(messages::CannotModifyProxy, proxy->setLower(0));
    EXPECT_RAISES(messages::CannotModifyProxy, proxy->setName(u"x"));
    EXPECT_RAISES(messages::CannotModifyProxy, other->getOwnedAttributes());
    proxy->setName(u"");
}

TEST_F(MetaClassFields, OfADeadElementStayAsTheyAre)
{
    Property const property = Property::create(m_model);
    property->setLower(1);
    property->destroy();

    property->setLower(2);
    property->setName(u"x");

    EXPECT_EQ(property->getLower(), 1u);
    EXPECT_EQ(property->getName(), u"");
}

TEST_F(MetaClassFields, AreNotChangedWhileTheModelIsFrozen)
{
    Property const property = Property::create(m_model);
    Model::Freezer const freezer = m_model->freeze();

    property->setLower(0);
    EXPECT_RAISES(messages::ModelFrozen, property->setLower(1));

    EXPECT_EQ(property->getLower(), 0u);
}
}  // namespace tarn::kiln::meta
