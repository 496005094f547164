/// \file
/// What holds for all collections of elements, besides what holds for all collections.
#pragma once
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/Package.h"
#include "tests/collections/CollectionFixture.h"

namespace testkit {

/// Begins with two elements in the collection.
template <class Kind> class CollectionOfElements : public CollectionFixture
{
protected:
    using Entry = typename Kind::Entry;

    CollectionOfElements()
    {
        add(first);
        add(second);
    }

    auto contents() { return Kind::contents(collection); }
    void add(Entry const& added) { Kind::add(collection, added); }
    void remove(Entry const& removed) { Kind::remove(collection, removed); }
    bool isUnique() const
    {
        if constexpr (requires { collection.isUnique(); })
            return collection.isUnique();
        else
            return true;
    }
    /// Whether elements know that they are in the collection.
    bool ties() const { return collection.isComposite() || collection.getOpposite(); }
    /// Whether `entry` knows, and says, that it is.
    bool isTied(ModelElement const& entry) const
    {
        if (collection.isComposite())
            return entry->container() == owner &&
                   entry->getContainment() == collection.getCollectionFeature();
        if (!ties())
            return false;
        Value const other = entry->getPropertyValue(collection.getOpposite().property(),
                                                    ModelElement::Impl::PRIVILEGED_ACCESS);
        if (collection.getOpposite().isSingle())
            return other.getValue<ModelElement>() == owner;
        std::vector<ModelElement> const owners =
            other.getValue<ReferenceCollection&>().getAllValues();
        return std::find(owners.begin(), owners.end(), owner) != owners.end();
    }
    void expectSound() { EXPECT_EQ(model->checkInvariants(), std::vector<string>()); }
    Entry danglingEntry()
    {
        return Kind::proxy(model,
                           ProxyId(ElementId::UUID_TYPE, u"00000000-0000-4000-8000-000000000001"));
    }

    typename Kind::Owner const owner = Kind::owner(model);
    typename Kind::Owner const another = Kind::owner(model);
    typename Kind::Collection& collection = Kind::of(owner);
    GenericCollectionInterface& generic = genericOf(collection);
    Entry const first = Kind::entry(model, 0);
    Entry const second = Kind::entry(model, 1);
    Entry const third = Kind::entry(model, 2);
    DeepCounter counter;
};

TYPED_TEST_SUITE_P(CollectionOfElements);

TYPED_TEST_P(CollectionOfElements, IsChangedByThoseWhoDoNotKnowItsClass)
{
    this->model->addListener(&this->counter);
    EXPECT_EQ(this->generic.genericSize(), 2u);

    this->generic.genericAdd(this->third);
    EXPECT_EQ(this->generic.genericSize(), 3u);
    this->generic.genericRemove(this->first);
    EXPECT_EQ(this->generic.genericSize(), 2u);
    this->generic.genericClear();

    EXPECT_TRUE(this->collection.empty());
    EXPECT_EQ(this->counter.commits, 3);
    this->model->removeListener(&this->counter);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, IgnoresNullAndDestroyedElements)
{
    auto const before = this->contents();
    this->third->destroy();
    this->model->addListener(&this->counter);

    for (typename TypeParam::Entry const& none : {typename TypeParam::Entry(), this->third})
    {
        this->add(none);
        this->remove(none);
        this->generic.genericAdd(none);
        this->generic.genericEnsureAt(none, 0);
        this->generic.genericRemove(none);
    }

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->counter.commits, 0);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(CollectionOfElements, ListsItsElementsOnceEach)
{
    EXPECT_EQ(this->collection.getAllValues().size(), 2u);
    EXPECT_EQ(this->collection.getAllValuesAndProxies().size(), 2u);
    EXPECT_TRUE(this->collection.contains(this->first));
    EXPECT_FALSE(this->collection.contains(this->third));
}

TYPED_TEST_P(CollectionOfElements, IgnoresWhatItHoldsUnlessItTakesRepetitions)
{
    auto const before = this->contents();
    this->model->addListener(&this->counter);

    if (this->isUnique())
    {
        this->add(this->first);
        this->generic.genericAdd(this->first);
    }

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->counter.commits, 0);
    this->model->removeListener(&this->counter);
}

TYPED_TEST_P(CollectionOfElements, SeesToItThatAnElementIsThere)
{
    this->generic.genericEnsureAt(this->third, 0);

    EXPECT_EQ(this->generic.genericSize(), 3u);
    EXPECT_TRUE(this->collection.contains(this->third));
    EXPECT_EQ(this->isTied(this->third), this->ties());
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, RefusesElementsOfAnotherClass)
{
    auto const before = this->contents();
    ModelElement const alien = meta::Package::create(this->model);
    ustring const wanted = this->collection.getElementClass()->getQualifiedName();
    ustring const given = alien->getMetaClass()->getQualifiedName();

    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, this->generic.genericAdd(alien),
                       wanted, given);
    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes,
                       this->generic.genericEnsureAt(alien, 0), wanted, given);
    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, this->generic.genericRemove(alien),
                       wanted, given);

    EXPECT_EQ(this->contents(), before);
    EXPECT_FALSE(this->collection.acceptsElement(alien));
    EXPECT_TRUE(this->collection.acceptsElement(this->third));
    EXPECT_FALSE(this->model->getCurrentTransaction());
}

TYPED_TEST_P(CollectionOfElements, RefusesElementsThatCanNotReferBack)
{
    auto const before = this->contents();
    Model const apart = Model::createTransientModel();
    auto const foreign = TypeParam::entry(apart, 2);

    if (this->ties())
    {
        EXPECT_RAISES_WITH(messages::CannotCreateCrossModelAssociation, this->add(foreign));
        EXPECT_RAISES_WITH(messages::CannotCreateCrossModelAssociation,
                           this->generic.genericAdd(foreign));
    }
    else
    {
        this->add(foreign);
        EXPECT_TRUE(this->collection.contains(foreign));
        this->remove(foreign);
    }

    EXPECT_EQ(this->contents(), before);
    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, KeepsTheElementsInStep)
{
    EXPECT_EQ(this->isTied(this->first), this->ties());
    EXPECT_FALSE(this->isTied(this->third));

    this->add(this->third);
    EXPECT_EQ(this->isTied(this->third), this->ties());
    this->remove(this->first);
    EXPECT_FALSE(this->isTied(this->first));
    this->expectSound();
    this->collection.clear();
    EXPECT_FALSE(this->isTied(this->second));
    EXPECT_FALSE(this->isTied(this->third));
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, LosesADestroyedElementThatKnowsItAndGetsItBackByARollback)
{
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->first->destroy();
    EXPECT_EQ(this->collection.size(), this->ties() ? 1u : 2u);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->isTied(this->first), this->ties());
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, DestroysAllItsContentsInOneTransaction)
{
    this->model->addListener(&this->counter);

    this->collection.destroyAllContents();

    EXPECT_FALSE(this->first);
    EXPECT_FALSE(this->second);
    EXPECT_TRUE(this->third);
    EXPECT_TRUE(this->owner);
    EXPECT_TRUE(this->collection.empty());
    EXPECT_EQ(this->counter.commits, 1);
    this->collection.destroyAllContents();
    EXPECT_EQ(this->counter.commits, 2) << "of nothing, too";
    this->model->removeListener(&this->counter);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, GetsDestroyedContentsBackByARollback)
{
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->collection.destroyAllContents();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(this->first);
    EXPECT_TRUE(this->second);
    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, TakesAnElementOfAnotherOwnerAndGivesItBackByARollback)
{
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    TypeParam::add(TypeParam::of(this->another), this->first);
    EXPECT_EQ(TypeParam::of(this->another).size(), 1u);
    this->expectSound();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->isTied(this->first), this->ties());
    EXPECT_TRUE(TypeParam::of(this->another).empty());
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, EmptiedWithoutUpkeepIsAsItWasAfterARollback)
{
    this->add(this->danglingEntry());
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->generic.genericBasicClear();
    EXPECT_TRUE(this->contents().empty());
    EXPECT_EQ(this->isTied(this->first), this->ties());
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, MayHoldItsOwnerUnlessItContains)
{
    auto const before = this->contents();
    if (!this->collection.isComposite())
    {
        this->add(this->owner);
        EXPECT_TRUE(this->collection.contains(this->owner));
        this->remove(this->owner);
    }
    else
    {
        TypeParam::add(TypeParam::of(this->first), this->another);
        EXPECT_RAISES(messages::CircularContainment, this->add(this->owner));
        EXPECT_RAISES(messages::CircularContainment,
                      TypeParam::add(TypeParam::of(this->another), this->owner));
    }

    EXPECT_EQ(this->contents(), before);
    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->expectSound();
}

// ---------------------------------------------------------------------------- proxies

TYPED_TEST_P(CollectionOfElements, KeepsAProxyThatCanNotBeResolvedUntilItIsTakenOut)
{
    auto const before = this->contents();
    auto const proxy = this->danglingEntry();

    this->add(proxy);
    this->collection.resolveLocal();
    this->collection.resolveAll();
    EXPECT_EQ(this->collection.getAllValues().size(), 2u);
    EXPECT_EQ(this->collection.getAllValuesAndProxies().size(), 3u);
    EXPECT_EQ(this->generic.genericSize(), this->generic.isSequenceInterface() ? 3u : 2u);
    EXPECT_FALSE(this->collection.contains(proxy));

    this->remove(proxy);
    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, LosesAProxyThatWasAddedByARollback)
{
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->add(this->danglingEntry());
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, GetsAProxyBackByARollback)
{
    auto const proxy = this->danglingEntry();
    this->add(proxy);
    auto const before = this->contents();

    Transaction const removal = this->model->beginTransaction(/*revertible=*/true);
    this->remove(proxy);
    EXPECT_EQ(removal.rollBack(), TransactionResult::RolledBack);
    EXPECT_EQ(this->contents(), before);
    Transaction const clearing = this->model->beginTransaction(/*revertible=*/true);
    this->collection.clear();
    EXPECT_TRUE(this->contents().empty());
    EXPECT_EQ(clearing.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, GetsAProxyBackWithItsOwnElementByARollback)
{
    auto const proxy = this->danglingEntry();
    this->add(proxy);
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->owner->destroy();
    EXPECT_EQ(static_cast<bool>(proxy), !this->collection.isComposite());
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(proxy);
    EXPECT_TRUE(proxy->isProxy());
    EXPECT_EQ(this->contents(), before);
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, IgnoresProxiesOnceItsElementIsDestroyed)
{
    this->owner->destroy();
    auto const before = this->contents();

    this->add(this->danglingEntry());
    this->remove(this->danglingEntry());
    this->collection.destroyAllContents();

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(static_cast<bool>(this->first), !this->collection.isComposite());
}

TYPED_TEST_P(CollectionOfElements, PutsAnElementInThePlaceOfItsProxy)
{
    auto const proxy =
        TypeParam::proxy(this->model, this->third->getPersistentProxyId(/*omitModel=*/true));
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);
    this->add(proxy);

    this->collection.replaceProxy(this->third, 2);
    transaction.commit();

    EXPECT_EQ(this->collection.size(), 3u);
    EXPECT_EQ(this->collection.getAllValuesAndProxies().size(), 3u);
    EXPECT_TRUE(this->collection.contains(this->third));
    EXPECT_EQ(this->isTied(this->third), this->ties());
    this->expectSound();
}

TYPED_TEST_P(CollectionOfElements, RefusesAProxyIntoAnotherModelIfItContains)
{
    auto const before = this->contents();
    auto const proxy = TypeParam::proxy(
        this->model, ProxyId(ElementId::UUID_TYPE, u"00000000-0000-4000-8000-000000000001",
                             ustring(u"memory://elsewhere")));
    if (this->collection.isComposite())
    {
        EXPECT_RAISES_WITH(messages::CannotCreateCrossModelAssociation, this->add(proxy));
    }
    else
    {
        this->add(proxy);
        EXPECT_EQ(this->contents().size(), 3u);
        this->remove(proxy);
    }

    EXPECT_EQ(this->contents(), before);
    EXPECT_FALSE(this->model->getCurrentTransaction());
}

REGISTER_TYPED_TEST_SUITE_P(
    CollectionOfElements, IsChangedByThoseWhoDoNotKnowItsClass, IgnoresNullAndDestroyedElements,
    ListsItsElementsOnceEach, IgnoresWhatItHoldsUnlessItTakesRepetitions,
    SeesToItThatAnElementIsThere, RefusesElementsOfAnotherClass, RefusesElementsThatCanNotReferBack,
    KeepsTheElementsInStep, LosesADestroyedElementThatKnowsItAndGetsItBackByARollback,
    DestroysAllItsContentsInOneTransaction, GetsDestroyedContentsBackByARollback,
    TakesAnElementOfAnotherOwnerAndGivesItBackByARollback,
    EmptiedWithoutUpkeepIsAsItWasAfterARollback, MayHoldItsOwnerUnlessItContains,
    KeepsAProxyThatCanNotBeResolvedUntilItIsTakenOut, LosesAProxyThatWasAddedByARollback,
    GetsAProxyBackByARollback, GetsAProxyBackWithItsOwnElementByARollback,
    IgnoresProxiesOnceItsElementIsDestroyed, PutsAnElementInThePlaceOfItsProxy,
    RefusesAProxyIntoAnotherModelIfItContains);
}  // namespace testkit
