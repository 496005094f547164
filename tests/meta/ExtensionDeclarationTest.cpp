#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {

using PrototypeOfAnExtension = MetamodelSketch;

TEST_F(PrototypeOfAnExtension, HasItsDescription)
{
    Extension const extension = named<Extension>(u"shelf");
    extension->setType(cls(u"Shelf", {}, package(u"library")));
    extension->setLower(1);
    extension->setUpper(1);
    extension->setIsUnique(true);

    ExtensionPrototype const prototype = extension->createPrototype();

    EXPECT_EQ(prototype.getName(), u"shelf");
    EXPECT_EQ(prototype.getTypeName(), u"library.Shelf");
    EXPECT_EQ(prototype.getLower(), 1u);
    EXPECT_EQ(prototype.getUpper(), 1u);
    EXPECT_FALSE(prototype.isOrdered());
    EXPECT_TRUE(prototype.isUnique());
}

TEST_F(PrototypeOfAnExtension, KnowsNoUpperBoundAboveOne)
{
    Extension const extension = Extension::create(m_model);
    extension->setUpper(5);

    EXPECT_EQ(extension->createPrototype().getUpper(), 0xFFFFFFFFu);
}

TEST_F(PrototypeOfAnExtension, StartsFromOneOptionalValue)
{
    ExtensionPrototype const prototype;

    EXPECT_EQ(prototype.getLower(), 0u);
    EXPECT_EQ(prototype.getUpper(), 1u);
    EXPECT_FALSE(prototype.isOrdered());
    EXPECT_TRUE(prototype.isUnique());
    EXPECT_EQ(prototype.getName(), u"");
    EXPECT_EQ(prototype.getTypeName(), u"");
}

TEST_F(PrototypeOfAnExtension, HasNoTypeNameWithoutAType)
{
    EXPECT_EQ(Extension::create(m_model)->createPrototype().getTypeName(), u"");
}

TEST_F(PrototypeOfAnExtension, KeepsAnUpperBoundBelowTwo)
{
    Extension const extension = Extension::create(m_model);
    EXPECT_EQ(extension->createPrototype().getUpper(), 0u);
    extension->setUpper(1);
    EXPECT_EQ(extension->createPrototype().getUpper(), 1u);
    extension->setUpper(2);
    EXPECT_EQ(extension->createPrototype().getUpper(), 0xFFFFFFFFu);
}

class ExtensionGroup : public MetamodelSketch
{
protected:
    DynamicExtensions group(unsigned long modelID, Class const& owner = {}) const
    {
        auto const made = DynamicExtensions::create(m_model);
        made->setModelID(modelID);
        made->setOwningClass(owner);
        return made;
    }
    Extension extension(ustring const& name, DynamicExtensions const& owner)
    {
        Extension const made = named<Extension>(name);
        made->setOwner(owner);
        return made;
    }
    DynamicExtensions proxy() const
    {
        DynamicExtensions const made(new DynamicExtensions::Impl(m_model, UUID()));
        made->_becomeProxy(ProxyId(u"uuid", u"gone"), ElementImpl::ElementValidity::BuilderProxy);
        return made;
    }
};

TEST_F(ExtensionGroup, TellsExtensionsWhichClassTheyExtend)
{
    Class const book = cls(u"Book");
    Extension const shelf = extension(u"shelf", group(1, book));

    EXPECT_EQ(shelf->getExtendedMetaclass(), book);
    EXPECT_FALSE(Extension::create(m_model)->getExtendedMetaclass());
    EXPECT_FALSE(extension(u"row", group(2))->getExtendedMetaclass());
}

TEST_F(ExtensionGroup, LeavesExtensionsWithoutAClassWhenItIsDestroyed)
{
    DynamicExtensions const owner = group(1, cls(u"Book"));
    Extension const shelf = extension(u"shelf", owner);

    owner->destroy();

    EXPECT_FALSE(shelf->getExtendedMetaclass().getElementImpl());
}

TEST_F(ExtensionGroup, IsFiledUnderItsNewModel)
{
    Class const book = cls(u"Book");
    DynamicExtensions const moved = group(1, book);

    moved->setModelID(5);

    EXPECT_EQ(moved->getModelID(), 5u);
    EXPECT_FALSE(book->getExtensions().find(1));
    EXPECT_EQ(book->getExtensions().find(5), moved);
    EXPECT_EQ(moved->getOwningClass(), book);
    expectConsistent();
}

TEST_F(ExtensionGroup, IsTheOnlyOneOfItsModelAndClass)
{
    Class const book = cls(u"Book");
    DynamicExtensions const first = group(1, book);
    DynamicExtensions const second = group(2, book);
    DynamicExtensions const homeless = group(1);
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UniquenessConstraint, second->setModelID(1));
    EXPECT_RAISES(messages::UniquenessConstraint, homeless->setOwningClass(book));

    EXPECT_FALSE(transaction.isRollBackOnly());
    EXPECT_EQ(second->getModelID(), 2u);
    EXPECT_EQ(book->getExtensions().find(1), first);
    EXPECT_EQ(book->getExtensions().find(2), second);
    EXPECT_FALSE(homeless->getOwningClass());
    transaction.commit();
    expectConsistent();
}

TEST_F(ExtensionGroup, HasItsFormerModelAfterARollback)
{
    Class const book = cls(u"Book");
    DynamicExtensions const moved = group(1, book);
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    moved->setModelID(5);

    transaction.rollBack();

    EXPECT_EQ(moved->getModelID(), 1u);
    EXPECT_EQ(book->getExtensions().find(1), moved);
    EXPECT_FALSE(book->getExtensions().find(5));
    expectConsistent();
}

TEST_F(ExtensionGroup, RefusesToBeChangedThroughAStandIn)
{
    DynamicExtensions const standIn = proxy();

    EXPECT_RAISES(messages::CannotModifyProxy, standIn->setModelID(1));
    EXPECT_RAISES(messages::CannotModifyProxy, standIn->setModelID(standIn->getModelID()));
    EXPECT_RAISES(messages::CannotModifyProxy, standIn->setOwningClass(cls(u"Book")));
}

TEST_F(ExtensionGroup, ChangesNothingForTheModelItHas)
{
    DynamicExtensions const present = group(3, cls(u"Book"));
    Model::Freezer const freezer = m_model->freeze();

    present->setModelID(3);

    EXPECT_EQ(present->getModelID(), 3u);
}

TEST_F(ExtensionGroup, HasEachNameOnce)
{
    DynamicExtensions const owner = group(1, cls(u"Book"));
    DynamicExtensions const other = group(2, cls(u"Novel"));
    Extension const shelf = extension(u"shelf", owner);
    Extension const row = extension(u"row", owner);
    Extension const namesake = extension(u"shelf", other);

    EXPECT_RAISES(messages::UniquenessConstraint, row->setName(u"shelf"));
    EXPECT_RAISES(messages::UniquenessConstraint, namesake->setOwner(owner));

    EXPECT_EQ(owner->getExtensions().find(u"row"), row);
    EXPECT_EQ(owner->getExtensions().find(u"shelf"), shelf);
    EXPECT_EQ(namesake->getOwner(), other);
    expectConsistent();
}
}  // namespace tarn::kiln::meta
