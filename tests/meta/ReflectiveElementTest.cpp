// How elements of run-time classes come into being, and which properties they have.
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tests/meta/ReflectiveFixture.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/InvalidationLog.h"

namespace testkit {
namespace {

class ReflectiveElement : public ReflectiveFixture
{
protected:
    meta::Class const thing = metamodel.makeClass(u"Thing");
    meta::Class const book = metamodel.makeClass(u"Book", thing);
    meta::Property const label = metamodel.property(thing, u"label", StandardTypes::stringMeta);
    meta::Property const pages =
        metamodel.property(book, u"pages", StandardTypes::integerMeta).required();
    meta::Property const previous = metamodel.property(book, u"previous", book);
};

TEST_F(ReflectiveElement, IsOfItsClassAndTopLevelInItsModel)
{
    UUID const id = ElementImpl::generateNewUuid();

    ModelElement const made = ModelElement::createReflective(model, book, id);

    EXPECT_EQ(made->getMetaClass(), book);
    EXPECT_EQ(made->getUuid(), id);
    EXPECT_EQ(model->findElement(id), made);
    EXPECT_TRUE(made->isTopLevel());
    EXPECT_EQ(made->getValidity(), ElementImpl::ElementValidity::Valid);
    EXPECT_TRUE(dynamic_cast<ReflectiveModelElementImpl*>(made.getImpl()));
}

TEST_F(ReflectiveElement, GetsAFreshUuidForTheNilOne)
{
    EXPECT_FALSE(make(book)->getUuid().is_nil());
    EXPECT_NE(make(book)->getUuid(), make(book)->getUuid());
}

TEST_F(ReflectiveElement, NeedsALiveModelAndAFreeUuid)
{
    ModelElement const first = make(book);

    EXPECT_RAISES(messages::CannotCreateWithoutModel, ModelElement::createReflective({}, book));
    EXPECT_RAISES(messages::UUIDConflict,
                  ModelElement::createReflective(model, book, first->getUuid()));

    EXPECT_EQ(model->findElement(first->getUuid()), first);
    EXPECT_EQ(model->getElementCount(), 1u);
}

TEST_F(ReflectiveElement, HasThePropertiesOfAllClassesOfTheChain)
{
    ModelElement const made = make(book);

    set(made, label, u"Emma");
    set(made, pages, 474);

    EXPECT_EQ(getOptional<ustring>(made, label), ustring(u"Emma"));
    EXPECT_EQ(get<int>(made, pages), 474);
    EXPECT_EQ(made->getPropertyByIndex(1), label);
    EXPECT_EQ(made->getPropertyByIndex(2), pages);
    EXPECT_EQ(made->getPropertyByIndex(3), previous);
    EXPECT_FALSE(made->getPropertyByIndex(4));
    EXPECT_FALSE(made->getPropertyByIndex(0));
}

TEST_F(ReflectiveElement, OfASuperclassHasNoPropertyOfTheSubclass)
{
    ModelElement const made = make(thing);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, valueOf(made, pages), u"pages", u"rt.Thing");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, has(made, pages), u"pages", u"rt.Thing");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, set(made, pages, 1), u"pages", u"rt.Thing");
}

TEST_F(ReflectiveElement, MayBeOfAnAbstractClass)
{
    book->setIsAbstract(true);

    EXPECT_EQ(make(book)->getMetaClass(), book);
}

TEST_F(ReflectiveElement, MayBeOfAClassWithGeneratedCode)
{
    tarnkiln::tests::RegistryElement<meta::Class> const registered(u"ClassOfTheRegistry");

    ModelElement const made = make(registered.get());

    EXPECT_EQ(made->getMetaClass(), registered.get());
    made->destroy();
}

TEST_F(ReflectiveElement, DoesNotStoreADerivedProperty)
{
    meta::Property const derived =
        metamodel.property(book, u"derived", StandardTypes::integerMeta).derived();
    ModelElement const made = make(book);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, valueOf(made, derived), u"derived", u"rt.Book");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, set(made, derived, 1), u"derived", u"rt.Book");
}

TEST_F(ReflectiveElement, CanNotBeMadeWhileAStoredPropertyHasNoType)
{
    meta::Property const untyped = metamodel.property(book, u"untyped", meta::Type());

    EXPECT_RAISES_WITH(messages::CannotUsePropertyWithoutType, make(book), u"untyped");
    EXPECT_EQ(model->getElementCount(), 0u);

    untyped->setIsDerived(true);
    EXPECT_TRUE(make(book)) << "a derived property is not stored";
}

TEST_F(ReflectiveElement, KeepsThePropertiesThatItsClassHadWhenItWasMade)
{
    ModelElement const before = make(book);
    meta::Property const late = metamodel.property(book, u"late", StandardTypes::integerMeta);
    ModelElement const after = make(book);

    set(after, late, 3);

    EXPECT_EQ(getOptional<int>(after, late), 3);
    EXPECT_RAISES_WITH(messages::NoSuchProperty, valueOf(before, late), u"late", u"rt.Book");
    set(before, pages, 7);
    EXPECT_EQ(get<int>(before, pages), 7) << "what it had still works";
}

TEST_F(ReflectiveElement, HasNoPropertyThatWasTakenFromItsClass)
{
    ModelElement const made = make(book);

    label->destroy();

    EXPECT_RAISES(messages::NoSuchProperty, valueOf(made, label));
    EXPECT_TRUE(make(book));
}

TEST_F(ReflectiveElement, NoticesAChangeOfThePropertyInNewElements)
{
    meta::Property const changing =
        metamodel.property(book, u"changing", StandardTypes::integerMeta).required();
    ModelElement const before = make(book);
    changing->setType(StandardTypes::stringMeta);
    ModelElement const after = make(book);

    set(after, changing, u"text");

    EXPECT_EQ(get<ustring>(after, changing), u"text");
    EXPECT_EQ(get<int>(before, changing), 0) << "an element keeps the value that it has";
    set(before, changing, u"text");
    EXPECT_EQ(get<ustring>(before, changing), u"text");
}

TEST_F(ReflectiveElement, NoticesANewSuperclassInNewElements)
{
    meta::Class const top = metamodel.makeClass(u"Top");
    meta::Property const mark =
        metamodel.property(top, u"mark", StandardTypes::integerMeta).required().at(9);
    ModelElement const before = make(book);
    thing->setSuperclass(top);
    ModelElement const after = make(book);

    set(after, mark, 5);

    EXPECT_EQ(get<int>(after, mark), 5);
    EXPECT_RAISES(messages::NoSuchProperty, valueOf(before, mark));
}

TEST_F(ReflectiveElement, KnowsNoExtensionUnderPublicAccess)
{
    meta::Extension const extension = meta::Extension::create(metamodel.model);
    extension->setName(u"extension");

    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       valueOf(make(book), extension, ModelElement::Impl::PUBLIC_ACCESS),
                       u"extension", u"rt.Book");
}

TEST_F(ReflectiveElement, TellsTheInvalidateCallbackOfItsCollectionsInTheOrderOfTheirIndices)
{
    meta::Property const second = metamodel.property(book, u"aaa", book).many().ordered().at(9);
    meta::Property const first = metamodel.property(book, u"zzz", book).many().ordered().at(8);
    ModelElement const made = make(book);
    ReferenceCollection* const secondCollection = &referencesOf(made, second);
    ReferenceCollection* const firstCollection = &referencesOf(made, first);
    InvalidationLog const log;

    made->destroy();

    EXPECT_THAT(log.calls(), ElementsAre(InvalidationLog::Call(made.getImpl(), firstCollection),
                                         InvalidationLog::Call(made.getImpl(), secondCollection),
                                         InvalidationLog::Call(made.getImpl(), nullptr)));
}
}  // namespace
}  // namespace testkit
