// Collections of literals without a C++ type.
#include "tarnkiln/collections/ReflectiveEnumCollection.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/collections/CollectionFixture.h"

namespace testkit {
namespace {

class LiteralCollection : public CollectionFixture
{
protected:
    LiteralCollection()
    {
        meta::StandardTypes::ensureInitialized();
        shape->setName(u"Shape");
        property->setType(colour);
        property->setUpper(0xFFFFFFFF);
        property->setPropertyIndex(static_cast<int>(Node::Impl::NUMBERS.index));
    }

    using Owned = std::unique_ptr<AbstractPrimitiveCollection>;

    Owned make(bool ordered, bool unique = false, ModelElement const& of = {})
    {
        property->setIsOrdered(ordered);
        property->setIsUnique(unique);
        return Owned(
            static_cast<AbstractPrimitiveCollection*>(makeReflectiveEnumCollection(of, property)));
    }
    Value number(long value) const { return Value(colour, value); }

    Model const types = Model::create(ModelConstellation());
    meta::Enum const colour = meta::Enum::create(types);
    meta::Enum const shape = meta::Enum::create(types);
    meta::Property const property = meta::Property::create(types);
    Node const owner = node(u"owner");
};

using LiteralSequence = LiteralCollection;
using LiteralSet = LiteralCollection;

TEST_F(LiteralSequence, IsMadeForAnOrderedProperty)
{
    Owned const sequence = make(/*ordered=*/true, /*unique=*/false, owner);

    EXPECT_TRUE(dynamic_cast<ReflectiveEnumSequence*>(sequence.get()));
    EXPECT_EQ(sequence->getKind(), AbstractPrimitiveCollection::SEQUENCE);
    EXPECT_EQ(sequence->getCollectionType(), colour);
    EXPECT_EQ(sequence->getOwner(), owner.getImpl());
}

TEST_F(LiteralSequence, KeepsLiteralsInOrder)
{
    Owned const sequence = make(/*ordered=*/true);
    auto& generic =
        dynamic_cast<GenericPrimitiveSequenceInterface&>(*sequence->getGenericInterface());

    for (long const value : {3L, -1L, 3L})
        sequence->genericAdd(number(value));
    generic.genericInsert(number(7), 1);
    generic.genericReplace(number(8), 0);

    EXPECT_EQ(sequence->getAllValues(),
              (std::vector<Value>{number(8), number(7), number(-1), number(3)}));
    EXPECT_EQ(generic.genericAt(2), number(-1));
    EXPECT_EQ(generic.genericIndexOf(number(-1)), 2);
    EXPECT_EQ(generic.genericIndexOf(number(5)), -1);
    sequence->genericRemove(number(-1));
    generic.genericRemoveAt(0);
    EXPECT_EQ(sequence->getAllValues(), (std::vector<Value>{number(7), number(3)}));
}

TEST_F(LiteralSequence, RefusesDuplicatesIfUnique)
{
    Owned const sequence = make(/*ordered=*/true, /*unique=*/true);

    sequence->genericAdd(number(3));
    sequence->genericAdd(number(3));

    EXPECT_EQ(sequence->size(), 1u);
}

TEST_F(LiteralSequence, RefusesNumbersAndLiteralsOfOtherEnumerations)
{
    Owned const sequence = make(/*ordered=*/true);
    auto& generic =
        dynamic_cast<GenericPrimitiveSequenceInterface&>(*sequence->getGenericInterface());
    sequence->genericAdd(number(3));

    for (Value const& wrong : {Value(shape, 3L), Value(meta::StandardTypes::integer64Meta, 3L)})
    {
        ustring const type = wrong.getType()->getQualifiedName();
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, sequence->genericAdd(wrong),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, sequence->genericRemove(wrong),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericInsert(wrong, 0),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericReplace(wrong, 0),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericIndexOf(wrong),
                           type);
    }
    EXPECT_EQ(sequence->getAllValues(), std::vector<Value>{number(3)});
}

TEST_F(LiteralSet, IsMadeForAPropertyWithoutOrder)
{
    Owned const set = make(/*ordered=*/false, /*unique=*/false, owner);

    EXPECT_TRUE(dynamic_cast<ReflectiveEnumSet*>(set.get()));
    EXPECT_EQ(set->getKind(), AbstractPrimitiveCollection::SET);
    EXPECT_EQ(set->getCollectionType(), colour);
    EXPECT_EQ(set->getOwner(), owner.getImpl());
    EXPECT_EQ(set->getGenericInterface(), nullptr);
}

TEST_F(LiteralSet, HoldsEachLiteralOnceAndRefusesOthers)
{
    Owned const set = make(/*ordered=*/false);
    for (long const value : {3L, -1L, 3L})
        set->genericAdd(number(value));

    EXPECT_EQ(set->getAllValues(), (std::vector<Value>{number(-1), number(3)}));
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, set->genericAdd(Value(shape, 5L)),
                       u"Shape");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, set->genericRemove(Value(shape, 3L)),
                       u"Shape");
    set->genericRemove(number(3));
    EXPECT_EQ(set->getAllValues(), std::vector<Value>{number(-1)});
}

TEST_F(LiteralCollection, IsBracketedByATransactionOfItsOwn)
{
    Owned const sequence = make(/*ordered=*/true, /*unique=*/false, owner);
    DeepCounter counter;
    Listening const listening(model, counter);

    sequence->genericAdd(number(3));

    EXPECT_EQ(counter.commits, 1);
    EXPECT_TRUE(counter.sawChanged({owner}));
}

TEST_F(LiteralCollection, IsMadeByTheRegistryForARegisteredEnumeration)
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    colour->setName(u"LiteralCollectionColour");
    registry.registerType(colour, makeReflectiveEnumCollection, /*builder=*/nullptr);

    std::unique_ptr<AbstractOwnedCollection> const made(
        registry.instantiateDynamicCollection(owner, property));

    EXPECT_TRUE(dynamic_cast<ReflectiveEnumSet*>(made.get()));
    meta::MetaRegistry::LockedModel const locked(registry);
    registry.unregisterType(colour, colour->getQualifiedName());
}
}  // namespace
}  // namespace testkit
