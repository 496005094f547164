// How owners keep what they hold by name when the name or the owner changes.
#include "tarnkiln/meta/AttributeMapImpl.h"
#include "tarnkiln/meta/DynamicExtensionsImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/StringAttributeImpl.h"
#include "tests/meta/MetamodelSketch.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Renaming = MetamodelSketch;
using Reowning = MetamodelSketch;
using MetamodelRollback = MetamodelSketch;

TEST_F(Renaming, FilesTheElementUnderItsNewName)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);

    title->setName(u"name");

    EXPECT_FALSE(book->getOwnedAttributes().find(u"title"));
    EXPECT_EQ(book->getOwnedAttributes().find(u"name"), title);
    EXPECT_EQ(title->getOwningType(), book);
    expectConsistent();
}

TEST_F(Renaming, RefusesANameThatASiblingHas)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);
    Property const author = property(u"author", book);

    EXPECT_RAISES(messages::UniquenessConstraint, title->setName(u"author"));

    EXPECT_EQ(title->getName(), u"title");
    EXPECT_EQ(book->getOwnedAttributes().find(u"title"), title);
    EXPECT_EQ(book->getOwnedAttributes().find(u"author"), author);
}

TEST_F(Renaming, LeavesAnOuterTransactionUsableWhenItIsRefused)
{
    Class const book = cls(u"Book");
    Property const title = property(u"title", book);
    property(u"author", book);
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UniquenessConstraint, title->setName(u"author"));

    EXPECT_FALSE(transaction.isRollBackOnly());
    title->setName(u"name");
    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_EQ(title->getName(), u"name");
}

TEST_F(Renaming, WorksForEveryKindOfKeyedElement)
{
    Package const outer = package(u"outer");
    Package const inner = package(u"inner", outer);
    Class const book = cls(u"Book", {}, outer);
    Enum const colour = named<Enum>(u"Colour");
    EnumLiteral const red = literal(u"red", 1, colour);

    inner->setName(u"i");
    book->setName(u"B");
    red->setName(u"r");

    EXPECT_EQ(outer->getNestedPackages().find(u"i"), inner);
    EXPECT_EQ(outer->getOwnedTypes().find(u"B"), book);
    EXPECT_EQ(colour->getLiterals().find(u"r"), red);
    EXPECT_EQ(outer->getOwnedTypes().size(), 1u);
    expectConsistent();
}

TEST_F(Renaming, LetsOperationsShareAName)
{
    Class const book = cls(u"Book");
    Operation const lend = operation(u"lend", book);
    Operation const give = operation(u"give", book);

    give->setName(u"lend");

    EXPECT_THAT(book->getOwnedOperations().find(u"lend"), ElementsAre(lend, give));
    EXPECT_THAT(book->getOwnedOperations().find(u"give"), IsEmpty());
}

TEST_F(Renaming, ChangesTheKeyOfAnAttribute)
{
    AttributeMap const map = AttributeMap::create(m_model);
    StringAttribute const a = StringAttribute::create(m_model);
    StringAttribute const b = StringAttribute::create(m_model);
    a->setKey(u"a");
    b->setKey(u"b");
    map->getAttributes().insert(a);
    map->getAttributes().insert(b);

    EXPECT_RAISES(messages::UniquenessConstraint, a->setKey(u"b"));
    a->setKey(u"c");

    EXPECT_EQ(map->getAttributes().find(u"c"), a);
    EXPECT_FALSE(map->getAttributes().find(u"a"));
    EXPECT_EQ(a->getOwner(), map);
    EXPECT_EQ(map->getOwner(), ModelElement());
}

TEST_F(Renaming, ChangesTheModelOfAGroupOfExtensions)
{
    Class const book = cls(u"Book");
    DynamicExtensions const first = DynamicExtensions::create(m_model);
    DynamicExtensions const second = DynamicExtensions::create(m_model);
    first->setModelID(1);
    second->setModelID(2);
    first->setOwningClass(book);
    second->setOwningClass(book);

    EXPECT_RAISES(messages::UniquenessConstraint, second->setModelID(1));
    second->setModelID(3);

    EXPECT_EQ(book->getExtensions().find(3), second);
    EXPECT_FALSE(book->getExtensions().find(2));
}

TEST_F(Renaming, OfAnExtensionMindsTheGroupThatItIsIn)
{
    Class const book = cls(u"Book");
    DynamicExtensions const group = DynamicExtensions::create(m_model);
    group->setOwningClass(book);
    Extension const shelf = named<Extension>(u"shelf");
    Extension const room = named<Extension>(u"room");
    shelf->setOwner(group);
    room->setOwner(group);

    EXPECT_RAISES(messages::UniquenessConstraint, shelf->setName(u"room"));
    shelf->setName(u"board");

    EXPECT_EQ(group->getExtensions().find(u"board"), shelf);
    EXPECT_EQ(shelf->getExtendedMetaclass(), book);
    EXPECT_EQ(shelf->identifier(), u"board");
    EXPECT_FALSE(Extension::create(m_model)->getExtendedMetaclass());
}

TEST_F(Reowning, MovesTheElementBetweenTheOwnersTables)
{
    Class const book = cls(u"Book");
    Class const shelf = cls(u"Shelf");
    Property const title = property(u"title", book);

    title->setOwningType(shelf);

    EXPECT_THAT(book->getOwnedAttributes().getAllValues(), IsEmpty());
    EXPECT_EQ(shelf->getOwnedAttributes().find(u"title"), title);

    title->setOwningType(StructuredType());

    EXPECT_TRUE(title->isTopLevel());
    EXPECT_FALSE(title->hasOwningType());
    expectConsistent();
}

TEST_F(Reowning, RefusesAnOwnerThatHasTheName)
{
    Package const first = package(u"first");
    Package const second = package(u"second");
    Class const here = cls(u"Book", {}, first);
    cls(u"Book", {}, second);

    EXPECT_RAISES(messages::UniquenessConstraint, here->setOwningPackage(second));

    EXPECT_EQ(here->getOwningPackage(), first);
}

TEST_F(Reowning, RefusesToNestAPackageInItself)
{
    Package const outer = package(u"outer");
    Package const inner = package(u"inner", outer);

    EXPECT_RAISES(messages::CircularContainment, outer->setParentPackage(inner));

    EXPECT_TRUE(outer->isTopLevel());
}

TEST_F(Reowning, RefusesAnOwnerInAnotherModel)
{
    Class const book = cls(u"Book");
    Model const other = Model::createRegistryModel(u"elsewhere");
    Package const elsewhere = Package::create(other);

    EXPECT_RAISES(messages::CannotChangeModel, book->setOwningPackage(elsewhere));
}

TEST_F(MetamodelRollback, TakesBackNamesOwnersAndValues)
{
    Package const outer = package(u"outer");
    Class const book = cls(u"Book", {}, outer);
    Class const top = cls(u"Top");
    Property const title = property(u"title", book);
    title->setDefaultValue(ustring(u"none"));
    outer->getImportedPackageURIs().push_back(u"a");

    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    book->setName(u"B");
    book->setSuperclass(top);
    book->setIsAbstract(true);
    title->setOwningType(top);
    title->setName(u"t");
    title->setDefaultValue(boost::none);
    outer->getImportedPackageURIs().push_back(u"b");
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(outer->getOwnedTypes().find(u"Book"), book);
    EXPECT_FALSE(outer->getOwnedTypes().find(u"B"));
    EXPECT_FALSE(book->hasSuperclass());
    EXPECT_FALSE(book->isAbstract());
    EXPECT_EQ(book->getPropertyByName(u"title"), title);
    EXPECT_THAT(top->getOwnedAttributes().getAllValues(), IsEmpty());
    EXPECT_EQ(title->getOwningType(), book);
    EXPECT_EQ(title->getDefaultValue().value(), u"none");
    EXPECT_EQ(outer->getImportedPackageURIs().size(), 1u);
    expectConsistent();
}

TEST_F(MetamodelRollback, BringsBackADestroyedPackageWithItsContents)
{
    Package const outer = package(u"outer");
    Class const book = cls(u"Book", {}, outer);
    Property const title = property(u"title", book);

    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    outer->destroy();
    EXPECT_FALSE(title);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(outer);
    EXPECT_TRUE(title);
    EXPECT_EQ(title->identifier(), u"outer.Book.title");
    expectConsistent();
}

TEST_F(MetamodelRollback, RemovesElementsThatWereMadeMeanwhile)
{
    Package const outer = package(u"outer");

    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    Class const book = cls(u"Book", {}, outer);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_FALSE(book);
    EXPECT_THAT(outer->getOwnedTypes().getAllValues(), IsEmpty());
    expectConsistent();
}
}  // namespace tarn::kiln::meta
