// Metamodels that are defined at run time, in a few lines.
#include "tarnkiln/meta/PackageDefinition.h"

#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"

#include <cstdint>

namespace tarn::kiln::meta {
namespace {

using Element = ModelElement::Impl;

/// A URI of its own for each test, since the registry lives as long as the process.
ustring freshUri()
{
    static char16_t number = u'a';
    return ustring(u"http://example.org/definition/") + number++;
}

TEST(PackageDefinition, MakesAPackageThatTheRegistryFinds)
{
    ustring const uri = freshUri();

    PackageDefinition definition(u"first", uri);
    Class const book = definition.defineClass(u"Book");
    Package const package = definition.finish();

    EXPECT_EQ(package, MetaRegistry::getInstance().getRootPackage(uri));
    EXPECT_EQ(book, MetaRegistry::getInstance().getClass(u"first.Book"));
    EXPECT_EQ(book, package->getOwnedTypes().find(u"Book"));
}

TEST(PackageDefinition, MakesWhatThreadsShareWithoutCountingIt)
{
    ustring const uri = freshUri();
    PackageDefinition definition(u"shared", uri);
    ClassDefinition newBook = definition.defineClass(u"Book");
    Property const title = newBook.attribute(u"title", StandardTypes::stringMeta);
    Class const book = newBook;
    EXPECT_FALSE(book->isPermanent());

    Package const package = definition.finish();

    EXPECT_TRUE(book->isPermanent());
    EXPECT_TRUE(title->isPermanent());
    EXPECT_TRUE(package->isPermanent());
    EXPECT_TRUE(StandardTypes::stringMeta.getElementImpl()->isPermanent());
    std::uint32_t const count = book->getRefCount();
    Class const copy = book;
    EXPECT_EQ(copy->getRefCount(), count);
}

TEST(PackageDefinition, LeavesNothingIfItIsNotFinished)
{
    ustring const uri = freshUri();
    std::size_t const before = MetaRegistry::getInstance().getModel()->getElementCount();

    {
        PackageDefinition definition(u"second", uri);
        definition.defineClass(u"Book").attribute(u"title", StandardTypes::stringMeta);
    }

    EXPECT_FALSE(MetaRegistry::getInstance().getRootPackage(uri));
    EXPECT_FALSE(MetaRegistry::getInstance().getClass(u"second.Book"));
    EXPECT_EQ(before, MetaRegistry::getInstance().getModel()->getElementCount());
}

TEST(PackageDefinition, NumbersSlotsBehindThoseOfTheSuperclass)
{
    PackageDefinition definition(u"third", freshUri());
    ClassDefinition novel = definition.defineClass(u"Novel");
    Property const genre = novel.attribute(u"genre", StandardTypes::stringMeta);
    ClassDefinition book = definition.defineClass(u"Book");
    Property const title = book.attribute(u"title", StandardTypes::stringMeta);
    Property const pages = book.attribute(u"pages", StandardTypes::integerMeta);
    Property const age = book.attribute(u"age", StandardTypes::integerMeta).derived();
    novel.extends(book);

    definition.finish();

    EXPECT_EQ(1, pages->getPropertyIndex()) << "by name";
    EXPECT_EQ(2, title->getPropertyIndex());
    EXPECT_EQ(3, genre->getPropertyIndex());
    EXPECT_EQ(0, age->getPropertyIndex());
}

TEST(PackageDefinition, SaysHowManyValuesAPropertyHas)
{
    PackageDefinition definition(u"fourth", freshUri());
    ClassDefinition book = definition.defineClass(u"Book");
    Property const title = book.attribute(u"title", StandardTypes::stringMeta);
    Property const note = book.attribute(u"note", StandardTypes::stringMeta).optional();
    Property const marks = book.attribute(u"marks", StandardTypes::integerMeta).sequence();
    Property const words = book.attribute(u"words", StandardTypes::stringMeta).many();
    Property const parts = book.contents(u"parts", book).keyedBy(title);
    Property const twins = book.reference(u"twins", book).keyedBy(title).manyPerKey();
    definition.finish();

    EXPECT_EQ(ValueFlags::Single, ValueMeta::doGetFlags(title));
    EXPECT_EQ(ValueFlags::OptionalSingle, ValueMeta::doGetFlags(note));
    EXPECT_EQ(ValueFlags::Sequence, ValueMeta::doGetFlags(marks));
    EXPECT_EQ(ValueFlags::Set, ValueMeta::doGetFlags(words));
    EXPECT_EQ(ValueFlags::Map, ValueMeta::doGetFlags(parts));
    EXPECT_TRUE(parts->isComposite());
    EXPECT_EQ(ValueFlags::Multimap, ValueMeta::doGetFlags(twins));
}

TEST(PackageDefinition, GivesClassesThatElementsCanBeMadeOf)
{
    PackageDefinition definition(u"fifth", freshUri());
    Enum const size = definition.defineEnum(u"Size", {u"Small", u"Large"});
    ClassDefinition shelf = definition.defineClass(u"Shelf");
    ClassDefinition book = definition.defineClass(u"Book");
    Property const title = book.attribute(u"title", StandardTypes::stringMeta).defaultValue(u"?");
    Property const format = book.attribute(u"format", size).defaultValue(u"Large");
    PropertyDefinition books = shelf.contents(u"books", book).keyedBy(title);
    Property const home = books.opposite(u"shelf");
    definition.finish();
    Model const model = Model::create(ModelConstellation());
    ModelElement const wall = ModelElement::createReflective(model, shelf);
    ModelElement const emma = ModelElement::createReflective(model, book);

    emma->setPropertyValue(title, Value(StandardTypes::stringMeta, ustring(u"Emma")),
                           Element::PUBLIC_ACCESS);
    emma->setPropertyValue(home, Value::createElementValue(home, wall), Element::PUBLIC_ACCESS);

    EXPECT_EQ(1, emma->getPropertyValue(format, Element::PUBLIC_ACCESS).getValue<long>());
    Value const held = wall->getPropertyValue(books, Element::PUBLIC_ACCESS);
    auto* const map = dynamic_cast<GenericMapInterface*>(
        held.getValue<ReferenceCollection&>().getGenericInterface());
    ASSERT_NE(nullptr, map);
    EXPECT_EQ(emma, map->genericFind(Value(StandardTypes::stringMeta, ustring(u"Emma"))));
    EXPECT_EQ(wall, emma->container());
    EXPECT_THAT(model->checkInvariants(), ::testing::IsEmpty());
}

TEST(PackageDefinition, RefusesANameThatIsTaken)
{
    PackageDefinition definition(u"sixth", freshUri());
    ClassDefinition book = definition.defineClass(u"Book");
    book.attribute(u"title", StandardTypes::stringMeta);

    EXPECT_RAISES(tarnkiln::messages::UniquenessConstraint, definition.defineClass(u"Book"));
    EXPECT_RAISES(tarnkiln::messages::UniquenessConstraint,
                  book.attribute(u"title", StandardTypes::integerMeta));
}

TEST(PackageDefinition, SaysWhatElseAPropertyIs)
{
    PackageDefinition definition(u"seventh", freshUri());
    ClassDefinition book = definition.defineClass(u"Book").makeAbstract();
    Property const isbn = book.attribute(u"isbn", StandardTypes::stringMeta).setOnce();
    Property const age = book.attribute(u"age", StandardTypes::integerMeta).readOnly().transient();
    Property const next = book.reference(u"next", book).sequence().unique();
    definition.finish();

    EXPECT_TRUE(Class(book)->isAbstract());
    EXPECT_TRUE(isbn->isReadOnly());
    EXPECT_TRUE(isbn->isSetOnce());
    EXPECT_TRUE(age->isReadOnly());
    EXPECT_FALSE(age->isSetOnce());
    EXPECT_TRUE(age->isTransient());
    EXPECT_TRUE(next->isOrdered());
    EXPECT_TRUE(next->isUnique());
}

TEST(PackageDefinition, LeavesNothingIfATypeOfItsNameIsRegistered)
{
    PackageDefinition first(u"eighth", freshUri());
    Class const book = first.defineClass(u"Book");
    first.finish();
    ustring const uri = freshUri();
    std::size_t const before = MetaRegistry::getInstance().getModel()->getElementCount();

    {
        PackageDefinition second(u"eighth", uri);
        second.defineClass(u"Book");
        EXPECT_RAISES_WITH(tarnkiln::messages::DuplicateTypeInRegistry, second.finish(),
                           u"eighth.Book");
    }

    EXPECT_EQ(book, MetaRegistry::getInstance().getClass(u"eighth.Book"));
    EXPECT_FALSE(MetaRegistry::getInstance().getRootPackage(uri));
    EXPECT_EQ(before, MetaRegistry::getInstance().getModel()->getElementCount());
}
}  // namespace
}  // namespace tarn::kiln::meta
