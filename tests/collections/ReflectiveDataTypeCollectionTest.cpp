// Collections of structured values without a C++ class.
#include "tarnkiln/collections/ReflectiveDataTypeCollection.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/collections/CollectionFixture.h"
#include "tests/support/Uuids.h"

namespace testkit {
namespace {

using meta::MetaRegistry;
using Types = meta::StandardTypes;

/// Entries with a name, which may be a key, and a page.
class StructuredCollection : public CollectionFixture
{
protected:
    StructuredCollection()
    {
        Types::ensureInitialized();
        entry->setName(u"Entry");
        meta::Package const books = meta::Package::create(types);
        books->setName(u"books");
        entry->setOwningPackage(books);
        name = field(u"name", Types::stringMeta);
        page = field(u"page", Types::integerMeta);
        property->setType(entry);
        property->setUpper(0xFFFFFFFF);
        property->setPropertyIndex(static_cast<int>(Node::Impl::NUMBERS.index));
    }

    meta::Property field(ustring const& fieldName, meta::Type const& type)
    {
        meta::Property const made = meta::Property::create(types);
        made->setName(fieldName);
        made->setType(type);
        made->setLower(1);
        made->setUpper(1);
        made->setOwningType(entry);
        return made;
    }
    /// An entry on `number`, with a name.
    Value on(int number, ustring const& text = u"") const
    {
        ReflectiveDataType made(entry);
        made.setPropertyValue(name, Value(Types::stringMeta, text));
        made.setPropertyValue(page, Value(Types::integerMeta, number));
        return Value::createReflectiveDataTypeValue(made);
    }
    static std::vector<Value> listOf(AbstractPrimitiveCollection const& collection)
    {
        return collection.getAllValues();
    }

    Model const types = Model::create(ModelConstellation());
    meta::DataType const entry = meta::DataType::create(types);
    meta::Property const property = meta::Property::create(types);
    meta::Property name;
    meta::Property page;
    Node const owner = node(u"owner");
    ReflectiveDataTypeSequence sequence{entry, owner, property};
    GenericPrimitiveSequenceInterface& generic =
        dynamic_cast<GenericPrimitiveSequenceInterface&>(*sequence.getGenericInterface());
};

using StructuredSequence = StructuredCollection;
using StructuredAssociative = StructuredCollection;

TEST_F(StructuredSequence, TellsItsKindTypeOwnerAndProperty)
{
    AbstractPrimitiveCollection const& collection = sequence;

    EXPECT_EQ(collection.getKind(), 1);
    EXPECT_EQ(collection.getCollectionType(), entry);
    EXPECT_EQ(collection.getOwner(), owner.getImpl());
    EXPECT_EQ(collection.getCollectionProperty(), property);
    EXPECT_EQ(collection.size(), 0u);
}

TEST_F(StructuredSequence, KeepsTheOrderAndEqualEntries)
{
    sequence.genericAdd(on(3));
    sequence.genericAdd(on(1));
    sequence.genericAdd(on(3));

    EXPECT_EQ(listOf(sequence), (std::vector<Value>{on(3), on(1), on(3)}));
    EXPECT_EQ(generic.genericAt(1), on(1));
    EXPECT_TRUE(generic.genericAt(1).isReflective());
    EXPECT_EQ(generic.genericIndexOf(on(3)), 0);
    EXPECT_EQ(generic.genericIndexOf(on(4)), -1);
}

TEST_F(StructuredSequence, InsertsReplacesAndRemovesAtPositions)
{
    sequence.genericAdd(on(1));

    generic.genericInsert(on(0), 0);
    generic.genericInsert(on(2), 2);
    generic.genericReplace(on(7), 1);
    EXPECT_EQ(listOf(sequence), (std::vector<Value>{on(0), on(7), on(2)}));

    generic.genericRemoveAt(1);
    EXPECT_EQ(listOf(sequence), (std::vector<Value>{on(0), on(2)}));
}

TEST_F(StructuredSequence, RemovesTheFirstEqualEntryAndAllOfThem)
{
    for (int const number : {1, 2, 1})
        sequence.genericAdd(on(number));

    sequence.genericRemove(on(1));
    EXPECT_EQ(listOf(sequence), (std::vector<Value>{on(2), on(1)}));
    sequence.clear();
    EXPECT_EQ(sequence.size(), 0u);
}

TEST_F(StructuredSequence, RefusesValuesOfAnotherTypeOrShapeEverywhere)
{
    sequence.genericAdd(on(1));
    meta::DataType const other = meta::DataType::create(types);
    for (Value const& wrong :
         {Value(Types::integerMeta, 1), Value::createReflectiveDataTypeValue(other, true),
          Value::createCollectionValue(property, &sequence)})
    {
        ustring const type = u"books.Entry";
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, sequence.genericAdd(wrong), type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, sequence.genericRemove(wrong),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericInsert(wrong, 0),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericReplace(wrong, 0),
                           type);
        EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, generic.genericIndexOf(wrong),
                           type);
    }
    EXPECT_EQ(listOf(sequence), std::vector<Value>{on(1)});
}

TEST_F(StructuredSequence, RefusesAnAbsentValue)
{
    Value const absent = Value::createReflectiveDataTypeValue(entry, false);

    EXPECT_RAISES(messages::InvalidValue, sequence.genericAdd(absent));
    EXPECT_RAISES(messages::InvalidValue, generic.genericIndexOf(absent));
    EXPECT_EQ(sequence.size(), 0u);
}

TEST_F(StructuredSequence, OpensNoTransactionOfItsOwn)
{
    DeepCounter counter;
    Listening const listening(model, counter);
    sequence.basicDropContents();

    EXPECT_RAISES(messages::NoOpenTransaction, sequence.genericAdd(on(1)));
    EXPECT_RAISES(messages::NoOpenTransaction, sequence.clear());
    EXPECT_EQ(sequence.size(), 0u);
    EXPECT_EQ(counter.commits, 0);
}

TEST_F(StructuredSequence, AnnouncesEachChangeAndNoRemovalOfWhatIsNotThere)
{
    DeepCounter counter;
    Listening const listening(model, counter);
    auto const isSeen = [&](auto const& change) {
        counter.changed.clear();
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        change();
        transaction.commit();
        return counter.sawChanged({owner});
    };

    EXPECT_TRUE(isSeen([&] { sequence.genericAdd(on(1)); }));
    EXPECT_TRUE(isSeen([&] { generic.genericReplace(on(1), 0); })) << "by an equal one too";
    EXPECT_FALSE(isSeen([&] { sequence.genericRemove(on(2)); }));
    EXPECT_TRUE(isSeen([&] { sequence.genericRemove(on(1)); }));
    EXPECT_TRUE(isSeen([&] { sequence.clear(); }));
}

TEST_F(StructuredSequence, CopiesSwapsAndDropsContents)
{
    ReflectiveDataTypeSequence snapshot(entry, ModelElement(), property);
    sequence.genericAdd(on(1));

    snapshot.copyContents(sequence);
    sequence.genericAdd(on(2));
    EXPECT_EQ(listOf(snapshot), std::vector<Value>{on(1)});

    sequence.basicSwapContents(snapshot);
    EXPECT_EQ(listOf(sequence), std::vector<Value>{on(1)});
    EXPECT_EQ(snapshot.size(), 2u);
    snapshot.basicDropContents();
    EXPECT_EQ(snapshot.size(), 0u);
}

TEST_F(StructuredSequence, IgnoresChangesOnceItsOwnerIsDestroyed)
{
    sequence.genericAdd(on(1));
    owner->destroy();

    sequence.genericAdd(on(2));
    sequence.genericRemove(on(1));
    generic.genericReplace(on(3), 0);
    sequence.clear();

    EXPECT_EQ(listOf(sequence), std::vector<Value>{on(1)});
}

/// A keyed collection of the fixture's entries, keyed by name.
class Index
{
public:
    Index(meta::DataType const& entry, meta::Property const& key, ModelElement const& owner,
          meta::Property const& property, bool uniqueKeys)
        : m_owned(MetaRegistry::getInstance().createReflectiveDataTypeAssociative(
              entry, key, owner, property, uniqueKeys))
    {}

    AbstractPrimitiveCollection* operator->() const
    {
        return static_cast<AbstractPrimitiveCollection*>(m_owned.get());
    }
    AbstractPrimitiveCollection& operator*() const { return *operator->(); }
    GenericPrimitiveAssociativeInterface& generic() const
    {
        return dynamic_cast<GenericPrimitiveAssociativeInterface&>(
            *operator->()->getGenericInterface());
    }
    std::vector<Value> at(ustring const& key) const
    {
        return generic().genericFind(Value(Types::stringMeta, key));
    }

private:
    std::unique_ptr<AbstractOwnedCollection> const m_owned;
};

TEST_F(StructuredAssociative, TellsItsKindTypeAndKeys)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);

    EXPECT_EQ(index->getKind(), 2);
    EXPECT_EQ(index->getCollectionType(), entry);
    EXPECT_EQ(index->getOwner(), owner.getImpl());
    EXPECT_EQ(index.generic().getKeyType(), Types::stringMeta);
    EXPECT_TRUE(dynamic_cast<ReflectiveDataTypeAssociative<ustring>*>(&*index));
}

TEST_F(StructuredAssociative, FindsEntriesByKeyInTheOrderInWhichTheyCame)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);
    index->genericAdd(on(3, u"b"));
    index->genericAdd(on(1, u"b"));
    index->genericAdd(on(2, u"a"));
    index->genericAdd(on(3, u"b"));

    EXPECT_EQ(index.at(u"b"), (std::vector<Value>{on(3, u"b"), on(1, u"b"), on(3, u"b")}));
    EXPECT_EQ(index.at(u"c"), std::vector<Value>());
    EXPECT_EQ(index.generic().genericKeys(),
              (std::vector<Value>{Value(Types::stringMeta, ustring(u"a")),
                                  Value(Types::stringMeta, ustring(u"b"))}));
    EXPECT_EQ(listOf(*index).front(), on(2, u"a"));
    EXPECT_EQ(index->size(), 4u);
}

TEST_F(StructuredAssociative, DropsASecondEntryOfAUniqueKeySilently)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/true);
    index->genericAdd(on(1, u"a"));

    index->genericAdd(on(2, u"a"));

    EXPECT_EQ(listOf(*index), std::vector<Value>{on(1, u"a")});
}

TEST_F(StructuredAssociative, PassesOverTheEntryBehindEachRemovedOne)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);
    for (int round = 0; round < 5; ++round)
        index->genericAdd(on(1, u"a"));
    index->genericAdd(on(1, u"b"));

    index->genericRemove(on(1, u"a"));
    EXPECT_EQ(index.at(u"a").size(), 2u) << "the second and the fourth stay";
    index->genericRemove(on(1, u"a"));
    EXPECT_EQ(index.at(u"a").size(), 1u);
    index->genericRemove(on(1, u"a"));
    EXPECT_EQ(index.at(u"a").size(), 0u);
    EXPECT_EQ(index.at(u"b").size(), 1u);
}

TEST_F(StructuredAssociative, RemovesEqualEntriesThatOthersStandBetween)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);
    for (int const number : {1, 2, 3, 1, 4})
        index->genericAdd(on(number, u"a"));

    index->genericRemove(on(1, u"a"));
    index->genericRemove(on(9, u"a"));
    index->genericRemove(on(2, u"b"));

    EXPECT_EQ(listOf(*index), (std::vector<Value>{on(2, u"a"), on(3, u"a"), on(4, u"a")}));
}

TEST_F(StructuredAssociative, RefusesValuesAndKeysOfAnotherType)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);
    Value const number(Types::integerMeta, 1);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, index->genericAdd(number),
                       u"books.Entry");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, index->genericRemove(number),
                       u"books.Entry");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, index.generic().genericFind(number),
                       u"Integer");
}

TEST_F(StructuredAssociative, RefusesAnEntryWithoutAKey)
{
    name->setLower(0);
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       index->genericAdd(Value::createReflectiveDataTypeValue(entry, true)),
                       u"String");
    EXPECT_EQ(index->size(), 0u);
}

TEST_F(StructuredAssociative, OpensNoTransactionOfItsOwnAndAnnouncesNoIdleChange)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/true);
    index->genericAdd(on(1, u"a"));
    DeepCounter counter;
    Listening const listening(model, counter);

    EXPECT_RAISES(messages::NoOpenTransaction, index->genericAdd(on(1, u"b")));
    EXPECT_RAISES(messages::NoOpenTransaction, index->genericRemove(on(1, u"a")));
    EXPECT_RAISES(messages::NoOpenTransaction, index->clear());
    EXPECT_EQ(index->size(), 1u);
    index->genericAdd(on(2, u"a"));
    index->genericRemove(on(2, u"a"));
    EXPECT_EQ(counter.commits, 0);
}

TEST_F(StructuredAssociative, CopiesSwapsAndDropsContents)
{
    Index const index(entry, name, owner, property, /*uniqueKeys=*/false);
    Index const snapshot(entry, name, ModelElement(), property, /*uniqueKeys=*/false);
    index->genericAdd(on(1, u"a"));

    snapshot->copyContents(*index);
    index->genericAdd(on(2, u"a"));
    index->basicSwapContents(*snapshot);
    EXPECT_EQ(index->size(), 1u);
    EXPECT_EQ(snapshot->size(), 2u);
    snapshot->basicDropContents();
    EXPECT_EQ(snapshot->size(), 0u);
}

template <class K>
void expectKey(Index const& index, K const& least, K const& greatest, meta::DataType const& entry,
               meta::Property const& key)
{
    EXPECT_TRUE((dynamic_cast<ReflectiveDataTypeAssociative<K>*>(&*index)));
    for (K const& value : {greatest, least, greatest})
    {
        ReflectiveDataType made(entry);
        made.setPropertyValue(key, Value(key->getType(), value));
        index->genericAdd(Value::createReflectiveDataTypeValue(made));
    }
    EXPECT_EQ(index.generic().genericKeys(),
              (std::vector<Value>{Value(key->getType(), least), Value(key->getType(), greatest)}));
    EXPECT_EQ(index.generic().genericFind(Value(key->getType(), greatest)).size(), 2u);
}

TEST_F(StructuredAssociative, HasKeysOfElevenTypes)
{
    auto const expect = [&]<class K>(meta::Type const& type, K const& least, K const& greatest) {
        meta::Property const key = field(u"key of " + type->getName(), type);
        Index const index(entry, key, owner, property, /*uniqueKeys=*/false);
        SCOPED_TRACE(testing::PrintToString(type->getName()));
        expectKey<K>(index, least, greatest, entry, key);
    };
    expect(Types::integerMeta, -1, 1);
    expect(Types::integer8Meta, static_cast<signed char>(-1), static_cast<signed char>(1));
    expect(Types::integer16Meta, static_cast<short>(-1), static_cast<short>(1));
    expect(Types::integer64Meta, -1L, 1L);
    expect(Types::unlimitedNaturalMeta, 1u, ~0u);
    expect(Types::uinteger8Meta, static_cast<unsigned char>(1), static_cast<unsigned char>(255));
    expect(Types::uinteger16Meta, static_cast<unsigned short>(1), static_cast<unsigned short>(2));
    expect(Types::uinteger64Meta, 1ul, ~0ul);
    expect(Types::stringMeta, ustring(u"a"), ustring(u"b"));
    expect(Types::stdstringMeta, string("a"), string("b"));
    expect(Types::uuidMeta, uuidOf(1), uuidOf(2));
}

TEST_F(StructuredAssociative, KeepsLiteralsAsTheirNumbers)
{
    meta::Enum const colour = meta::Enum::create(types);
    meta::Property const hue = field(u"hue", colour);
    Index const index(entry, hue, owner, property, /*uniqueKeys=*/false);
    for (long const number : {3L, -1L, 3L})
    {
        ReflectiveDataType made(entry);
        made.setPropertyValue(hue, Value(colour, number));
        index->genericAdd(Value::createReflectiveDataTypeValue(made));
    }

    EXPECT_TRUE(dynamic_cast<ReflectiveDataTypeAssociative<int>*>(&*index));
    EXPECT_EQ(index.generic().getKeyType(), colour);
    EXPECT_EQ(index.generic().genericKeys(),
              (std::vector<Value>{Value(colour, -1L), Value(colour, 3L)}));
    EXPECT_EQ(index.generic().genericFind(Value(colour, 3L)).size(), 2u);
}

TEST_F(StructuredAssociative, HasNoKeysOfOtherTypes)
{
    for (meta::Type const& type :
         {Types::booleanMeta, Types::realMeta, Types::dateTimeMeta, Types::hostArrayMeta})
    {
        meta::Property const key = field(u"key of " + type->getName(), type);
        EXPECT_RAISES_WITH(messages::UnsupportedQualification,
                           Index(entry, key, owner, property, true), type->getName());
    }
    meta::Property const structured = field(u"structured", entry);
    EXPECT_RAISES_WITH(messages::UnsupportedQualification,
                       Index(entry, structured, owner, property, true), u"books.Entry");
}
}  // namespace
}  // namespace testkit
