/// \file
/// The collections that the registry makes for properties.
#include "tarnkiln/collections/ReflectiveDataTypeCollection.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"

namespace tarn::kiln::meta {
namespace {

using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;

MetaRegistry& registry()
{
    return MetaRegistry::getInstance();
}

/// Holds nothing; tells who asked for it.
class IdleCollection : public AbstractOwnedCollection
{
public:
    IdleCollection(ModelElement const& owner, Property const& property)
        : AbstractOwnedCollection(owner.getImpl(), property)
    {}

    Type getCollectionType() const override { return {}; }
    void copyContents(AbstractOwnedCollection const&) override {}
    void basicSwapContents(AbstractOwnedCollection&) noexcept override {}
    void basicDropContents() noexcept override {}
};

class OtherIdleCollection final : public IdleCollection
{
public:
    using IdleCollection::IdleCollection;
};

template <class Collection>
AbstractOwnedCollection* make(ModelElement const& owner, Property const& property)
{
    return new Collection(owner, property);
}

/// A type and a property of that type, in the registry for the length of a test.
template <class Handle> class DynamicCollection : public ::testing::Test
{
protected:
    using Collection = std::unique_ptr<AbstractOwnedCollection>;

    DynamicCollection()
    {
        RegistrySession session;
        property->setType(type.get());
        session.commit();
    }

    Collection instantiate(ModelElement const& owner = {}) const
    {
        return Collection(registry().instantiateDynamicCollection(owner, property));
    }

    RegistryElement<Handle> type{u"Listed"};
    RegistryElement<Property> property{u"list"};
};

using CollectionOfAClass = DynamicCollection<Class>;
using CollectionOfADataType = DynamicCollection<DataType>;

TEST_F(CollectionOfAClass, IsMadeForTheGivenOwner)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);

    Collection const collection = instantiate(type.get());

    ASSERT_NE(dynamic_cast<IdleCollection*>(collection.get()), nullptr);
    EXPECT_EQ(collection->getOwner(), type.get().getImpl());
    EXPECT_EQ(collection->getCollectionProperty(), property.get());
}

TEST_F(CollectionOfAClass, IsASnapshotWithoutAnOwner)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);

    Collection const collection = instantiate();

    ASSERT_NE(collection, nullptr);
    EXPECT_EQ(collection->getOwner(), nullptr);
}

TEST_F(CollectionOfAClass, IsNullWithoutAnEntry)
{
    EXPECT_EQ(instantiate(), nullptr);
}

TEST_F(CollectionOfAClass, IsNullForAnEntryWithoutInstantiator)
{
    registry().registerType(type.get(), nullptr);

    EXPECT_EQ(instantiate(), nullptr);
}

TEST_F(CollectionOfAClass, IsNullIfTheEntryIsOfANamesake)
{
    RegistryElement<Class> const namesake(u"Listed");
    registry().registerType(namesake.get(), make<IdleCollection>, nullptr);

    EXPECT_EQ(instantiate(), nullptr);
}

TEST_F(CollectionOfAClass, IsNullForAPropertyWithoutType)
{
    RegistryElement<Property> const untyped(u"untyped");

    EXPECT_EQ(registry().instantiateDynamicCollection(ModelElement(), untyped.get()), nullptr);
}

TEST_F(CollectionOfAClass, ComesFromTheUpdatedInstantiator)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);
    registry().updateCollectionInstantiator(type.get(), make<OtherIdleCollection>);

    Collection const collection = instantiate();

    EXPECT_NE(dynamic_cast<OtherIdleCollection*>(collection.get()), nullptr);
}

TEST_F(CollectionOfADataType, IsMadeByTheInstantiatorOfATypeOfTheRegistry)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);

    Collection const collection = instantiate();

    EXPECT_NE(dynamic_cast<IdleCollection*>(collection.get()), nullptr);
}

TEST_F(CollectionOfADataType, IsNullForATypeOfTheRegistryWithoutAnEntry)
{
    EXPECT_EQ(instantiate(), nullptr);
}

TEST_F(CollectionOfADataType, IsAReflectiveSequenceForATypeOfAnotherModel)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);
    Model const model = Model::createRegistryModel(u"test://types");
    DataType const foreign = DataType::create(model);
    foreign->setName(u"Listed");
    Property const list = Property::create(model);
    list->setType(foreign);

    for (bool const ordered : {false, true})
    {
        list->setIsOrdered(ordered);
        Collection const collection(registry().instantiateDynamicCollection(foreign, list));
        auto const* const sequence = dynamic_cast<ReflectiveDataTypeSequence*>(collection.get());
        ASSERT_NE(sequence, nullptr);
        EXPECT_EQ(sequence->getCollectionType(), foreign);
        EXPECT_EQ(sequence->getOwner(), foreign.getImpl());
        EXPECT_EQ(sequence->getCollectionProperty(), list);
    }
}

/// The qualifying property of the collection.
class CollectionOfAQualifiedDataType : public CollectionOfADataType
{
protected:
    CollectionOfAQualifiedDataType() { qualify(StandardTypes::stringMeta, 1); }

    void qualify(Type const& keyType, unsigned int upper, bool unique = true)
    {
        RegistrySession session;
        key->setType(keyType);
        key->setUpper(upper);
        property->setQualifiedBy(key.get());
        property->setIsQualificationUnique(unique);
        session.commit();
    }

    RegistryElement<Property> key{u"key"};
};

TEST_F(CollectionOfAQualifiedDataType, IsAssociativeEvenIfTheTypeHasAnInstantiator)
{
    registry().registerType(type.get(), make<IdleCollection>, nullptr);
    for (bool const unique : {false, true})
    {
        qualify(StandardTypes::stringMeta, 1, unique);
        Collection const collection = instantiate();
        auto const* const keyed =
            dynamic_cast<ReflectiveDataTypeAssociative<ustring>*>(collection.get());
        ASSERT_NE(keyed, nullptr);
        EXPECT_EQ(keyed->isQualificationUnique(), unique);
        EXPECT_EQ(keyed->getKeyType(), StandardTypes::stringMeta);
    }
}

TEST_F(CollectionOfAQualifiedDataType, IsNullForAKeyOfManyValuesWithoutTypeOrOfAClass)
{
    qualify(StandardTypes::stringMeta, 2);
    EXPECT_EQ(instantiate(), nullptr);
    qualify(Type(), 1);
    EXPECT_EQ(instantiate(), nullptr);
    RegistryElement<Class> const keyClass(u"KeyClass");
    qualify(keyClass.get(), 1);
    EXPECT_EQ(instantiate(), nullptr);
}

TEST_F(CollectionOfAQualifiedDataType, IsRefusedForAKeyOfAnotherType)
{
    qualify(StandardTypes::booleanMeta, 1);

    EXPECT_RAISES_WITH(messages::UnsupportedQualification, instantiate(), u"Boolean");
}
}  // namespace
}  // namespace tarn::kiln::meta
