// What metamodel elements compute: qualified names, and the types of a package by kind.
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class DerivedProperty : public MetamodelSketch
{
protected:
    static Property of(ModelElement const& element, char16_t const* name)
    {
        return element->getMetaClass()->getPropertyByName(name);
    }
    static Value get(ModelElement const& element, char16_t const* name)
    {
        return element->getPropertyValue(of(element, name), ModelElement::Impl::PUBLIC_ACCESS);
    }
    static bool has(ModelElement const& element, char16_t const* name)
    {
        return element->hasPropertyValue(of(element, name), ModelElement::Impl::PUBLIC_ACCESS);
    }
    template <class Handle> Handle in(Package const& owner, ustring const& name)
    {
        Handle const made = named<Handle>(name);
        made->setOwningPackage(owner);
        return made;
    }
};

TEST_F(DerivedProperty, TellsTheQualifiedNamesOfTypesAndPackages)
{
    Package const outer = package(u"outer");
    Class const book = cls(u"Book", {}, outer);

    EXPECT_EQ(get(outer, u"qualifiedName").getValue<ustring>(), u"outer");
    EXPECT_EQ(get(book, u"qualifiedName").getValue<ustring>(), u"outer.Book");
    EXPECT_TRUE(has(book, u"qualifiedName"));
    EXPECT_TRUE(has(outer, u"qualifiedName"));
}

TEST_F(DerivedProperty, ListsTheTypesOfAPackageByKindAndName)
{
    Package const outer = package(u"outer");
    Class const shelf = in<Class>(outer, u"Shelf");
    Enum const colour = in<Enum>(outer, u"Colour");
    DataType const date = in<DataType>(outer, u"Date");
    PrimitiveType const code = in<PrimitiveType>(outer, u"Code");
    Class const book = in<Class>(outer, u"Book");

    EXPECT_THAT(outer->getClasses().getAllValues(), ElementsAre(book, shelf));
    EXPECT_THAT(outer->getEnumerations().getAllValues(), ElementsAre(colour));
    EXPECT_THAT(outer->getDataTypes().getAllValues(), ElementsAre(date));
    EXPECT_THAT(outer->getPrimitiveTypes().getAllValues(), ElementsAre(code));
    EXPECT_EQ(outer->getClasses().getCollectionType(), Class::metaClass());
    EXPECT_EQ(outer->getClasses().getCollectionFeature().property(), of(outer, u"classes"));
}

TEST_F(DerivedProperty, ShowsChangesOfThePackageAtOnce)
{
    Package const outer = package(u"outer");
    SubsettedElementSet<Class>& classes = outer->getClasses();
    EXPECT_FALSE(has(outer, u"classes"));

    Class const book = in<Class>(outer, u"Book");
    EXPECT_THAT(classes.getAllValues(), ElementsAre(book));
    EXPECT_TRUE(has(outer, u"classes"));

    book->setName(u"Volume");
    EXPECT_THAT(classes.getAllValues(), ElementsAre(book));

    book->setOwningPackage(Package());
    EXPECT_THAT(classes.getAllValues(), IsEmpty());
    EXPECT_EQ(&outer->getClasses(), &classes);
}

TEST_F(DerivedProperty, IsReadByReflectionAsACollection)
{
    Package const outer = package(u"outer");
    Class const book = in<Class>(outer, u"Book");
    in<Enum>(outer, u"Colour");

    Value const classes = get(outer, u"classes");

    EXPECT_EQ(classes.getFlags(), ValueFlags::Sequence);
    EXPECT_EQ(classes.getType(), Class::metaClass());
    EXPECT_EQ(&classes.getValue<ReferenceCollection&>(), &outer->getClasses());
    EXPECT_EQ(&get(outer, u"enumerations").getValue<ReferenceCollection&>(),
              &outer->getEnumerations());
    EXPECT_EQ(&get(outer, u"dataTypes").getValue<ReferenceCollection&>(), &outer->getDataTypes());
    EXPECT_EQ(&get(outer, u"primitiveTypes").getValue<ReferenceCollection&>(),
              &outer->getPrimitiveTypes());
    EXPECT_FALSE(has(outer, u"dataTypes"));
}

TEST_F(DerivedProperty, CanNotBeSet)
{
    Package const outer = package(u"outer");
    Class const book = in<Class>(outer, u"Book");

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       book->setPropertyValue(of(book, u"qualifiedName"),
                                              get(book, u"qualifiedName"),
                                              ModelElement::Impl::PRIVILEGED_ACCESS),
                       u"qualifiedName", u"tarn.kiln.meta.Class");
    EXPECT_RAISES(messages::NoSuchProperty,
                  outer->setPropertyValue(of(outer, u"classes"), get(outer, u"classes"),
                                          ModelElement::Impl::PRIVILEGED_ACCESS));
    auto* const generic =
        dynamic_cast<GenericSequenceInterface*>(outer->getClasses().getGenericInterface());
    ASSERT_TRUE(generic);
    EXPECT_RAISES(messages::CannotAddIncompatibleObjectSubset, generic->genericAdd(book));
    EXPECT_RAISES(messages::CannotAddIncompatibleObjectSubset, generic->genericClear());
}

TEST_F(DerivedProperty, OfAPackageHoldsNothingByItself)
{
    Package const outer = package(u"outer");
    Class const book = in<Class>(outer, u"Book");
    outer->getClasses();

    EXPECT_EQ(book->getContainment(), Feature(Package::Impl::OWNED_TYPES));
    expectConsistent();
    outer->destroy();
    EXPECT_FALSE(book);
}

TEST_F(DerivedProperty, OfAPackageIsNoneOfAStandIn)
{
    Package const proxy =
        Package::cast(ModelElement::createProxy(m_model, Package::metaClass(), ProxyId()));

    EXPECT_RAISES(messages::CannotModifyProxy, proxy->getClasses());
    EXPECT_RAISES(messages::CannotModifyProxy, proxy->getOwnedTypes());
}

TEST_F(DerivedProperty, TellsTheOwnerOfAMap)
{
    AttributeMapAttribute const attribute = AttributeMapAttribute::create(m_model);
    AttributeMap const map = AttributeMap::create(m_model);
    EXPECT_FALSE(has(map, u"owner"));

    attribute->setValue(map);

    EXPECT_TRUE(has(map, u"owner"));
    EXPECT_EQ(get(map, u"owner").getValue<ModelElement>(), attribute);
}

TEST_F(DerivedProperty, TellsTheClassThatAnExtensionExtends)
{
    Class const book = cls(u"Book");
    DynamicExtensions const group = DynamicExtensions::create(m_model);
    group->setOwningClass(book);
    Extension const shelf = named<Extension>(u"shelf");
    EXPECT_FALSE(has(shelf, u"extendedMetaclass"));

    shelf->setOwner(group);

    EXPECT_EQ(get(shelf, u"extendedMetaclass").getValue<Class>(), book);
}

TEST_F(DerivedProperty, HasNoNumber)
{
    Package const outer = package(u"outer");

    EXPECT_FALSE(outer->getPropertyByIndex(0));
    EXPECT_FALSE(outer->getPropertyByIndex(ModelElement::Impl::NO_INDEX));
    EXPECT_FALSE(outer->getPropertyByIndex(8));
}
}  // namespace
}  // namespace tarn::kiln::meta
