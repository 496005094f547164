// Builders of elements whose classes are defined at run time.
#include "tarnkiln/meta/ReflectiveBuilder.h"

#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tests/meta/ReflectiveFixture.h"
#include "tests/support/Uuids.h"

namespace testkit {
namespace {

using meta::ClassDefinition;
using Builder = ModelElement::Builder;

/// Shelves with books, which have notes and readers; defined once.
struct Shelves
{
    static Shelves const& get()
    {
        static Shelves const shelves;
        return shelves;
    }

    meta::Class shelf, book, thing;
    meta::Property title, pages, isbn, age, marks, next, twins, books, cover, home;

private:
    Shelves()
    {
        meta::PackageDefinition definition(u"shelves", u"http://example.org/reflective-builder");
        ClassDefinition thingClass = definition.defineClass(u"Thing").makeAbstract();
        ClassDefinition bookClass = definition.defineClass(u"Book").extends(thingClass);
        title = thingClass.attribute(u"title", StandardTypes::stringMeta);
        pages = bookClass.attribute(u"pages", StandardTypes::integerMeta).optional();
        isbn = bookClass.attribute(u"isbn", StandardTypes::stringMeta).setOnce();
        age = bookClass.attribute(u"age", StandardTypes::integerMeta).derived();
        marks = bookClass.attribute(u"marks", StandardTypes::integerMeta).sequence();
        next = bookClass.reference(u"next", bookClass);
        twins = bookClass.reference(u"twins", bookClass).sequence().unique();
        cover = bookClass.contents(u"cover", bookClass);
        ClassDefinition shelfClass = definition.defineClass(u"Shelf");
        meta::PropertyDefinition all = shelfClass.contents(u"books", bookClass).keyedBy(title);
        home = all.opposite(u"home");
        books = all;
        definition.finish();
        shelf = shelfClass;
        book = bookClass;
        thing = thingClass;
    }
};

class ReflectiveBuilderTest : public ReflectiveFixture
{
protected:
    static Value text(ustring const& value) { return Value(StandardTypes::stringMeta, value); }
    static Value number(int value) { return Value(StandardTypes::integerMeta, value); }

    std::unique_ptr<Builder> builderOf(meta::Class const& metaClass) const
    {
        return metaClass->instantiateBuilder(model);
    }
    std::unique_ptr<Builder> nestedBook(ustring const& title) const
    {
        auto nested = std::make_unique<ReflectiveBuilder>(shelves.book);
        nested->setOrAdd(shelves.title, text(title));
        return nested;
    }

    Shelves const& shelves = Shelves::get();
};

TEST_F(ReflectiveBuilderTest, IsWhatClassesDefinedAtRunTimeHave)
{
    UUID const id = uuidOf(1);

    ModelElement const made = shelves.book->instantiate(model, id);

    ASSERT_TRUE(made);
    EXPECT_EQ(made->getMetaClass(), shelves.book);
    EXPECT_EQ(made->getUuid(), id);
    EXPECT_EQ(model->findElement(id), made);
}

TEST_F(ReflectiveBuilderTest, GivesTheElementItsValues)
{
    ModelElement const other = make(shelves.book);
    auto const builder = builderOf(shelves.book);
    builder->setOrAdd(shelves.title, text(u"Ema"));
    builder->setOrAdd(shelves.title, text(u"Emma"));
    builder->setOrAdd(shelves.isbn, text(u"123"));
    builder->setOrAdd(shelves.marks, number(3));
    builder->setOrAdd(shelves.marks, number(1));
    builder->setOrAdd(shelves.next, Value::createElementValue(shelves.next, other));
    builder->setOrAdd(shelves.twins, Value::createElementValue(shelves.twins, other));

    ModelElement const emma = builder->create();

    EXPECT_EQ(get<ustring>(emma, shelves.title), u"Emma") << "the last one counts";
    EXPECT_EQ(get<ustring>(emma, shelves.isbn), u"123");
    EXPECT_FALSE(has(emma, shelves.pages)) << "not given";
    EXPECT_THAT(valuesOf(emma, shelves.marks).getAllValues(), ElementsAre(number(3), number(1)));
    EXPECT_EQ(get<ModelElement>(emma, shelves.next), other);
    EXPECT_THAT(entriesOf(emma, shelves.twins), ElementsAre(other));
}

TEST_F(ReflectiveBuilderTest, KnowsWhichPropertiesWereGiven)
{
    auto const builder = builderOf(shelves.book);

    builder->setOrAdd(shelves.pages, number(7));

    auto const slotOf = [](meta::Property const& property) {
        return static_cast<unsigned long>(property->getPropertyIndex());
    };
    EXPECT_TRUE(builder->isSet(slotOf(shelves.pages)));
    EXPECT_FALSE(builder->isSet(slotOf(shelves.title)));
}

TEST_F(ReflectiveBuilderTest, BuildsWhatTheElementContainsInOneTransaction)
{
    ScriptedListener listener;
    listen(model, listener);
    auto const builder = builderOf(shelves.shelf);
    auto emma = nestedBook(u"Emma");
    emma->setOrAdd(shelves.cover, nestedBook(u"cover"));
    builder->setOrAdd(shelves.books, std::move(emma));
    builder->setOrAdd(shelves.books, nestedBook(u"Persuasion"));

    ModelElement const wall = builder->create();

    EXPECT_EQ(listener.committed.size(), 1u);
    ModelElement const found = mapOf(wall, shelves.books).genericFind(text(u"Emma"));
    ASSERT_TRUE(found);
    EXPECT_EQ(get<ModelElement>(found, shelves.home), wall);
    EXPECT_EQ(get<ustring>(get<ModelElement>(found, shelves.cover), shelves.title), u"cover");
    EXPECT_EQ(model->getElementCount(), 4u);
}

TEST_F(ReflectiveBuilderTest, LeavesNothingIfAPartCanNotBeBuilt)
{
    auto const builder = builderOf(shelves.shelf);
    builder->setOrAdd(shelves.books, nestedBook(u"Emma"));
    builder->setOrAdd(shelves.books, nestedBook(u"Emma"));

    EXPECT_RAISES(messages::UniquenessConstraint, builder->create());

    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ReflectiveBuilderTest, RefusesWhatIsNoStoredPropertyOfTheClass)
{
    auto const builder = builderOf(shelves.book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, builder->setOrAdd(shelves.age, number(1)), u"age",
                       u"shelves.Book");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder->setOrAdd(shelves.books, nestedBook(u"Emma")), u"books",
                       u"shelves.Book");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, builder->setOrAdd(meta::Property(), number(1)),
                       u"", u"shelves.Book");
}

TEST_F(ReflectiveBuilderTest, RefusesBuildersThatAPropertyCanNotHold)
{
    auto const builder = builderOf(shelves.book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder->setOrAdd(shelves.next, nestedBook(u"Emma")), u"next",
                       u"shelves.Book")
        << "not composite";
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder->setOrAdd(shelves.cover, builderOf(shelves.shelf)), u"cover",
                       u"shelves.Book")
        << "of another class";
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       builder->setOrAdd(shelves.cover, std::unique_ptr<Builder>()), u"cover",
                       u"shelves.Book");
}

TEST_F(ReflectiveBuilderTest, RefusesAValueOfAnotherType)
{
    auto const builder = builderOf(shelves.book);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       builder->setOrAdd(shelves.title, number(1)), u"String");
    builder->setOrAdd(shelves.marks, text(u"one"));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, builder->create(), u"String");
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ReflectiveBuilderTest, MakesNoElementOfAnAbstractClass)
{
    EXPECT_RAISES_WITH(messages::NoSuchOperation, builderOf(shelves.thing)->create(), u"create",
                       u"shelves.Thing");
    EXPECT_RAISES_WITH(messages::NoSuchOperation,
                       ModelElement::createProxy(model, shelves.thing,
                                                 ProxyId(ElementId::UUID_TYPE, u"x", boost::none)),
                       u"create", u"shelves.Thing");
}

TEST_F(ReflectiveBuilderTest, MakesNothingInAFrozenModel)
{
    auto const builder = builderOf(shelves.book);
    Model::Freezer const freezer(model);

    EXPECT_RAISES(messages::ModelFrozen, builder->create());
}

TEST_F(ReflectiveBuilderTest, MakesStandIns)
{
    ProxyId const id(ElementId::UUID_TYPE, u"some id", ustring(u"memory://elsewhere"));
    ModelElement const user = make(shelves.book);

    ModelElement const proxy = ModelElement::createProxy(model, shelves.book, id);
    set(user, shelves.next, proxy);

    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(proxy->getMetaClass(), shelves.book);
    EXPECT_EQ(proxy->getValidity(), ElementImpl::ElementValidity::BuilderProxy);
    EXPECT_EQ(model->getElementCount(), 1u) << "a stand-in is in no registry";
    EXPECT_EQ(user->getPropertyValue(shelves.next, ModelElement::Impl::NO_PROXY_RESOLVE)
                  .getValue<ModelElement>(),
              proxy);
}
}  // namespace
}  // namespace testkit
