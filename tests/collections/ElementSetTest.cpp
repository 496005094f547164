#include "tests/collections/CollectionFixture.h"

namespace testkit {
namespace {

class ElementSet : public CollectionFixture
{
protected:
    Node const owner = node(u"owner");
    Node const a = node(u"a");
    Node const b = node(u"b");
    Opened<UnorderedElementSet<Node>> set{owner.getImpl(), Feature(), Feature()};
};

TEST_F(ElementSet, HoldsAnElementOnce)
{
    set.insert(a);
    set.insert(b);
    set.insert(a);

    EXPECT_EQ(sortedNamesIn(set), (Names{u"a", u"b"}));
    EXPECT_EQ(set.size(), 2u);
    EXPECT_TRUE(set.contains(a));
}

TEST_F(ElementSet, CanBeWalked)
{
    set.insert(a);
    set.insert(b);

    Names names;
    for (Node const& entry : set)
        names.push_back(entry->getName());

    std::sort(names.begin(), names.end());
    EXPECT_EQ(names, (Names{u"a", u"b"}));
}

TEST_F(ElementSet, ErasesAnElementAndIgnoresOneThatIsAbsent)
{
    set.insert(a);

    set.erase(b);
    set.erase(a);

    EXPECT_TRUE(set.empty());
}

TEST_F(ElementSet, IgnoresNullAndDestroyedElements)
{
    b->destroy();
    for (Node const& nothing : {Node(), b})
    {
        set.insert(nothing);
        set.erase(nothing);
        genericOf(set).genericAdd(nothing);
        genericOf(set).genericRemove(nothing);
        EXPECT_FALSE(set.contains(nothing));
    }

    EXPECT_TRUE(set.empty());
}

TEST_F(ElementSet, CanBeUsedWithoutItsElementClass)
{
    GenericCollectionInterface& generic = genericOf(set);
    EXPECT_FALSE(generic.isSequenceInterface());
    EXPECT_FALSE(generic.isMapInterface());
    EXPECT_FALSE(generic.isMultimapInterface());

    generic.genericAdd(a);
    generic.genericEnsureAt(b, 7);
    EXPECT_EQ(generic.genericSize(), 2u) << "without positions, to ensure is to add";
    generic.genericRemove(a);
    EXPECT_EQ(namesIn(set), (Names{u"b"}));
    generic.genericClear();
    generic.genericAdd(a);
    generic.genericBasicClear();
    EXPECT_EQ(generic.genericSize(), 0u);
}

TEST_F(ElementSet, RefusesElementsOfAWrongClass)
{
    UnorderedElementSet<SpecialNode> special(owner.getImpl(), Feature(), Feature());

    EXPECT_RAISES_WITH(messages::CannotAddIncompatibleTypes, genericOf(special).genericAdd(a),
                       u"testkit.SpecialNode", u"testkit.Node");
    EXPECT_RAISES(messages::CannotAddIncompatibleTypes, genericOf(special).genericRemove(a));

    EXPECT_TRUE(special.empty());
}

TEST_F(ElementSet, AnnouncesNothingForADuplicateOrAnAbsentElement)
{
    DeepCounter counter;
    owner->getMarks().insert(a);
    model->addListener(&counter);

    owner->getMarks().insert(a);
    owner->getMarks().erase(b);
    EXPECT_EQ(counter.commits, 0);

    owner->getMarks().clear();
    owner->getMarks().clear();
    EXPECT_EQ(counter.commits, 2) << "clearing is a change even if nothing is there";
    model->removeListener(&counter);
}

TEST_F(ElementSet, BasicOperationsLeaveTheOtherEndAlone)
{
    Opened<UnorderedElementSet<Node>> marks(owner.getImpl(), Node::Impl::MARKS);

    marks.basicAdd(a);
    marks.basicAdd(a);
    EXPECT_EQ(marks.size(), 1u);
    EXPECT_TRUE(a->getMarkedBy().empty());

    marks.basicRemove(b);
    marks.basicRemove(a);
    EXPECT_TRUE(marks.empty());
}

TEST_F(ElementSet, HoldsManyElements)
{
    std::vector<Node> nodes;
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    for (int count = 0; count < 1000; ++count)
        nodes.push_back(Node::create(model));

    for (Node const& element : nodes)
        set.insert(element);
    EXPECT_EQ(set.size(), 1000u);
    for (Node const& element : nodes)
        set.erase(element);

    EXPECT_TRUE(set.empty());
    transaction.commit();
}
}  // namespace
}  // namespace testkit
