#include "tarnkiln/collections/SubsettedElementSet.h"

#include "tests/collections/CollectionFixture.h"

namespace testkit {
namespace {

class Subset : public CollectionFixture
{
protected:
    Node const owner = node(u"owner");
    Node const plain = node(u"plain");
    SpecialNode const first = SpecialNode::create(model);
    SpecialNode const second = SpecialNode::create(model);
    SubsettedElementSet<SpecialNode> subset{owner->getLinks(), Node::Impl::LINKS};
};

TEST_F(Subset, ShowsTheElementsOfItsClassInTheirOrder)
{
    EXPECT_EQ(subset.size(), 0u);
    for (Node const& element : {Node(first), plain, Node(second)})
        owner->getLinks().push_back(element);

    EXPECT_EQ(subset.getAllValues(), (std::vector<ModelElement>{first, second}));
    EXPECT_EQ(subset.getAllValuesAndProxies(), (std::vector<ModelElement>{first, second}));
    EXPECT_TRUE(subset.contains(first));
    EXPECT_FALSE(subset.contains(plain));
    EXPECT_EQ(subset.getElementClass(), SpecialNode::metaClass());

    owner->getLinks().remove(first);
    EXPECT_EQ(subset.getAllValues(), (std::vector<ModelElement>{second}));
}

TEST_F(Subset, CanBeReadWithoutItsElementClass)
{
    for (Node const& element : {plain, Node(first), Node(second)})
        owner->getLinks().push_back(element);
    GenericSequenceInterface& generic = dynamic_cast<GenericSequenceInterface&>(genericOf(subset));

    EXPECT_EQ(generic.genericSize(), 2u);
    EXPECT_EQ(generic.genericAt(1), second);
    EXPECT_EQ(generic.genericIndexOf(second), 1);
    EXPECT_EQ(generic.genericIndexOf(plain), -1);
    EXPECT_EQ(generic.genericIndexOf({}), -1);
}

TEST_F(Subset, HoldsNothingThatARollbackCouldTake)
{
    owner->getLinks().push_back(first);
    SubsettedElementSet<SpecialNode> other(plain->getLinks(), Node::Impl::LINKS);

    subset.basicSwapContents(other);
    EXPECT_EQ(subset.size(), 1u);
    subset.basicDropContents();
    EXPECT_EQ(subset.size(), 1u);
    EXPECT_EQ(other.size(), 0u);
}

TEST_F(Subset, RefusesChangesWithoutUpkeepToo)
{
    using messages::CannotAddIncompatibleObjectSubset;
    Opened<SubsettedElementSet<SpecialNode>> opened(owner->getLinks(), Node::Impl::LINKS);
    owner->getLinks().push_back(first);

    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, opened.basicRemove(first));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, opened.basicClear());
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, opened.basicCopyValues(subset));
    EXPECT_FALSE(opened.basicContainsProxyTo(first));

    EXPECT_EQ(opened.size(), 1u);
}

TEST_F(Subset, RefusesAllChanges)
{
    using messages::CannotAddIncompatibleObjectSubset;
    owner->getLinks().push_back(first);
    GenericSequenceInterface& generic = dynamic_cast<GenericSequenceInterface&>(genericOf(subset));

    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericAdd(second));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericEnsureAt(second, 0));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericInsert(second, 0));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericReplace(second, 0));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericRemove(first));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericRemoveAt(0));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericClear());
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, generic.genericBasicClear());
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, subset.copyContents(owner->getLinks()));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, subset.replaceProxy(second, 0));
    EXPECT_RAISES(CannotAddIncompatibleObjectSubset, subset.basicAddWithProxy(second));

    EXPECT_EQ(subset.size(), 1u);
}
}  // namespace
}  // namespace testkit
