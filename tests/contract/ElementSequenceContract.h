/// \file
/// What holds for all sequences of elements, seen without their class.
#pragma once
#include "tarnkiln/meta/Package.h"
#include "tests/collections/CollectionFixture.h"

namespace testkit {

/// Begins with two elements in the sequence.
template <class Kind> class SequenceOfElements : public CollectionFixture
{
protected:
    using Elements = std::vector<ModelElement>;

    SequenceOfElements()
    {
        sequence.genericAdd(first);
        sequence.genericAdd(second);
    }

    Elements contents() { return collection.getAllValuesAndProxies(); }
    void expectSound() { EXPECT_EQ(model->checkInvariants(), std::vector<string>()); }

    typename Kind::Owner const owner = Kind::owner(model);
    typename Kind::Collection& collection = Kind::of(owner);
    GenericSequenceInterface& sequence = genericOf(collection);
    ModelElement const first = Kind::entry(model, 0);
    ModelElement const second = Kind::entry(model, 1);
    ModelElement const third = Kind::entry(model, 2);
    DeepCounter counter;
};

TYPED_TEST_SUITE_P(SequenceOfElements);

TYPED_TEST_P(SequenceOfElements, IsSeenAsASequence)
{
    GenericCollectionInterface const& generic = this->sequence;

    EXPECT_TRUE(generic.isSequenceInterface());
    EXPECT_FALSE(generic.isMapInterface());
    EXPECT_FALSE(generic.isMultimapInterface());
}

TYPED_TEST_P(SequenceOfElements, KnowsThePositionsOfItsEntriesAlone)
{
    EXPECT_EQ(this->sequence.genericAt(0), this->first);
    EXPECT_EQ(this->sequence.genericAt(1), this->second);
    EXPECT_EQ(this->sequence.genericIndexOf(this->first), 0);
    EXPECT_EQ(this->sequence.genericIndexOf(this->second), 1);
    EXPECT_EQ(this->sequence.genericIndexOf(this->third), -1);
    EXPECT_EQ(this->sequence.genericIndexOf(ModelElement()), -1);
    EXPECT_EQ(this->sequence.genericIndexOf(meta::Package::create(this->model)), -1);
    this->third->destroy();
    EXPECT_EQ(this->sequence.genericIndexOf(this->third), -1);
}

TYPED_TEST_P(SequenceOfElements, TakesAnElementAtAnyPosition)
{
    this->sequence.genericInsert(this->third, 1);

    EXPECT_EQ(this->contents(),
              typename TestFixture::Elements({this->first, this->third, this->second}));
    this->expectSound();
}

TYPED_TEST_P(SequenceOfElements, LeavesAnElementWhereItIsIfThatIsInsertedAgain)
{
    this->model->addListener(&this->counter);

    if (this->collection.isUnique())
        this->sequence.genericInsert(this->second, 0);
    this->sequence.genericInsert(ModelElement(), 0);

    EXPECT_EQ(this->contents(), typename TestFixture::Elements({this->first, this->second}));
    EXPECT_EQ(this->counter.commits, 0);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(SequenceOfElements, MovesAnElementToThePositionWhereItIsToBe)
{
    this->sequence.genericEnsureAt(this->third, 1);
    EXPECT_EQ(this->contents(),
              typename TestFixture::Elements({this->first, this->third, this->second}));

    if (this->collection.isUnique())
    {
        this->sequence.genericEnsureAt(this->third, 0);
        EXPECT_EQ(this->contents(),
                  typename TestFixture::Elements({this->third, this->first, this->second}));
    }
    this->expectSound();
}

TYPED_TEST_P(SequenceOfElements, PutsAnElementInThePlaceOfAnother)
{
    this->model->addListener(&this->counter);

    this->sequence.genericReplace(this->third, 0);

    EXPECT_EQ(this->contents(), typename TestFixture::Elements({this->third, this->second}));
    EXPECT_EQ(this->counter.commits, 1);
    this->sequence.genericReplace(this->third, 0);
    EXPECT_EQ(this->counter.commits, 1) << "by itself";
    this->model->removeListener(&this->counter);
    this->expectSound();
}

TYPED_TEST_P(SequenceOfElements, RefusesAReplacementThatIsNoneOrInHereAlready)
{
    ModelElement const dead = TypeParam::entry(this->model, 3);
    dead->destroy();

    EXPECT_RAISES_WITH(messages::CannotAddNonExistentObject,
                       this->sequence.genericReplace(ModelElement(), 0));
    EXPECT_RAISES_WITH(messages::CannotAddNonExistentObject,
                       this->sequence.genericReplace(dead, 0));
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes,
                  this->sequence.genericReplace(meta::Package::create(this->model), 0));
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes,
                  this->sequence.genericInsert(meta::Package::create(this->model), 0));
    if (this->collection.isUnique())
    {
        EXPECT_RAISES_WITH(messages::CannotAddSecondObject,
                           this->sequence.genericReplace(this->second, 0));
    }

    EXPECT_EQ(this->contents(), typename TestFixture::Elements({this->first, this->second}));
    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->expectSound();
}

TYPED_TEST_P(SequenceOfElements, LosesTheEntryAtAPosition)
{
    this->sequence.genericRemoveAt(0);

    EXPECT_EQ(this->contents(), typename TestFixture::Elements({this->second}));
    EXPECT_TRUE(this->first);
    this->expectSound();
}

TYPED_TEST_P(SequenceOfElements, IgnoresChangesAtPositionsOnceItsElementIsDestroyed)
{
    this->owner->destroy();
    auto const before = this->contents();

    this->sequence.genericInsert(this->third, 0);
    this->sequence.genericEnsureAt(this->third, 0);
    this->sequence.genericReplace(this->third, 0);
    this->sequence.genericRemoveAt(0);

    EXPECT_EQ(this->contents(), before);
    EXPECT_TRUE(this->third->isTopLevel());
}

TYPED_TEST_P(SequenceOfElements, GetsItsOrderBackByARollback)
{
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->sequence.genericInsert(this->third, 0);
    this->sequence.genericRemoveAt(1);
    this->sequence.genericAdd(this->first);
    this->sequence.genericRemoveAt(0);
    this->sequence.genericReplace(this->third, 0);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), typename TestFixture::Elements({this->first, this->second}));
    this->expectSound();
}

REGISTER_TYPED_TEST_SUITE_P(SequenceOfElements, IsSeenAsASequence,
                            KnowsThePositionsOfItsEntriesAlone, TakesAnElementAtAnyPosition,
                            LeavesAnElementWhereItIsIfThatIsInsertedAgain,
                            MovesAnElementToThePositionWhereItIsToBe,
                            PutsAnElementInThePlaceOfAnother,
                            RefusesAReplacementThatIsNoneOrInHereAlready, LosesTheEntryAtAPosition,
                            IgnoresChangesAtPositionsOnceItsElementIsDestroyed,
                            GetsItsOrderBackByARollback);
}  // namespace testkit
