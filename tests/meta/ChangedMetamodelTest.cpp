// What elements of run-time classes do when their metamodel changes under them: all that they
// remember of it gives way at once.
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

class ChangedMetamodel : public ReflectiveFixture
{
protected:
    static Value read(ModelElement const& from, meta::Property const& property)
    {
        return from->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS);
    }
    Value valueOf(meta::Property const& property) const { return read(element, property); }
    void setPages(ModelElement const& of, int number) const
    {
        of->setPropertyValue(pages, Value(StandardTypes::integerMeta, number),
                             ModelElement::Impl::PUBLIC_ACCESS);
    }
    void setPages(int number) const { setPages(element, number); }

    meta::Class const thing = metamodel.makeClass(u"Thing");
    meta::Class const book = metamodel.makeClass(u"Book", thing);
    meta::Property const label =
        metamodel.property(thing, u"label", StandardTypes::stringMeta).required();
    meta::Property const pages =
        metamodel.property(book, u"pages", StandardTypes::integerMeta).required();
    meta::Property const draft = metamodel.property(book, u"draft", book);
    ModelElement const element = make(book);
};

TEST_F(ChangedMetamodel, HidesAndShowsAPropertyAtOnce)
{
    EXPECT_EQ(valueOf(pages).getValue<int>(), 0);

    pages->setIsPublicAccessor(false);
    EXPECT_RAISES(messages::NoSuchProperty, valueOf(pages));

    pages->setIsPublicAccessor(true);
    EXPECT_EQ(valueOf(pages).getValue<int>(), 0);
}

TEST_F(ChangedMetamodel, TakesAwayTheRightToSetAtOnce)
{
    setPages(1);

    pages->setIsPublicMutator(false);
    EXPECT_RAISES(messages::NoSuchProperty, setPages(2));
    pages->setIsPublicMutator(true);
    setPages(3);
    pages->setIsReadOnly(true);
    EXPECT_RAISES(messages::NoSuchProperty, setPages(4));

    EXPECT_EQ(valueOf(pages).getValue<int>(), 3);
}

TEST_F(ChangedMetamodel, LetsAPropertyBeSetOnceFromNowOn)
{
    setPages(1);

    pages->setIsSetOnce(true);

    EXPECT_RAISES_WITH(messages::CannotSetReadOnlyProperty, setPages(2), u"pages");
}

TEST_F(ChangedMetamodel, ForgetsTheSuperclassAtOnce)
{
    EXPECT_EQ(valueOf(label).getValue<ustring>(), u"");

    book->setSuperclass(ModelElement::metaClass());
    EXPECT_RAISES(messages::NoSuchProperty, valueOf(label));

    book->setSuperclass(thing);
    EXPECT_EQ(valueOf(label).getValue<ustring>(), u"");
}

TEST_F(ChangedMetamodel, CountsWhileItsTransactionIsOpenAndAfterItsRollback)
{
    Transaction const change = metamodel.model->beginTransaction(/*revertible=*/true);
    EXPECT_EQ(valueOf(pages).getValue<int>(), 0);
    pages->setIsPublicAccessor(false);
    EXPECT_RAISES(messages::NoSuchProperty, valueOf(pages));

    change.rollBack();

    EXPECT_EQ(valueOf(pages).getValue<int>(), 0);
}

TEST_F(ChangedMetamodel, GivesNewElementsAnotherTypeOfValues)
{
    setPages(1);

    pages->setType(StandardTypes::realMeta);
    ModelElement const later = make(book);

    EXPECT_EQ(valueOf(pages).getValue<int>(), 1);
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes, setPages(2));
    EXPECT_EQ(later->getPropertyValue(pages, ModelElement::Impl::PUBLIC_ACCESS).getValue<double>(),
              0.0);
}

TEST_F(ChangedMetamodel, IsReadFromOldAndNewElementsInTurn)
{
    setPages(1);
    meta::Property const age =
        metamodel.property(book, u"age", StandardTypes::integerMeta).required();
    ModelElement const later = make(book);
    setPages(later, 2);

    for (int round = 0; round < 3; ++round)
    {
        EXPECT_EQ(valueOf(pages).getValue<int>(), 1);
        EXPECT_EQ(read(later, pages).getValue<int>(), 2);
        EXPECT_RAISES(messages::NoSuchProperty, valueOf(age));
        EXPECT_EQ(read(later, age).getValue<int>(), 0);
    }
}

TEST_F(ChangedMetamodel, GivesReferencesOfAllElementsAnotherTypeAtOnce)
{
    ModelElement const first = make(book);
    element->setPropertyValue(draft, Value(book, first), ModelElement::Impl::PUBLIC_ACCESS);
    EXPECT_EQ(valueOf(draft).getType(), book);

    draft->setType(thing);

    EXPECT_EQ(valueOf(draft).getType(), thing);
    EXPECT_EQ(valueOf(draft).getValue<ModelElement>(), first);
}

TEST_F(ChangedMetamodel, GivesNewElementsWhatARolledBackChangeHadTaken)
{
    Transaction const change = metamodel.model->beginTransaction(/*revertible=*/true);
    pages->setOwningType(thing);
    label->destroy();
    ModelElement const within = make(book);
    EXPECT_RAISES(messages::NoSuchProperty,
                  within->getPropertyValue(label, ModelElement::Impl::PUBLIC_ACCESS));

    change.rollBack();
    ModelElement const after = make(book);

    EXPECT_EQ(after->getPropertyValue(label, ModelElement::Impl::PUBLIC_ACCESS).getValue<ustring>(),
              u"");
}

TEST_F(ChangedMetamodel, ThatIsGoneLeavesTheValuesWithoutAName)
{
    setPages(1);

    metamodel.model->destroy();

    EXPECT_RAISES(messages::NoSuchProperty, valueOf(pages));
}
}  // namespace
}  // namespace testkit
