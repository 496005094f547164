/// \file
/// What holds for all maps and multimaps of elements, seen without their types.
#pragma once
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/contract/CollectionKinds.h"

namespace testkit {

/// Elements by names of one letter; holds those of the second letter and of the first.
template <class Kind> class KeyedElements : public CollectionFixture
{
protected:
    using Elements = std::vector<ModelElement>;

    KeyedElements()
    {
        generic.genericAdd(second);
        generic.genericAdd(first);
    }

    auto contents() { return Kind::contents(collection); }
    /// The elements under the key of that letter, of a map too.
    Elements find(int number) { return findBy(keyOf(number)); }
    Elements findBy(Value const& key)
    {
        if (auto* const multimap = dynamic_cast<GenericMultimapInterface*>(&generic))
            return multimap->genericFind(key);
        ModelElement const found = dynamic_cast<GenericMapInterface&>(generic).genericFind(key);
        return found.getImpl() ? Elements{found} : Elements{};
    }
    std::vector<Value> keys()
    {
        if (auto* const multimap = dynamic_cast<GenericMultimapInterface*>(&generic))
            return multimap->genericKeys();
        return dynamic_cast<GenericMapInterface&>(generic).genericKeys();
    }
    meta::Type keyType()
    {
        if (auto* const multimap = dynamic_cast<GenericMultimapInterface*>(&generic))
            return multimap->getKeyType();
        return dynamic_cast<GenericMapInterface&>(generic).getKeyType();
    }
    static Value keyOf(int number)
    {
        return Value(meta::StandardTypes::stringMeta, letter(number));
    }
    void expectSound() { EXPECT_EQ(model->checkInvariants(), std::vector<string>()); }

    typename Kind::Owner const owner = Kind::owner(model);
    typename Kind::Collection& collection = Kind::of(owner);
    GenericCollectionInterface& generic = genericOf(collection);
    ModelElement const first = Kind::entry(model, 0);
    ModelElement const second = Kind::entry(model, 1);
    DeepCounter counter;
};

TYPED_TEST_SUITE_P(KeyedElements);

TYPED_TEST_P(KeyedElements, AreSeenAsAMapOrAMultimap)
{
    EXPECT_FALSE(this->generic.isSequenceInterface());
    EXPECT_NE(this->generic.isMapInterface(), this->generic.isMultimapInterface());
    EXPECT_EQ(this->keyType(), meta::StandardTypes::stringMeta);
}

TYPED_TEST_P(KeyedElements, AreFoundByTheirKeys)
{
    EXPECT_EQ(this->find(0), typename TestFixture::Elements({this->first}));
    EXPECT_EQ(this->find(1), typename TestFixture::Elements({this->second}));
    EXPECT_EQ(this->find(2), typename TestFixture::Elements());
}

TYPED_TEST_P(KeyedElements, HaveKeysInAscendingOrderEachOnce)
{
    EXPECT_EQ(this->keys(), (std::vector{this->keyOf(0), this->keyOf(1)}));

    if (this->generic.isMultimapInterface())
        this->generic.genericAdd(TypeParam::entry(this->model, 1));

    EXPECT_EQ(this->keys(), (std::vector{this->keyOf(0), this->keyOf(1)}));
    EXPECT_EQ(this->collection.getAllValues().front(), this->first);
}

TYPED_TEST_P(KeyedElements, ShareAKeyInAMultimapOnly)
{
    auto const before = this->contents();
    ModelElement const twin = TypeParam::entry(this->model, 0);
    if (this->generic.isMultimapInterface())
    {
        this->generic.genericAdd(twin);
        EXPECT_EQ(this->find(0), typename TestFixture::Elements({this->first, twin}));
        this->generic.genericRemove(this->first);
        EXPECT_EQ(this->find(0), typename TestFixture::Elements({twin}));
    }
    else
    {
        EXPECT_RAISES_WITH(messages::UniquenessConstraint, this->generic.genericAdd(twin));
        EXPECT_EQ(this->contents(), before);
        EXPECT_TRUE(twin->isTopLevel());
        this->generic.genericRemove(this->first);
        this->generic.genericAdd(twin);
        EXPECT_EQ(this->find(0), typename TestFixture::Elements({twin}));
    }
    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->expectSound();
}

TYPED_TEST_P(KeyedElements, AreNotFoundByAKeyOfAnotherType)
{
    meta::StandardTypes::ensureInitialized();

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       this->findBy(Value(meta::StandardTypes::integerMeta, 1)), u"Integer");
}

TYPED_TEST_P(KeyedElements, HaveTheirKeysBackAfterARollback)
{
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->generic.genericRemove(this->first);
    this->generic.genericAdd(TypeParam::entry(this->model, 0));
    this->second->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->find(0), typename TestFixture::Elements({this->first}));
    EXPECT_EQ(this->find(1), typename TestFixture::Elements({this->second}));
    this->expectSound();
}

TYPED_TEST_P(KeyedElements, StandBesideProxiesWhichHaveNoKeys)
{
    this->generic.genericAdd(TypeParam::proxy(
        this->model, ProxyId(ElementId::UUID_TYPE, u"00000000-0000-4000-8000-000000000001")));

    EXPECT_EQ(this->generic.genericSize(), 2u);
    EXPECT_EQ(this->keys().size(), 2u);
    EXPECT_EQ(this->collection.getAllValuesAndProxies().size(), 3u);
}

REGISTER_TYPED_TEST_SUITE_P(KeyedElements, AreSeenAsAMapOrAMultimap, AreFoundByTheirKeys,
                            HaveKeysInAscendingOrderEachOnce, ShareAKeyInAMultimapOnly,
                            AreNotFoundByAKeyOfAnotherType, HaveTheirKeysBackAfterARollback,
                            StandBesideProxiesWhichHaveNoKeys);
}  // namespace testkit
