// How elements of metamodels are described by builders and made.
#include "tarnkiln/kernel/Freezer.h"
#include "tests/meta/MetaBuilders.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Uuids.h"

#include <boost/date_time/gregorian/greg_date.hpp>
#include <boost/optional/optional_io.hpp>

namespace tarn::kiln::meta {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testkit::uuidOf;
using Orchestrator = ModelElement::Builder::Orchestrator;

class MetaBuilder : public MetamodelSketch
{
protected:
    template <class C> static std::unique_ptr<typename C::Builder> nested(ustring const& name)
    {
        auto builder = std::make_unique<typename C::Builder>();
        builder->setName(name);
        return builder;
    }
    template <class C> static C build(typename C::Builder& builder)
    {
        return C::cast(builder.create());
    }
};

using MetaBuilderFields = MetaBuilder;
using MetaBuilderContents = MetaBuilder;
using MetaBuilderFailures = MetaBuilder;

// ---------------------------------------------------------------------------- all properties

TEST_F(MetaBuilderFields, ReachAPackage)
{
    Package const parent = package(u"outer");
    Package::Builder builder(m_model);
    builder.setName(u"inner").setUri(u"uri").setParentPackage(parent).setDefaultVobjCategory("c");
    builder.addImportedPackageURIs(u"one").addImportedPackageURIs({u"two", u"one"});

    Package const made = build<Package>(builder);

    EXPECT_EQ(made->getQualifiedName(), u"outer.inner");
    EXPECT_EQ(made->getUri(), u"uri");
    EXPECT_EQ(made->getParentPackage(), parent);
    EXPECT_EQ(parent->getNestedPackages().find(u"inner"), made);
    EXPECT_EQ(made->getDefaultVobjCategory(), string("c"));
    EXPECT_THAT(made->getImportedPackageURIs().getEntries(), ElementsAre(u"one", u"two", u"one"));
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachAClass)
{
    Package const owner = package(u"p");
    Class const above = cls(u"Above");
    Class::Builder builder(m_model);
    builder.setSuperclass(above).setIsAbstract(true);
    builder.setVobjName("b.Book").setVobjCompactDisplay(true).addVobjDispCategories({"x", "y"});
    builder.setIsVobjHidden(true).setOwningPackage(owner);
    builder.setName(u"Book");

    Class const made = build<Class>(builder);

    EXPECT_EQ(made->getSuperclass(), above);
    EXPECT_TRUE(made->isAbstract());
    EXPECT_EQ(made->getVobjName(), "b.Book");
    EXPECT_TRUE(made->getVobjCompactDisplay());
    EXPECT_THAT(made->getVobjDispCategories().getEntries(), ElementsAre("x", "y"));
    EXPECT_TRUE(made->isVobjHidden());
    EXPECT_EQ(owner->getOwnedTypes().find(u"Book"), made);
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachAProperty)
{
    Class const owner = cls(u"Book");
    Property const other = property(u"other", owner);
    Property::Builder builder(m_model);
    builder.setIsDerived(true).setIsComposite(true).setIsReadOnly(true).setIsUnique(true);
    builder.setQualifiedBy(other).setCustomQualification(true).setIsQualificationUnique(false);
    builder.setOpposite(other).setPropertyIndex(3).setIsPublicAccessor(false);
    builder.setIsPublicMutator(false).setIsTransient(true).setIsSparse(true).setOwningType(owner);
    builder.setVobjDispCategory("group").setVobjDispSkipEmpty(true).setIsSetOnce(true);
    builder.setIsVobjHidden(true).setDefaultValue(u"7").setIsQueryIndex(true);
    builder.setType(owner).setLower(1).setUpper(0xFFFFFFFF).setIsOrdered(true).setName(u"title");

    Property const made = build<Property>(builder);

    EXPECT_TRUE(made->isDerived());
    EXPECT_TRUE(made->isComposite());
    EXPECT_TRUE(made->isReadOnly());
    EXPECT_TRUE(made->isUnique());
    EXPECT_EQ(made->getQualifiedBy(), other);
    EXPECT_TRUE(made->getCustomQualification());
    EXPECT_FALSE(made->isQualificationUnique());
    EXPECT_EQ(made->getOpposite(), other);
    EXPECT_EQ(made->getPropertyIndex(), 3);
    EXPECT_FALSE(made->isPublicAccessor());
    EXPECT_FALSE(made->isPublicMutator());
    EXPECT_TRUE(made->isTransient());
    EXPECT_TRUE(made->isSparse());
    EXPECT_EQ(made->getOwningType(), owner);
    EXPECT_EQ(made->getVobjDispCategory(), string("group"));
    EXPECT_TRUE(made->getVobjDispSkipEmpty());
    EXPECT_TRUE(made->isSetOnce());
    EXPECT_TRUE(made->isVobjHidden());
    EXPECT_EQ(made->getDefaultValue().value(), u"7");
    EXPECT_TRUE(made->isQueryIndex());
    EXPECT_EQ(made->getType(), owner);
    EXPECT_EQ(made->getLower(), 1u);
    EXPECT_EQ(made->getUpper(), 0xFFFFFFFFu);
    EXPECT_TRUE(made->isOrdered());
    EXPECT_EQ(owner->getPropertyByName(u"title"), made);
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachAnOperationAndAnArgument)
{
    Class const owner = cls(u"Book");
    Operation::Builder builder(m_model);
    builder.setIsAbstract(true).setIsStatic(true).setIsPublic(false).setIsEvent(true);
    builder.setOwningType(owner).setName(u"open");
    Operation const operation = build<Operation>(builder);
    Argument::Builder argument(m_model);
    argument.setOperation(operation).setIsInput(false).setName(u"page");

    Argument const made = build<Argument>(argument);

    EXPECT_TRUE(operation->isAbstract());
    EXPECT_TRUE(operation->isStatic());
    EXPECT_FALSE(operation->isPublic());
    EXPECT_TRUE(operation->isEvent());
    EXPECT_EQ(operation->getOwningType(), owner);
    EXPECT_FALSE(made->isInput());
    EXPECT_EQ(made->getOperation(), operation);
    EXPECT_THAT(operation->getArguments().getAllValues(), ElementsAre(made));
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachAnEnumerationAndALiteral)
{
    PrimitiveType::Builder integer(m_model);
    integer.setName(u"Integer");
    PrimitiveType const underlying = build<PrimitiveType>(integer);
    Enum::Builder builder(m_model);
    builder.setUnderlyingType(underlying).setName(u"Colour");
    Enum const colour = build<Enum>(builder);
    EnumLiteral::Builder literal(m_model);
    literal.setValue(-3).setParentEnum(colour).setPublicIdentifier(u"RED").setName(u"red");

    EnumLiteral const made = build<EnumLiteral>(literal);

    EXPECT_EQ(colour->getUnderlyingType(), underlying);
    EXPECT_EQ(made->getValue(), -3);
    EXPECT_EQ(made->getPublicIdentifier().value(), u"RED");
    EXPECT_EQ(colour->findLiteralByValue(-3), made);
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachExtensionsAndTheirGroup)
{
    Class const owner = cls(u"Book");
    DynamicExtensions::Builder builder(m_model);
    builder.setModelID(5).setOwningClass(owner);
    DynamicExtensions const group = build<DynamicExtensions>(builder);
    Extension::Builder extension(m_model);
    extension.setOwner(group).setDefaultValue(boost::none).setName(u"shelf");

    Extension const made = build<Extension>(extension);

    EXPECT_EQ(group->getModelID(), 5u);
    EXPECT_EQ(owner->getExtensions().find(5), group);
    EXPECT_EQ(group->getExtensions().find(u"shelf"), made);
    EXPECT_EQ(made->getExtendedMetaclass(), owner);
    EXPECT_FALSE(made->getDefaultValue().has_value());
    expectConsistent();
}

TEST_F(MetaBuilderFields, ReachAttributesOfEveryKind)
{
    boost::posix_time::ptime const time(boost::gregorian::date(2001, 2, 3));
    auto const in = [this](auto&& builder, ustring const& key, AttributeMap const& map) {
        builder.setKey(key).setOwner(map);
        return builder.create();
    };
    AttributeMap::Builder outer(m_model);
    AttributeMap const map = build<AttributeMap>(outer);
    BooleanAttribute::Builder truth(m_model);
    IntegerAttribute::Builder integer(m_model);
    RealAttribute::Builder real(m_model);
    StringAttribute::Builder text(m_model);
    UUIDAttribute::Builder id(m_model);
    DateTimeAttribute::Builder date(m_model);
    AttributeMapAttribute::Builder inner(m_model);

    EXPECT_TRUE(BooleanAttribute::cast(in(truth.setValue(true), u"b", map))->getValue());
    EXPECT_EQ(IntegerAttribute::cast(in(integer.setValue(4), u"i", map))->getValue(), 4);
    EXPECT_EQ(RealAttribute::cast(in(real.setValue(2.5), u"r", map))->getValue(), 2.5);
    EXPECT_EQ(StringAttribute::cast(in(text.setValue(u"x"), u"s", map))->getValue(), u"x");
    EXPECT_EQ(UUIDAttribute::cast(in(id.setValue(uuidOf(2)), u"u", map))->getValue(), uuidOf(2));
    EXPECT_EQ(DateTimeAttribute::cast(in(date.setValue(time), u"d", map))->getValue(), time);
    AttributeMapAttribute const nested = AttributeMapAttribute::cast(
        in(inner.setValue(std::make_unique<AttributeMap::Builder>()), u"m", map));
    EXPECT_EQ(nested->getValue()->container(), nested);
    EXPECT_EQ(map->getAttributes().size(), 7u);
    expectConsistent();
}

// ---------------------------------------------------------------------------- every class

template <class C> class BuilderOfEveryClass : public MetamodelSketch
{};

TYPED_TEST_SUITE(BuilderOfEveryClass, ConcreteMetaClasses);

TYPED_TEST(BuilderOfEveryClass, MakesAnElementOfThatClass)
{
    std::unique_ptr<ModelElement::Builder> const builder =
        TypeParam::Builder::instantiate(this->m_model);

    ModelElement const made = builder->create(uuidOf(1));

    ASSERT_TRUE(TypeParam::cast(made));
    EXPECT_EQ(typeid(*made.getImpl()), typeid(typename TypeParam::Impl));
    EXPECT_EQ(this->m_model->findElement(uuidOf(1)), made);
    EXPECT_TRUE(made->isTopLevel());
    EXPECT_EQ(builder->getMetaClass(), TypeParam::metaClass());
    this->expectConsistent();
}

TYPED_TEST(BuilderOfEveryClass, MakesStandIns)
{
    ModelElement const proxy = typename TypeParam::Builder(this->m_model).createProxy(ProxyId());

    ASSERT_TRUE(TypeParam::cast(proxy));
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(this->m_model->getElementCount(), 0u);
}

// ---------------------------------------------------------------------------- contents

TEST_F(MetaBuilderContents, NestFromThePackageToTheArguments)
{
    auto open = nested<Operation>(u"open");
    open->addArguments(nested<Argument>(u"page")).addArguments(nested<Argument>(u"line"));
    auto shut = nested<Operation>(u"open");
    auto book = nested<Class>(u"Book");
    book->addOwnedAttributes(nested<Property>(u"title"));
    book->addOwnedOperations(std::move(open)).addOwnedOperations(std::move(shut));
    auto colour = nested<Enum>(u"Colour");
    colour->addLiterals(nested<EnumLiteral>(u"red")).addLiterals(nested<EnumLiteral>(u"blue"));
    auto inner = nested<Package>(u"inner");
    inner->addOwnedTypes(std::move(book)).addOwnedTypes(std::move(colour));
    Package::Builder outer(m_model);
    outer.addNestedPackages(std::move(inner)).setName(u"outer");

    Package const made = build<Package>(outer);

    Package const within = made->getNestedPackages().find(u"inner");
    ASSERT_TRUE(within);
    Class const cls = Class::cast(within->getOwnedTypes().find(u"Book"));
    ASSERT_TRUE(cls);
    EXPECT_EQ(cls->getQualifiedName(), u"outer.inner.Book");
    EXPECT_EQ(cls->getPropertyByName(u"title")->getOwningType(), cls);
    std::vector<Operation> const operations = cls->getOperationsByName(u"open");
    ASSERT_EQ(operations.size(), 2u);
    ASSERT_EQ(operations[0]->getArguments().size(), 2u);
    EXPECT_EQ(operations[0]->getArguments()[0]->getName(), u"page");
    EXPECT_EQ(operations[0]->getArguments()[1]->getName(), u"line");
    EXPECT_EQ(Enum::cast(within->getOwnedTypes().find(u"Colour"))->getLiterals().size(), 2u);
    EXPECT_THAT(m_model->getTopLevelElements(), ElementsAre(ModelElement(made)));
    EXPECT_EQ(m_model->getElementCount(), 11u);
    expectConsistent();
}

TEST_F(MetaBuilderContents, OfAClassIncludeItsExtensions)
{
    auto group = std::make_unique<DynamicExtensions::Builder>();
    group->setModelID(9).addExtensions(nested<Extension>(u"shelf"));
    Class::Builder builder(m_model);
    builder.addExtensions(std::move(group));

    Class const made = build<Class>(builder);

    DynamicExtensions const found = made->getExtensions().find(9);
    ASSERT_TRUE(found);
    EXPECT_EQ(found->getOwningClass(), made);
    EXPECT_EQ(found->getExtensions().find(u"shelf")->getExtendedMetaclass(), made);
    expectConsistent();
}

TEST_F(MetaBuilderContents, OfAnAttributeMapAreOfAnyKind)
{
    auto text = std::make_unique<StringAttribute::Builder>();
    text->setValue(u"v").setKey(u"text");
    auto deeper = std::make_unique<AttributeMap::Builder>();
    deeper->addAttributes(std::move(text));
    auto map = std::make_unique<AttributeMapAttribute::Builder>();
    map->setValue(std::move(deeper)).setKey(u"map");
    AttributeMap::Builder builder(m_model);
    builder.addAttributes(std::move(map));

    AttributeMap const made = build<AttributeMap>(builder);

    AttributeMapAttribute const inside =
        AttributeMapAttribute::cast(made->getAttributes().find(u"map"));
    ASSERT_TRUE(inside);
    EXPECT_TRUE(StringAttribute::cast(inside->getValue()->getAttributes().find(u"text")));
    expectConsistent();
}

// ---------------------------------------------------------------------------- failures

TEST_F(MetaBuilderFailures, OfAnAbstractClassMakeNothing)
{
    Attribute::Builder builder(m_model);

    EXPECT_RAISES(messages::NoSuchOperation, builder.create());
    EXPECT_RAISES(messages::NoSuchOperation, builder.createProxy(ProxyId()));

    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
}

TEST_F(MetaBuilderFailures, OfNamesThatSiblingsShareLeaveNothingBehind)
{
    auto inner = nested<Package>(u"inner");
    inner->addOwnedTypes(nested<Class>(u"Same")).addOwnedTypes(nested<Enum>(u"Same"));
    Package::Builder outer(m_model);
    outer.addNestedPackages(std::move(inner));

    EXPECT_RAISES(messages::UniquenessConstraint, outer.create());

    EXPECT_EQ(m_model->getElementCount(), 0u);
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
    expectConsistent();
}

TEST_F(MetaBuilderFailures, OfANameThatTheOwnerHasLeaveTheOwnerAsItWas)
{
    Package const owner = package(u"p");
    Class const present = cls(u"Book", {}, owner);
    Class::Builder builder(m_model);
    builder.addOwnedAttributes(nested<Property>(u"a")).setOwningPackage(owner).setName(u"Book");

    EXPECT_RAISES(messages::UniquenessConstraint, builder.create());

    EXPECT_EQ(owner->getOwnedTypes().find(u"Book"), present);
    EXPECT_EQ(m_model->getElementCount(), 2u);
    expectConsistent();
}

TEST_F(MetaBuilderFailures, InTheConstructorLeaveNothingWithTheOrchestrator)
{
    Model const elsewhere = Model::create(ModelConstellation());
    Class const foreign = Class::create(elsewhere);
    auto property = nested<Property>(u"title");
    property->setType(foreign);
    Property::Builder* const failing = property.get();
    Class::Builder builder(m_model);
    builder.addOwnedAttributes(std::move(property));
    {
        Orchestrator orchestrator(&builder);

        EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, builder.create());

        EXPECT_EQ(orchestrator.getCreatedElement(failing).getImpl(), nullptr);
        EXPECT_TRUE(orchestrator.getCreatedElement(&builder));
    }
    EXPECT_EQ(failing->getOrchestrator(), nullptr);
    EXPECT_EQ(m_model->getElementCount(), 0u);
    expectConsistent();
}

TEST_F(MetaBuilderFailures, OfAUuidThatIsTakenLeaveTheOtherElement)
{
    Class const present = Class::create(m_model, uuidOf(1));
    Class::Builder builder(m_model);

    EXPECT_RAISES(messages::UUIDConflict, builder.create(uuidOf(1)));

    EXPECT_EQ(m_model->findElement(uuidOf(1)), present);
    EXPECT_EQ(m_model->getElementCount(), 1u);
    expectConsistent();
}

TEST_F(MetaBuilderFailures, OfAFrozenModelMakeNothing)
{
    Model::Freezer const freezer = m_model->freeze();
    Class::Builder builder(m_model);

    EXPECT_RAISES(messages::ModelFrozen, builder.create());

    EXPECT_EQ(m_model->getElementCount(), 0u);
}

TEST_F(MetaBuilderFailures, DoomTheTransactionThatIsOpen)
{
    Class const book = cls(u"Book");
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    book->setName(u"Novel");
    Class::Builder builder(m_model);
    builder.addOwnedAttributes(nested<Property>(u"same"));
    builder.addOwnedAttributes(nested<Property>(u"same"));

    EXPECT_RAISES(messages::UniquenessConstraint, builder.create());

    EXPECT_TRUE(transaction.isRollBackOnly());
    EXPECT_EQ(transaction.commit(), TransactionResult::RolledBack);
    EXPECT_EQ(book->getName(), u"Book");
    EXPECT_EQ(m_model->getElementCount(), 1u);
    expectConsistent();
}
}  // namespace tarn::kiln::meta
