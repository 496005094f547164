#include "tests/collections/CollectionFixture.h"

#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace testkit {
namespace {

Value text(ustring const& value)
{
    meta::StandardTypes::ensureInitialized();
    return Value(meta::StandardTypes::stringMeta, value);
}

class KeyedCollection : public CollectionFixture
{
protected:
    GenericMapInterface& mapOf(ReferenceCollection const& collection)
    {
        return dynamic_cast<GenericMapInterface&>(genericOf(collection));
    }
    GenericMultimapInterface& multimapOf(ReferenceCollection const& collection)
    {
        return dynamic_cast<GenericMultimapInterface&>(genericOf(collection));
    }

    Node const owner = node(u"owner");
    Node const other = node(u"other");
    Node const a = node(u"a");
    Node const b = node(u"b");
    Node const secondA = node(u"a");
};

TEST_F(KeyedCollection, FilesElementsByTheirKeyAscending)
{
    owner->getByName().insert(b);
    owner->getByName().insert(a);

    EXPECT_EQ(owner->getByName().find(u"a"), a);
    EXPECT_EQ(owner->getByName().find(u"b"), b);
    EXPECT_FALSE(owner->getByName().find(u"c"));
    EXPECT_EQ(namesIn(owner->getByName()), (Names{u"a", u"b"}));
    EXPECT_EQ(owner->getByName().begin()->first, u"a");
    EXPECT_EQ(a->container(), owner);
    EXPECT_TRUE(owner->getByName().contains(a));
}

TEST_F(KeyedCollection, IgnoresAnElementThatItHolds)
{
    owner->getByName().insert(a);
    owner->getByName().insert(a);
    EXPECT_EQ(owner->getByName().size(), 1u);

    owner->getGrouped().insert(a);
    owner->getGrouped().insert(a);
    EXPECT_EQ(owner->getGrouped().size(), 1u);
}

TEST_F(KeyedCollection, RefusesATakenKeyInAMap)
{
    owner->getByName().insert(a);

    EXPECT_RAISES(messages::UniquenessConstraint, owner->getByName().insert(secondA));
    EXPECT_RAISES(messages::UniquenessConstraint,
                  genericOf(owner->getByName()).genericAdd(secondA));

    EXPECT_EQ(owner->getByName().find(u"a"), a);
    EXPECT_TRUE(secondA->isTopLevel());
}

TEST_F(KeyedCollection, HoldsSeveralElementsOfAKeyInAMultimapInTheOrderOfTheirComing)
{
    owner->getGrouped().insert(secondA);
    owner->getGrouped().insert(b);
    owner->getGrouped().insert(a);

    EXPECT_EQ(owner->getGrouped().find(u"a"), (std::vector<Node>{secondA, a}));
    EXPECT_TRUE(owner->getGrouped().find(u"c").empty());
    EXPECT_EQ(owner->getGrouped().count(u"a"), 2u);
    EXPECT_EQ(a->getGroup(), owner);
}

TEST_F(KeyedCollection, ErasingReleasesTheElement)
{
    owner->getByName().insert(a);
    owner->getByName().erase(b);
    owner->getByName().erase(a);
    EXPECT_TRUE(a->isTopLevel());
    EXPECT_TRUE(owner->getByName().empty());

    owner->getGrouped().insert(a);
    owner->getGrouped().insert(secondA);
    owner->getGrouped().erase(a);
    EXPECT_FALSE(a->getGroup());
    EXPECT_EQ(owner->getGrouped().find(u"a"), (std::vector<Node>{secondA}));
}

TEST_F(KeyedCollection, ClearingReleasesAllElements)
{
    owner->getByName().insert(a);
    owner->getByName().insert(b);
    owner->getGrouped().insert(a);

    owner->getByName().clear();
    owner->getGrouped().clear();

    EXPECT_TRUE(a->isTopLevel());
    EXPECT_TRUE(b->isTopLevel());
    EXPECT_FALSE(a->getGroup());
    EXPECT_TRUE(owner->getByName().empty());
}

TEST_F(KeyedCollection, AddingMovesFromTheOldContainer)
{
    owner->getByName().insert(a);

    other->getByName().insert(a);

    EXPECT_TRUE(owner->getByName().empty());
    EXPECT_EQ(a->container(), other);
}

TEST_F(KeyedCollection, IgnoresNullAndDestroyedElements)
{
    b->destroy();
    for (Node const& nothing : {Node(), b})
    {
        owner->getByName().insert(nothing);
        owner->getByName().erase(nothing);
        genericOf(owner->getByName()).genericAdd(nothing);
        genericOf(owner->getGrouped()).genericAdd(nothing);
        genericOf(owner->getGrouped()).genericRemove(nothing);
    }

    EXPECT_TRUE(owner->getByName().empty());
    EXPECT_TRUE(owner->getGrouped().empty());
}

TEST_F(KeyedCollection, RefusesElementsOfAWrongClassBeforeItReadsTheirKey)
{
    bool read = false;
    ElementMap<int, SpecialNode> map(
        owner.getImpl(),
        [&](ModelElement::Impl*) {
            read = true;
            return 0;
        },
        Feature(), Feature());

    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, genericOf(map).genericAdd(a),
                       u"testkit.SpecialNode", u"testkit.Node");
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, genericOf(map).genericRemove(a));

    EXPECT_FALSE(read);
}

TEST_F(KeyedCollection, KeepsTheOldKeyOfAnElementThatIsRenamedBehindItsBack)
{
    Opened<ElementMultimap<ustring, Node>> map(
        owner.getImpl(),
        [](ModelElement::Impl* member) { return static_cast<Node::Impl*>(member)->getName(); },
        Feature(), Feature());
    map.insert(a);

    a->setName(u"z");

    EXPECT_EQ(map.find(u"a"), (std::vector<Node>{a}));
    map.erase(a);
    EXPECT_EQ(map.size(), 1u) << "the new key misses it";
    map.insert(a);
    EXPECT_EQ(map.size(), 2u) << "so that it is filed twice";
}

TEST_F(KeyedCollection, RenamingAMemberOfAnAssociationFilesItAnew)
{
    owner->getByName().insert(a);

    a->setName(u"z");

    EXPECT_FALSE(owner->getByName().find(u"a"));
    EXPECT_EQ(owner->getByName().find(u"z"), a);
}

TEST_F(KeyedCollection, KeepsTheEntryOfATakenKeyInABasicAdd)
{
    Opened<ElementMap<ustring, Node>> map(
        owner.getImpl(),
        [](ModelElement::Impl* member) { return static_cast<Node::Impl*>(member)->getName(); },
        Feature(), Feature());

    map.basicAdd(a);
    map.basicAdd(secondA);

    EXPECT_EQ(map.find(u"a"), a);
    map.basicRemove(secondA);
    EXPECT_EQ(map.size(), 1u) << "the key alone does not make it the entry";
    map.basicRemove(a);
    EXPECT_TRUE(map.empty());
}

TEST_F(KeyedCollection, AnnouncesABasicRemovalOfAnAbsentElement)
{
    DeepCounter counter;
    Opened<ElementMap<ustring, Node>> map(
        owner.getImpl(),
        [](ModelElement::Impl* member) { return static_cast<Node::Impl*>(member)->getName(); },
        Node::Impl::BY_NAME);
    model->addListener(&counter);

    map.basicRemove(a);

    EXPECT_EQ(counter.commits, 1);
    model->removeListener(&counter);
}

TEST_F(KeyedCollection, OrdersKeysThatAreNotANumberToo)
{
    ElementMap<double, Node> map(
        owner.getImpl(),
        [](ModelElement::Impl* member) { return static_cast<Node::Impl*>(member)->getWeight(); },
        Feature(), Feature());
    a->setWeight(std::numeric_limits<double>::quiet_NaN());
    b->setWeight(1);
    secondA->setWeight(std::numeric_limits<double>::quiet_NaN());

    map.insert(a);
    map.insert(b);

    EXPECT_EQ(map.find(1), b);
    EXPECT_EQ(map.find(std::numeric_limits<double>::quiet_NaN()), a);
    EXPECT_RAISES(messages::UniquenessConstraint, map.insert(secondA));
}

TEST_F(KeyedCollection, AnElementWhoseKeyCannotBeReadStaysOut)
{
    ElementMap<int, Node> map(
        owner.getImpl(),
        [](ModelElement::Impl*) -> int {
            reportException(messages::CannotCastIncompatibleTypes(u"Integer"));
        },
        Node::Impl::BY_NAME, Feature());

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, map.insert(a), u"Integer");

    EXPECT_TRUE(map.empty());
    EXPECT_FALSE(model->getCurrentTransaction());
}

// ---------------------------------------------------------------------------- without types

TEST_F(KeyedCollection, AMapCanBeAskedWithoutItsKeyType)
{
    GenericMapInterface& map = mapOf(owner->getByName());
    EXPECT_TRUE(map.isMapInterface());
    EXPECT_FALSE(map.isMultimapInterface());
    EXPECT_FALSE(map.isSequenceInterface());

    map.genericAdd(b);
    map.genericEnsureAt(a, 9);

    EXPECT_EQ(map.genericSize(), 2u);
    EXPECT_EQ(map.genericFind(text(u"a")), a);
    EXPECT_FALSE(map.genericFind(text(u"c")));
    std::vector<Value> const keys = map.genericKeys();
    ASSERT_EQ(keys.size(), 2u);
    EXPECT_EQ(keys[0].getValue<ustring>(), u"a");
    EXPECT_EQ(keys[1].getValue<ustring>(), u"b");
    EXPECT_EQ(map.getKeyType(), meta::StandardTypes::stringMeta);
    map.genericRemove(a);
    map.genericClear();
    EXPECT_EQ(map.genericSize(), 0u);
    map.genericAdd(a);
    map.genericBasicClear();
    EXPECT_EQ(map.genericSize(), 0u);
}

TEST_F(KeyedCollection, AMultimapCanBeAskedWithoutItsKeyType)
{
    GenericMultimapInterface& map = multimapOf(owner->getGrouped());
    EXPECT_TRUE(map.isMultimapInterface());
    EXPECT_FALSE(map.isMapInterface());

    map.genericAdd(a);
    map.genericAdd(secondA);
    map.genericAdd(b);

    EXPECT_EQ(map.genericFind(text(u"a")), (std::vector<ModelElement>{a, secondA}));
    EXPECT_TRUE(map.genericFind(text(u"c")).empty());
    EXPECT_EQ(map.genericKeys().size(), 2u) << "each key once";
    EXPECT_EQ(map.getKeyType(), meta::StandardTypes::stringMeta);
    map.genericRemove(a);
    map.genericBasicClear();
    map.genericClear();
    EXPECT_EQ(map.genericSize(), 0u);
}

TEST_F(KeyedCollection, RefusesAKeyOfAnotherType)
{
    meta::StandardTypes::ensureInitialized();
    Value const number(meta::StandardTypes::integerMeta, 1);

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       mapOf(owner->getByName()).genericFind(number), u"Integer");
    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  multimapOf(owner->getGrouped()).genericFind(number));
}

TEST_F(KeyedCollection, KnowsTheTypeOfATextKeyWithoutAProperty)
{
    ElementMap<ustring, Node> texts(
        owner.getImpl(), [](ModelElement::Impl*) { return ustring(u"k"); }, Feature(), Feature());
    ElementMap<int, Node> numbers(
        owner.getImpl(), [](ModelElement::Impl*) { return 7; }, Feature(), Feature());
    numbers.insert(a);

    EXPECT_EQ(mapOf(texts).getKeyType(), meta::StandardTypes::stringMeta);
    EXPECT_FALSE(mapOf(numbers).getKeyType());
    EXPECT_EQ(mapOf(numbers).genericKeys().at(0).getValue<int>(), 7);
}
}  // namespace
}  // namespace testkit
