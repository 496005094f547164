/// \file
/// What holds for all collections of plain values, seen without their type.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/collections/CollectionFixture.h"

namespace testkit {

/// Begins with one value in the collection.
template <class Kind> class CollectionOfValues : public CollectionFixture
{
protected:
    CollectionOfValues() { Kind::add(Kind::of(owner), Kind::entry(model, 0)); }

    /// An entry as those know it who do not know its type.
    Value value(int number)
    {
        auto const snapshot = Kind::snapshot();
        Kind::add(*snapshot, Kind::entry(model, number));
        return static_cast<AbstractPrimitiveCollection const&>(*snapshot).getAllValues().at(0);
    }
    std::vector<Value> contents() { return collection.getAllValues(); }
    bool isSequence() const
    {
        return collection.getKind() == AbstractPrimitiveCollection::SEQUENCE;
    }
    bool isUnique() const
    {
        if constexpr (requires(typename Kind::Collection const& own) { own.isUnique(); })
            return Kind::of(owner).isUnique();
        else
            return true;
    }
    GenericPrimitiveSequenceInterface& sequence()
    {
        return dynamic_cast<GenericPrimitiveSequenceInterface&>(*collection.getGenericInterface());
    }

    typename Kind::Owner const owner = Kind::owner(model);
    AbstractPrimitiveCollection& collection = Kind::of(owner);
    Value const first = value(0);
    Value const second = value(1);
    Value const third = value(2);
    DeepCounter counter;
};

TYPED_TEST_SUITE_P(CollectionOfValues);

TYPED_TEST_P(CollectionOfValues, IsChangedByThoseWhoDoNotKnowItsType)
{
    this->model->addListener(&this->counter);

    this->collection.genericAdd(this->second);
    EXPECT_EQ(this->collection.size(), 2u);
    this->collection.genericRemove(this->first);
    EXPECT_EQ(this->contents(), std::vector{this->second});
    this->collection.clear();
    EXPECT_EQ(this->collection.size(), 0u);

    EXPECT_EQ(this->counter.commits, 3);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(CollectionOfValues, GivesValuesOfItsType)
{
    ASSERT_EQ(this->contents().size(), 1u);
    EXPECT_TRUE(this->collection.getCollectionType());
    EXPECT_EQ(this->contents()[0].getType(), this->collection.getCollectionType());
}

TYPED_TEST_P(CollectionOfValues, RefusesValuesOfAnotherType)
{
    meta::StandardTypes::ensureInitialized();
    Value const wrong(meta::StandardTypes::booleanMeta, true);
    this->model->addListener(&this->counter);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, this->collection.genericAdd(wrong),
                       u"Boolean");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, this->collection.genericRemove(wrong),
                       u"Boolean");
    if (this->isSequence())
    {
        EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                      this->sequence().genericInsert(wrong, 0));
        EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                      this->sequence().genericReplace(wrong, 0));
        EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                      this->sequence().genericIndexOf(wrong));
    }

    EXPECT_EQ(this->contents(), std::vector{this->first});
    EXPECT_EQ(this->counter.commits, 0);
    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(CollectionOfValues, TakesARepetitionUnlessItIsUnique)
{
    this->model->addListener(&this->counter);

    this->collection.genericAdd(this->first);

    EXPECT_EQ(this->collection.size(), this->isUnique() ? 1u : 2u);
    EXPECT_EQ(this->counter.commits, this->isUnique() && this->isSequence() ? 0 : 1)
        << "a set announces what changes nothing";
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(CollectionOfValues, LosesTheFirstOfEqualValues)
{
    this->collection.genericAdd(this->second);
    this->collection.genericAdd(this->first);

    this->collection.genericRemove(this->first);

    if (this->isUnique())
        EXPECT_EQ(this->contents(), std::vector{this->second});
    else
        EXPECT_EQ(this->contents(), (std::vector{this->second, this->first}));
    this->collection.genericRemove(this->third);
    EXPECT_EQ(this->collection.size(), this->isUnique() ? 1u : 2u);
}

TYPED_TEST_P(CollectionOfValues, HasAViewWithPositionsIfItIsASequence)
{
    if (!this->isSequence())
    {
        EXPECT_EQ(this->collection.getKind(), AbstractPrimitiveCollection::SET);
        EXPECT_EQ(this->collection.getGenericInterface(), nullptr);
        return;
    }
    this->sequence().genericInsert(this->second, 0);
    EXPECT_EQ(this->contents(), (std::vector{this->second, this->first}));
    EXPECT_EQ(this->sequence().genericAt(1), this->first);
    EXPECT_EQ(this->sequence().genericIndexOf(this->first), 1);
    EXPECT_EQ(this->sequence().genericIndexOf(this->third), -1);

    this->sequence().genericReplace(this->third, 1);
    EXPECT_EQ(this->contents(), (std::vector{this->second, this->third}));
    this->sequence().genericRemoveAt(0);
    EXPECT_EQ(this->contents(), std::vector{this->third});
}

TYPED_TEST_P(CollectionOfValues, IsNotTouchedWhenAUniqueEntryIsReplacedByItself)
{
    this->model->addListener(&this->counter);

    if (this->isSequence())
        this->sequence().genericReplace(this->first, 0);

    EXPECT_EQ(this->contents(), std::vector{this->first});
    EXPECT_EQ(this->counter.commits, this->isSequence() && !this->isUnique() ? 1 : 0);
    this->model->removeListener(&this->counter);
}

REGISTER_TYPED_TEST_SUITE_P(CollectionOfValues, IsChangedByThoseWhoDoNotKnowItsType,
                            GivesValuesOfItsType, RefusesValuesOfAnotherType,
                            TakesARepetitionUnlessItIsUnique, LosesTheFirstOfEqualValues,
                            HasAViewWithPositionsIfItIsASequence,
                            IsNotTouchedWhenAUniqueEntryIsReplacedByItself);
}  // namespace testkit
