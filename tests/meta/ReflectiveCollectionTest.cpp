// Which collections the properties of reflective elements have, and what goes into them.
#include "tarnkiln/collections/ReflectiveDataTypeCollection.h"
#include "tarnkiln/collections/ReflectiveElementSequence.h"
#include "tarnkiln/collections/ReflectiveKeyedCollection.h"
#include "tarnkiln/collections/ReflectiveUnorderedElementSet.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"
#include "tests/meta/ReflectiveFixture.h"
#include "tests/support/InvalidationLog.h"

#include <typeinfo>

namespace testkit {
namespace {

class ReflectiveCollection : public ReflectiveFixture
{
protected:
    PropertySketch members(ustring const& name) { return metamodel.property(a, name, a).many(); }
    template <class Expected> static bool is(ReferenceCollection& collection)
    {
        return typeid(collection) == typeid(Expected);
    }
    /// A snapshot of the collection of `property`.
    std::unique_ptr<ReferenceCollection> snapshotOf(ModelElement const& element,
                                                    meta::Property const& property)
    {
        auto const& impl = dynamic_cast<ReflectiveModelElementImpl&>(*element.getImpl());
        return std::unique_ptr<ReferenceCollection>(static_cast<ReferenceCollection*>(
            impl.instantiateCollection(property, /*owned=*/false)));
    }

    meta::Class const a = metamodel.makeClass(u"A");
    meta::Class const subclass = metamodel.makeClass(u"SubclassOfA", a);
    meta::Class const b = metamodel.makeClass(u"B");
};

TEST_F(ReflectiveCollection, IsASequenceIfOrderedAndASetOtherwise)
{
    meta::Property const ordered = members(u"ordered").ordered();
    meta::Property const unordered = members(u"unordered");
    ModelElement const made = make(a);

    EXPECT_TRUE(is<ReflectiveElementSequence>(referencesOf(made, ordered)));
    EXPECT_TRUE(is<ReflectiveUnorderedElementSet>(referencesOf(made, unordered)));
    EXPECT_EQ(valueOf(made, ordered).getFlags(), ValueFlags::Sequence);
    EXPECT_EQ(valueOf(made, unordered).getFlags(), ValueFlags::Set);
}

TEST_F(ReflectiveCollection, IsOneObjectForTheLifeOfItsElement)
{
    meta::Property const ordered = members(u"ordered").ordered();
    ModelElement const made = make(a);

    EXPECT_EQ(&referencesOf(made, ordered), &referencesOf(made, ordered));
    EXPECT_EQ(valueOf(made, ordered), valueOf(made, ordered));
    EXPECT_EQ(referencesOf(made, ordered).getOwner(), made.getImpl());
    EXPECT_EQ(referencesOf(made, ordered).getCollectionProperty(), ordered);
}

TEST_F(ReflectiveCollection, TravelsInReflectiveForm)
{
    meta::Property const ordered = members(u"ordered").ordered();
    ModelElement const made = make(a);

    EXPECT_TRUE(valueOf(made, ordered).isReflective());
    EXPECT_EQ(valueOf(made, ordered).getType(), ModelElement::metaClass());
    EXPECT_EQ(referencesOf(made, ordered).getCollectionType(), ModelElement::metaClass());
}

TEST_F(ReflectiveCollection, HasAValueOnceItHasEntries)
{
    meta::Property const ordered = members(u"ordered").ordered();
    ModelElement const made = make(a);
    EXPECT_FALSE(has(made, ordered));

    genericOf(made, ordered).genericAdd(made);

    EXPECT_TRUE(has(made, ordered));
}

TEST_F(ReflectiveCollection, IsNotMadeToTellThatItHasNoEntries)
{
    meta::Property const asked = members(u"asked").ordered();
    meta::Property const read = members(u"read");
    ModelElement const made = make(a);
    InvalidationLog const log;

    EXPECT_FALSE(has(made, asked));
    EXPECT_FALSE(has(made, read));
    AbstractOwnedCollection* const collection = &referencesOf(made, read);
    made->destroy();

    std::vector<AbstractOwnedCollection*> ended;
    for (auto const& [element, dying] : log.calls())
    {
        if (dying)
            ended.push_back(dying);
    }
    EXPECT_THAT(ended, ElementsAre(collection));
}

TEST_F(ReflectiveCollection, RefusesAnUnrelatedClassAndAcceptsASubclass)
{
    meta::Property const name =
        metamodel.property(a, u"name", StandardTypes::stringMeta).required();
    std::vector<meta::Property> const properties = {
        members(u"ordered").ordered(), members(u"unordered"), members(u"keyed").keyedBy(name),
        members(u"grouped").groupedBy(name)};
    ModelElement const made = make(a), child = make(subclass), alien = make(b);

    for (meta::Property const& property : properties)
    {
        GenericCollectionInterface& collection = genericOf(made, property);
        collection.genericAdd(child);
        EXPECT_THAT(entriesOf(made, property), ElementsAre(child));
        EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, collection.genericAdd(alien),
                           u"rt.A", u"rt.B");
        EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes,
                           collection.genericEnsureAt(alien, 0), u"rt.A", u"rt.B");
        EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, collection.genericRemove(alien),
                           u"rt.A", u"rt.B");
        EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes,
                           ModelElement::Impl::_basicAdd(&referencesOf(made, property), alien),
                           u"rt.A", u"rt.B");
        EXPECT_THAT(entriesOf(made, property), ElementsAre(child));
    }
    GenericSequenceInterface& sequence = sequenceOf(made, properties[0]);
    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, sequence.genericInsert(alien, 0),
                       u"rt.A", u"rt.B");
    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, sequence.genericReplace(alien, 0),
                       u"rt.A", u"rt.B");
    EXPECT_EQ(sequence.genericIndexOf(alien), -1);
    EXPECT_EQ(sequence.genericIndexOf(child), 0);
}

TEST_F(ReflectiveCollection, IsUniqueAsThePropertySays)
{
    meta::Property const unique = members(u"unique").ordered().unique();
    meta::Property const plain = members(u"plain").ordered();
    ModelElement const made = make(a), entry = make(a);

    for (int i = 0; i < 2; ++i)
    {
        genericOf(made, unique).genericAdd(entry);
        genericOf(made, plain).genericAdd(entry);
    }

    EXPECT_THAT(entriesOf(made, unique), ElementsAre(entry));
    EXPECT_THAT(entriesOf(made, plain), ElementsAre(entry, entry));
}

TEST_F(ReflectiveCollection, ThatIsQualifiedIsKeyedEvenIfItIsOrdered)
{
    meta::Property const name =
        metamodel.property(a, u"name", StandardTypes::stringMeta).required();
    meta::Property const keyed = members(u"keyed").keyedBy(name).ordered();
    meta::Property const grouped = members(u"grouped").groupedBy(name).ordered();
    ModelElement const made = make(a);

    EXPECT_TRUE(is<ReflectiveElementMap<ustring>>(referencesOf(made, keyed)));
    EXPECT_TRUE(is<ReflectiveElementMultimap<ustring>>(referencesOf(made, grouped)));
    EXPECT_EQ(valueOf(made, keyed).getFlags(), ValueFlags::Map);
    EXPECT_EQ(valueOf(made, grouped).getFlags(), ValueFlags::Multimap);
    EXPECT_EQ(valueOf(made, keyed).getKeyType(), StandardTypes::stringMeta);
}

TEST_F(ReflectiveCollection, IsKeyedByEachStandardTypeInItsOwnWay)
{
    auto const expectKeys = [&]<class K>(meta::Type const& type, K const& first, K const& second) {
        ustring const suffix = type->getQualifiedName();
        meta::Property const key = metamodel.property(a, u"key" + suffix, type).required();
        meta::Property const keyed = members(u"keyed" + suffix).keyedBy(key);
        meta::Property const grouped = members(u"grouped" + suffix).groupedBy(key);
        ModelElement const owner = make(a), one = make(a), two = make(a);
        set(one, key, second);
        set(two, key, first);
        for (ModelElement const& member : {one, two})
        {
            genericOf(owner, keyed).genericAdd(member);
            genericOf(owner, grouped).genericAdd(member);
        }

        EXPECT_TRUE(is<ReflectiveElementMap<K>>(referencesOf(owner, keyed)));
        EXPECT_TRUE(is<ReflectiveElementMultimap<K>>(referencesOf(owner, grouped)));
        EXPECT_EQ(mapOf(owner, keyed).genericFind(Value(type, first)), two);
        EXPECT_THAT(multimapOf(owner, grouped).genericFind(Value(type, second)), ElementsAre(one));
        EXPECT_THAT(mapOf(owner, keyed).genericKeys(),
                    ElementsAre(Value(type, first), Value(type, second)));
    };

    expectKeys(StandardTypes::integerMeta, -1, 1);
    expectKeys(StandardTypes::integer8Meta, static_cast<signed char>(-1),
               static_cast<signed char>(1));
    expectKeys(StandardTypes::integer16Meta, static_cast<short>(-1), static_cast<short>(1));
    expectKeys(StandardTypes::integer64Meta, -1L, 1L);
    expectKeys(StandardTypes::unlimitedNaturalMeta, 0u, 0xFFFFFFFFu);
    expectKeys(StandardTypes::uinteger8Meta, static_cast<unsigned char>(0),
               static_cast<unsigned char>(255));
    expectKeys(StandardTypes::uinteger16Meta, static_cast<unsigned short>(0),
               static_cast<unsigned short>(65535));
    expectKeys(StandardTypes::uinteger64Meta, 0UL, ~0UL);
    expectKeys(StandardTypes::realMeta, -0.5, 0.5);
    expectKeys(StandardTypes::stringMeta, ustring(u"a"), ustring(u"b"));
    expectKeys(StandardTypes::stdstringMeta, string("a"), string("b"));
    expectKeys(StandardTypes::uuidMeta, UUID{}, UUID{{1}});
}

TEST_F(ReflectiveCollection, IsKeyedByTheNumberOfALiteral)
{
    meta::Enum const colour = metamodel.makeEnum(u"Colour", {u"red", u"blue"});
    Value const red = Value::createEnumValue(colour->findLiteralByValue(0));
    Value const blue = Value::createEnumValue(colour->findLiteralByValue(1));
    meta::Property const paint = metamodel.property(a, u"paint", colour).required();
    meta::Property const keyed = members(u"keyed").keyedBy(paint);
    ModelElement const owner = make(a), one = make(a), two = make(a);
    setValue(one, paint, blue);
    setValue(two, paint, red);
    genericOf(owner, keyed).genericAdd(one);
    genericOf(owner, keyed).genericAdd(two);

    EXPECT_TRUE(is<ReflectiveElementMap<unsigned long>>(referencesOf(owner, keyed)));
    EXPECT_EQ(mapOf(owner, keyed).genericFind(blue), one);
    EXPECT_THAT(mapOf(owner, keyed).genericKeys(), ElementsAre(red, blue));
}

TEST_F(ReflectiveCollection, IsKeyedByTheUuidOfAReferencedElement)
{
    meta::Property const friendOf = metamodel.property(a, u"friend", b);
    meta::Property const keyed = members(u"keyed").keyedBy(friendOf);
    ModelElement const owner = make(a), one = make(a), two = make(a), target = make(b);
    set(one, friendOf, target);
    genericOf(owner, keyed).genericAdd(one);
    genericOf(owner, keyed).genericAdd(two);

    EXPECT_TRUE(is<ReflectiveElementMap<UUID>>(referencesOf(owner, keyed)));
    EXPECT_EQ(mapOf(owner, keyed).genericFind(Value(StandardTypes::uuidMeta, target->getUuid())),
              one);
    EXPECT_EQ(mapOf(owner, keyed).genericFind(Value(StandardTypes::uuidMeta, UUID())), two);
}

TEST_F(ReflectiveCollection, IsKeyedByAValueOfADataType)
{
    meta::DataType const place = metamodel.makeDataType(u"Place");
    meta::Property const row =
        metamodel.field(place, u"row", StandardTypes::integerMeta).required();
    auto const at = [&](int number) {
        ReflectiveDataType value(place);
        value.setPropertyValue(row, Value(StandardTypes::integerMeta, number));
        return Value::createReflectiveDataTypeValue(value);
    };
    meta::Property const seat = metamodel.property(a, u"seat", place).required();
    meta::Property const keyed = members(u"keyed").keyedBy(seat);
    meta::Property const grouped = members(u"grouped").groupedBy(seat);
    ModelElement const owner = make(a), one = make(a), two = make(a);
    setValue(one, seat, at(2));
    setValue(two, seat, at(1));
    for (ModelElement const& member : {one, two})
    {
        genericOf(owner, keyed).genericAdd(member);
        genericOf(owner, grouped).genericAdd(member);
    }

    EXPECT_TRUE(is<ReflectiveElementMap<ReflectiveDataType>>(referencesOf(owner, keyed)));
    EXPECT_EQ(mapOf(owner, keyed).genericFind(at(1)), two);
    EXPECT_FALSE(mapOf(owner, keyed).genericFind(at(3)));
    EXPECT_THAT(mapOf(owner, keyed).genericKeys(), ElementsAre(at(1), at(2)));
    EXPECT_EQ(mapOf(owner, keyed).getKeyType(), place);
    EXPECT_TRUE(is<ReflectiveElementMultimap<ReflectiveDataType>>(referencesOf(owner, grouped)));
    EXPECT_THAT(multimapOf(owner, grouped).genericFind(at(2)), ElementsAre(one));

    meta::Property const optionalSeat = metamodel.property(a, u"optionalSeat", place);
    meta::Property const byOptional = members(u"byOptional").keyedBy(optionalSeat);
    ModelElement const unseated = make(a);
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       genericOf(make(a), byOptional).genericAdd(unseated), u"rt.Place");
}

TEST_F(ReflectiveCollection, OfADataTypeOutsideTheRegistryHasReflectiveValues)
{
    meta::DataType const place = metamodel.makeDataType(u"Place");
    meta::Property const row =
        metamodel.field(place, u"row", StandardTypes::integerMeta).required();
    meta::Property const list = metamodel.property(a, u"list", place).many();
    meta::Property const table = metamodel.property(a, u"table", place).keyedBy(row);
    ModelElement const made = make(a);

    EXPECT_TRUE(dynamic_cast<ReflectiveDataTypeSequence*>(&valuesOf(made, list)));
    EXPECT_TRUE(dynamic_cast<ReflectiveDataTypeAssociative<int>*>(&valuesOf(made, table)));

    Value const one = Value::createReflectiveDataTypeValue(ReflectiveDataType(place));
    Transaction const transaction = begin();
    valuesOf(made, list).genericAdd(one);
    EXPECT_TRUE(has(made, list));
    transaction.rollBack();
    EXPECT_FALSE(has(made, list));
}

TEST_F(ReflectiveCollection, OfADataTypeCanNotBeKeyedByAnyType)
{
    meta::DataType const place = metamodel.makeDataType(u"Place");
    meta::Property const open =
        metamodel.field(place, u"open", StandardTypes::booleanMeta).required();
    metamodel.property(a, u"table", place).keyedBy(open);

    EXPECT_RAISES_WITH(messages::UnsupportedQualification, make(a), u"Boolean");
}

TEST_F(ReflectiveCollection, CanNotBeKeyedByAnyOtherType)
{
    meta::Property const flag =
        metamodel.property(a, u"flag", StandardTypes::booleanMeta).required();
    EXPECT_TRUE(make(a));
    meta::Property const keyed = members(u"keyed").keyedBy(flag);

    EXPECT_RAISES_WITH(messages::UnsupportedQualification, make(a), u"Boolean");

    flag->setType(StandardTypes::dateTimeMeta);
    EXPECT_RAISES_WITH(messages::UnsupportedQualification, make(a), u"DateTime");
    flag->setType(meta::Type());
    keyed->setIsDerived(true);
    flag->setIsDerived(true);
    EXPECT_TRUE(make(a));
}

TEST_F(ReflectiveCollection, WithADeadQualifierIsNotKeyed)
{
    meta::Property const name =
        metamodel.property(a, u"name", StandardTypes::stringMeta).required();
    meta::Property const keyed = members(u"keyed").keyedBy(name).ordered();
    name->destroy();

    EXPECT_TRUE(is<ReflectiveElementSequence>(referencesOf(make(a), keyed)));
}

TEST_F(ReflectiveCollection, KeysByWhatThePublicMayRead)
{
    meta::Property const name =
        metamodel.property(a, u"name", StandardTypes::stringMeta).required().notReadable();
    meta::Property const keyed = members(u"keyed").keyedBy(name);
    ModelElement const made = make(a), member = make(a);

    EXPECT_RAISES_WITH(messages::NoSuchProperty, genericOf(made, keyed).genericAdd(member), u"name",
                       u"rt.A");

    EXPECT_THAT(entriesOf(made, keyed), IsEmpty());
}

TEST_F(ReflectiveCollection, HasASnapshotOfTheSameClassWithoutAnOwner)
{
    meta::Property const name =
        metamodel.property(a, u"name", StandardTypes::stringMeta).required();
    std::vector<meta::Property> const properties = {
        members(u"ordered").ordered(), members(u"unordered"), members(u"keyed").keyedBy(name),
        members(u"grouped").groupedBy(name)};
    ModelElement const made = make(a), member = make(a);

    for (meta::Property const& property : properties)
    {
        ReferenceCollection& attached = referencesOf(made, property);
        genericOf(made, property).genericAdd(member);
        auto const snapshot = snapshotOf(made, property);

        EXPECT_EQ(typeid(*snapshot), typeid(attached));
        EXPECT_FALSE(snapshot->getOwner());
        EXPECT_EQ(snapshot->getCollectionProperty(), property);
        EXPECT_EQ(snapshot->getElementClass(), a);
        snapshot->copyContents(attached);
        EXPECT_THAT(snapshot->getAllValues(), ElementsAre(member));
        snapshot->getGenericInterface()->genericClear();
        EXPECT_THAT(attached.getAllValues(), ElementsAre(member));
    }
}

TEST_F(ReflectiveCollection, IsMadeFreelyForAnOwnedProperty)
{
    meta::Property const ordered = members(u"ordered").ordered();
    meta::Property const numbers =
        metamodel.property(a, u"numbers", StandardTypes::integerMeta).many();
    ModelElement const made = make(a);
    auto const& impl = dynamic_cast<ReflectiveModelElementImpl&>(*made.getImpl());

    std::unique_ptr<AbstractOwnedCollection> const attached(
        impl.instantiateCollection(ordered, /*owned=*/true));
    std::unique_ptr<AbstractOwnedCollection> const values(
        impl.instantiatePrimitiveCollection(numbers, /*owned=*/true));
    std::unique_ptr<AbstractOwnedCollection> const free(
        impl.instantiatePrimitiveCollection(numbers, /*owned=*/false));

    EXPECT_EQ(attached->getOwner(), made.getImpl());
    EXPECT_EQ(values->getOwner(), made.getImpl());
    EXPECT_FALSE(free->getOwner());
    EXPECT_NE(attached.get(), &referencesOf(made, ordered));
}

TEST_F(ReflectiveCollection, OfASetIsChangedThroughItsGenericView)
{
    meta::Property const unordered = members(u"unordered");
    ModelElement const made = make(a), one = make(a), two = make(a);
    ModelElement const proxy = danglingProxy(a);
    GenericCollectionInterface& view = genericOf(made, unordered);

    view.genericAdd(one);
    view.genericAdd(one);
    view.genericAdd(two);
    view.genericAdd(proxy);
    EXPECT_EQ(view.genericSize(), 2u) << "a stand-in stands beside the set";
    EXPECT_THAT(entriesOf(made, unordered), UnorderedElementsAre(one, two, proxy));
    view.genericRemove(one);
    view.genericRemove(proxy);
    EXPECT_THAT(entriesOf(made, unordered), ElementsAre(two));
    view.genericAdd(proxy);
    view.genericClear();
    EXPECT_THAT(entriesOf(made, unordered), IsEmpty());
    EXPECT_FALSE(view.isSequenceInterface() || view.isMapInterface() || view.isMultimapInterface());
}
}  // namespace
}  // namespace testkit
