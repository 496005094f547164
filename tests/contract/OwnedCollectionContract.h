/// \file
/// What holds for the collections of all kinds. See `CollectionKinds.h`.
#pragma once
#include "tests/collections/CollectionFixture.h"

namespace testkit {

template <class Kind> class OwnedCollection : public CollectionFixture
{
protected:
    typename Kind::Entry entry(int number) { return Kind::entry(model, number); }
    auto contents() { return Kind::contents(collection); }
    void add(typename Kind::Entry const& added) { Kind::add(collection, added); }
    void remove(typename Kind::Entry const& removed) { Kind::remove(collection, removed); }

    typename Kind::Owner const owner = Kind::owner(model);
    typename Kind::Collection& collection = Kind::of(owner);
    typename Kind::Entry const first = entry(0);
    typename Kind::Entry const second = entry(1);
    typename Kind::Entry const third = entry(2);
    DeepCounter counter;
};

TYPED_TEST_SUITE_P(OwnedCollection);

TYPED_TEST_P(OwnedCollection, CommitsAChangeOutsideATransactionByItself)
{
    this->model->addListener(&this->counter);

    this->add(this->first);
    EXPECT_EQ(this->counter.commits, 1);
    this->add(this->second);
    EXPECT_EQ(this->counter.commits, 2);
    this->remove(this->first);
    EXPECT_EQ(this->counter.commits, 3);
    this->collection.clear();
    EXPECT_EQ(this->counter.commits, 4);
    this->collection.copyContents(*TypeParam::snapshot());
    EXPECT_EQ(this->counter.commits, 5);

    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(OwnedCollection, CommitsNothingInsideATransaction)
{
    this->model->addListener(&this->counter);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);

    this->add(this->first);
    this->add(this->second);
    this->remove(this->first);
    EXPECT_EQ(this->counter.commits, 0);

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_EQ(this->counter.commits, 1);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(OwnedCollection, HoldsWhatWasAddedUntilItIsRemoved)
{
    this->add(this->first);
    this->add(this->second);
    EXPECT_EQ(this->collection.size(), 2u);

    this->remove(this->first);
    EXPECT_EQ(this->collection.size(), 1u);
    EXPECT_FALSE(this->collection.empty());

    this->collection.clear();
    EXPECT_TRUE(this->collection.empty());
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, ChangesSilentlyWithoutAnOwner)
{
    this->add(this->first);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    this->model->addListener(&this->counter);
    Model::Freezer const frozen = this->model->freeze();

    TypeParam::add(*snapshot, this->first);
    TypeParam::add(*snapshot, this->second);
    EXPECT_EQ(snapshot->size(), 2u);
    TypeParam::remove(*snapshot, this->first);
    EXPECT_EQ(snapshot->size(), 1u);
    snapshot->copyContents(this->collection);
    EXPECT_EQ(TypeParam::contents(*snapshot), before);
    snapshot->clear();
    EXPECT_TRUE(snapshot->empty());

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->counter.commits, 0);
    EXPECT_EQ(snapshot->getOwner(), nullptr);
    this->model->removeListener(&this->counter);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, CopiesContentsExactly)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    TypeParam::add(*snapshot, this->third);

    snapshot->copyContents(this->collection);
    EXPECT_EQ(TypeParam::contents(*snapshot), before);

    this->remove(this->first);
    EXPECT_EQ(TypeParam::contents(*snapshot), before) << "the copy is independent";
}

TYPED_TEST_P(OwnedCollection, IsAsItWasAfterARollback)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->remove(this->first);
    this->add(this->third);
    this->collection.clear();
    this->add(this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, IsEmptyAfterARollbackIfItWasMadeInTheTransaction)
{
    auto const fresh = TypeParam::owner(this->model);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    TypeParam::add(TypeParam::of(fresh), this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(TypeParam::of(fresh).empty());
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, TakesARefusedChangeBack)
{
    this->add(this->first);
    auto const before = this->contents();
    Refuser refuser;
    this->model->addListener(&refuser);

    this->add(this->second);
    EXPECT_EQ(this->contents(), before);
    this->remove(this->first);
    EXPECT_EQ(this->contents(), before);
    this->collection.clear();
    EXPECT_EQ(this->contents(), before);

    this->model->removeListener(&refuser);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, RefusesChangesWhileTheModelIsFrozen)
{
    this->add(this->first);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    {
        Model::Freezer const frozen = this->model->freeze();

        EXPECT_RAISES(messages::ModelFrozen, this->add(this->second));
        EXPECT_RAISES(messages::ModelFrozen, this->remove(this->first));
        EXPECT_RAISES(messages::ModelFrozen, this->collection.clear());
        EXPECT_RAISES(messages::ModelFrozen, this->collection.copyContents(*snapshot));
        EXPECT_EQ(this->contents(), before);
    }

    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->add(this->second);
    EXPECT_EQ(this->collection.size(), 2u) << "the model takes changes again";
}

TYPED_TEST_P(OwnedCollection, IgnoresChangesOnceItsElementIsDestroyed)
{
    this->add(this->first);
    this->owner->destroy();
    std::size_t const size = this->collection.size();
    this->model->addListener(&this->counter);

    this->add(this->second);
    this->remove(this->first);
    this->collection.clear();

    EXPECT_EQ(this->collection.size(), size);
    EXPECT_EQ(this->counter.commits, 0);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(OwnedCollection, ComesBackWithItsElementWhenADestructionIsRolledBack)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->owner->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(this->owner);
    EXPECT_EQ(this->contents(), before);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST_P(OwnedCollection, IsRecordedByAShallowTransactionAndStaysChangedAfterItsRollback)
{
    ShallowCounter shallow;
    this->model->addShallowListener(&shallow);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);

    this->add(this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotRevertible);

    EXPECT_EQ(this->collection.size(), 1u);
    this->model->removeListener(&shallow);
}

TYPED_TEST_P(OwnedCollection, IsNotRecordedWhileADataSourceLoads)
{
    this->model->addListener(&this->counter);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);
    {
        Model::DataSourceLoadingInProgressIndicator const loading(this->model);
        this->add(this->first);
    }

    static_cast<void>(transaction.rollBack());

    EXPECT_EQ(this->collection.size(), 1u) << "what is loaded is no change";
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(OwnedCollection, TellsAboutItsPlace)
{
    EXPECT_EQ(this->collection.getOwner(), this->owner.getImpl());
    EXPECT_TRUE(this->collection.getCollectionFeature());
    EXPECT_EQ(this->collection.getCollectionFeature().slot() != nullptr,
              TypeParam::IS_GIVEN_BY_SLOT);
}

REGISTER_TYPED_TEST_SUITE_P(OwnedCollection, CommitsAChangeOutsideATransactionByItself,
                            CommitsNothingInsideATransaction, HoldsWhatWasAddedUntilItIsRemoved,
                            ChangesSilentlyWithoutAnOwner, CopiesContentsExactly,
                            IsAsItWasAfterARollback,
                            IsEmptyAfterARollbackIfItWasMadeInTheTransaction,
                            TakesARefusedChangeBack, RefusesChangesWhileTheModelIsFrozen,
                            IgnoresChangesOnceItsElementIsDestroyed,
                            ComesBackWithItsElementWhenADestructionIsRolledBack,
                            IsRecordedByAShallowTransactionAndStaysChangedAfterItsRollback,
                            IsNotRecordedWhileADataSourceLoads, TellsAboutItsPlace);
}  // namespace testkit
